#include "sysdata/osInfo_log.h"

#include <algorithm>
#include <cctype>

namespace NQ::OSINFO
{

namespace
{

bool holdsPassword(std::string const& text)
{
    return text.find("Password") != std::string::npos;
}

bool isPlainWord(std::string const& text)
{
    return std::all_of(text.begin(), text.end(),
                       [](unsigned char c) { return std::isalnum(c) != 0; });
}

/** useradd's exit code as its command line echoes it, or a notice without any argument in it. */
bool quotesNothing(std::string const& line)
{
    if (line == "usermod: no changes")
        return true;
    return line.compare(0, 3, "rc=") == 0 &&
           line.find_first_not_of("0123456789", 3) == std::string::npos;
}

} // namespace

std::string loggable(std::string const& text)
{
    return holdsPassword(text) && !isPlainWord(text) ? "" : text;
}

std::string loggableOutput(std::string const& output, bool secret)
{
    if (!secret && !holdsPassword(output))
        return output;
    std::string shown;
    for (std::string::size_type start = 0; start < output.size();) {
        std::string::size_type const end = std::min(output.find('\n', start), output.size());
        std::string const line = output.substr(start, end - start);
        shown += quotesNothing(line) ? line : "(not shown)";
        shown += '\n';
        start = end + 1;
    }
    return shown;
}

std::string unknownType(std::string const& type)
{
    return LOG::message("Unknown parameter type: ", loggable(type));
}

std::string tooLong(std::string const& program)
{
    return LOG::message("Command line too long: ", program);
}

} // namespace NQ::OSINFO
