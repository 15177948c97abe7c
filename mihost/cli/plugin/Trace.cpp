#include "mihost/cli/plugin/Trace.h"

#include "mihost/cli/catalogue/Catalogue.h"
#include "mihost/cli/plugin/TraceFile.h"

#include <cerrno>

namespace mihost
{

namespace
{

constexpr char standardError[] = "-";

std::FILE* openTrace(std::string const& file)
{
    if (file == standardError)
        return stderr;
    Descriptor opened = openTraceFile(file);
    std::FILE* const stream = fdopen(opened.get(), "we"); // kept from the commands
    if (!stream)
        throw cannotWriteTrace(file, errno);
    opened.release();
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
    // A reader may close the trace early.
    if (int const problem = writer_.finish(); problem != 0 && problem != EPIPE)
        throw cannotWriteTrace(file_, problem);
}

} // namespace mihost
