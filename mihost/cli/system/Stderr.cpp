#include "mihost/cli/system/Stderr.h"

#include "mihost/runtime/Text.h"

#include <cstdio>
#include <fmt/format.h>
#include <unistd.h>

namespace mihost
{

namespace
{

constexpr char yellow[] = "\x1b[33m";
constexpr char red[] = "\x1b[31m";
constexpr char plain[] = "\x1b[0m";

struct MessageStyle {
    Colours colours = Colours::Auto;
    bool isQuiet = false;
};

MessageStyle& style()
{
    static MessageStyle current;
    return current;
}

void writeMessage(char const* colour, std::string const& text)
{
    std::string const message = fmt::format("mihost: {}", printable(text));
    bool const isColoured = takesColours(STDERR_FILENO, style().colours);
    writeStderr(isColoured ? colour + message + plain + '\n' : message + '\n');
}

} // namespace

void writeStderr(std::string const& text)
{
    std::fwrite(text.data(), 1, text.size(), stderr);
    std::fflush(stderr);
}

void setMessageStyle(Colours colours, bool isQuiet)
{
    style() = {colours, isQuiet};
}

void warn(std::string const& text)
{
    if (!style().isQuiet)
        writeMessage(yellow, text);
}

void writeError(std::string const& text)
{
    writeMessage(red, text);
}

} // namespace mihost
