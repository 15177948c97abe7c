#include "sysdata/userInfo_parse.h"

#include <algorithm>
#include <cstdio>
#include <cstring>
#include <vector>

namespace NQ::USER_INFO
{

namespace
{
constexpr std::string_view denyKey = "deny=";
}

std::string takeDenyLine(std::string_view& rules)
{
    std::size_t const at = rules.find(denyKey);
    if (at == std::string_view::npos)
        return {};
    std::size_t const lineEnd = std::min(rules.find('\n', at), rules.size());
    std::size_t const before = rules.rfind('\n', at);
    std::size_t const begin = before == std::string_view::npos ? 0 : before + 1;
    std::string line(rules.substr(begin, lineEnd - begin));
    rules.remove_prefix(lineEnd);
    return line;
}

Scan scanDeny(std::string const& line, long& deny)
{
    std::string::size_type const at = line.find(denyKey);
    if (at == std::string::npos)
        return Scan::absent;
    int number = 0;
    if (std::sscanf(line.c_str() + at, "deny=%d", &number) != 1)
        return Scan::invalid;
    deny = number;
    return Scan::valid;
}

Scan scanLabelledDate(char const* line, char const* label, LabelledDate& date)
{
    if (!std::strstr(line, label))
        return Scan::absent;
    std::string const format = std::string(label) + " : %s %02d, %04d";
    std::vector<char> month(std::strlen(line) + 1); // holds whatever %s can find
    int const converted = std::sscanf(line, format.c_str(), month.data(), &date.day, &date.year);
    if (converted >= 1)
        date.month = month.data();
    if (converted < 3)
        return Scan::invalid;
    if (date.month == "never")
        date = {"Jan", 19, 2038};
    return Scan::valid;
}

CalendarDay scanDay(char const* text)
{
    CalendarDay day;
    std::sscanf(text, "%4d-%2d-%2d 00:00:00", &day.year, &day.month, &day.day);
    return day;
}

} // namespace NQ::USER_INFO
