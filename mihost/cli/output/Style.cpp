#include "mihost/cli/output/Style.h"

#include <algorithm>
#include <iterator>

namespace mihost
{

namespace
{

struct Mark {
    char const* sign; // three bytes, an invisible character
    char const* control;
};

constexpr std::size_t signSize = 3;

// In the order of the enumeration, and what ends all of them.
constexpr Mark marks[] = {
    {"\u2060", "\x1b[1m"},  {"\u2061", "\x1b[2m"},  {"\u2062", "\x1b[32m"}, {"\u2063", "\x1b[33m"},
    {"\u2064", "\x1b[31m"}, {"\u2066", "\x1b[36m"}, {"\u2069", "\x1b[0m"},
};
constexpr Mark const& end = *std::rbegin(marks);

Mark const* markAt(std::string_view text)
{
    if (text.empty() || text.front() != marks[0].sign[0])
        return nullptr; // almost always
    auto const found = std::find_if(std::begin(marks), std::end(marks), [text](Mark const& mark) {
        return text.substr(0, signSize) == mark.sign;
    });
    return found == std::end(marks) ? nullptr : found;
}

} // namespace

std::string styled(Style style, std::string_view text)
{
    std::string result = marks[static_cast<std::size_t>(style)].sign;
    return result.append(text).append(end.sign);
}

std::string withColours(std::string_view text)
{
    std::string result;
    Mark const* current = &end;
    while (!text.empty()) {
        if (Mark const* const mark = markAt(text)) {
            result += mark->control;
            current = mark;
            text.remove_prefix(signSize);
            continue;
        }
        if (text.front() == '\n' && current != &end) {
            result += end.control;
            current = &end;
        }
        result += text.front();
        text.remove_prefix(1);
    }
    return result;
}

std::string withoutStyles(std::string_view text)
{
    std::string result;
    while (!text.empty()) {
        bool const isMark = markAt(text) != nullptr;
        if (!isMark)
            result += text.front();
        text.remove_prefix(isMark ? signSize : 1);
    }
    return result;
}

} // namespace mihost
