#include "util/textTools.h"

#include <cstdarg>
#include <cstdio>

namespace NQ::text
{

void replaceAfterFirst(char* s, char from, char to)
{
    if (*s == '\0')
        return;
    for (char* at = s + 1; *at != '\0'; ++at) {
        if (*at != from)
            continue;
        *at = to;
        if (to == '\0')
            return;
    }
}

bool print(char* buffer, std::size_t size, char const* format, ...)
{
    std::va_list arguments;
    va_start(arguments, format);
    int const length = std::vsnprintf(buffer, size, format, arguments);
    va_end(arguments);
    return length >= 0 && static_cast<std::size_t>(length) < size;
}

std::vector<std::string> split(std::string const& text, std::string const& delimiters)
{
    std::vector<std::string> tokens;
    std::string::size_type start = text.find_first_not_of(delimiters);
    while (start != std::string::npos) {
        std::string::size_type const end = text.find_first_of(delimiters, start);
        tokens.push_back(text.substr(start, end - start));
        start = text.find_first_not_of(delimiters, end);
    }
    return tokens;
}

} // namespace NQ::text
