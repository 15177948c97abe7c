#include "mihost/cli/Trace.h"

#include "mihost/cli/Catalogue.h"
#include "mihost/cli/Failure.h"

#include <cerrno>
#include <cstring>
#include <fmt/format.h>

namespace mihost
{

namespace
{

constexpr char standardError[] = "-";

Failure cannotWrite(std::string const& file, int problem)
{
    return {BadUsage, fmt::format("cannot write the trace '{}': {}", file, std::strerror(problem))};
}

std::FILE* openTrace(std::string const& file)
{
    if (file == standardError)
        return stderr;
    std::FILE* const stream = std::fopen(file.c_str(), "we"); // kept from the commands
    if (!stream)
        throw cannotWrite(file, errno);
    return stream;
}

} // namespace

Trace::Trace(std::string const& file)
    : file_(file), stream_(openTrace(file)), writer_(stream_), lines_(writer_, kindName)
{
    setNodeObserver(&lines_);
}

Trace::~Trace()
{
    setNodeObserver(nullptr);
    if (stream_ != stderr)
        std::fclose(stream_);
}

void Trace::finish()
{
    // A reader that went early has seen what it wanted.
    if (int const problem = writer_.finish(); problem != 0 && problem != EPIPE)
        throw cannotWrite(file_, problem);
}

} // namespace mihost
