#include "mihost/cli/output/Output.h"

#include "mihost/cli/output/Terminal.h"
#include "mihost/cli/system/Failure.h"

#include <cerrno>
#include <cstring>
#include <fmt/format.h>

namespace mihost
{

Output::Output(std::FILE* stream) : stream_(stream) {}

void Output::write(std::string_view text)
{
    if (std::fwrite(text.data(), 1, text.size(), stream_) != text.size())
        fail();
    size_ += text.size();
}

void Output::line(std::string_view text)
{
    write(text);
    write("\n");
}

void Output::json(Json const& document)
{
    line(document.dump());
}

void Output::flush()
{
    if (std::fflush(stream_) != 0)
        fail();
}

Room Output::room() const
{
    unsigned int const width = terminal::width(descriptor());
    return {width == 0 ? Room::unlimited : width, terminal::hasUnicode() ? "…" : "~"};
}

std::string Output::bold(std::string const& text) const
{
    return styled("\x1b[1m", text);
}

std::string Output::faint(std::string const& text) const
{
    return styled("\x1b[2m", text);
}

std::string Output::styled(char const* start, std::string const& text) const
{
    constexpr char end[] = "\x1b[0m";
    return terminal::takesColours(descriptor()) ? start + text + end : text;
}

void Output::fail()
{
    int const problem = errno;
    if (problem == EPIPE)
        throw OutputClosed();
    throw Failure(BadUsage, fmt::format("cannot write the output: {}", std::strerror(problem)));
}

} // namespace mihost
