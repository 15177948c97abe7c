#include "sysdata/logInfo_parse.h"

#include <climits>
#include <cstdio>
#include <cstring>

namespace NQ::logLines
{

bool findCount(char const* line, unsigned int& count)
{
    int number = 0;
    if (std::sscanf(line, "%d ", &number) != 1)
        return false;
    count = static_cast<unsigned int>(number);
    return true;
}

bool findStamp(char const* text, Stamp& stamp)
{
    return std::sscanf(text, "%15s %d %d:%d:%d ", stamp.month, &stamp.day, &stamp.hour,
                       &stamp.minute, &stamp.second) == 5;
}

bool findToday(char const* line, Today& today)
{
    char const* const beforeMonth = std::strchr(line, ' ');
    char const* const beforeYear = std::strrchr(line, ' ');
    return beforeMonth && beforeYear && std::sscanf(beforeYear, " %d\n", &today.year) == 1 &&
           std::sscanf(beforeMonth, " %511s \n", today.month) == 1;
}

int yearOf(Stamp const& stamp, Today const& today)
{
    bool const hasYearBefore = today.year != 0 && today.year != INT_MIN;
    bool const fromLastYear =
        std::strcmp(today.month, "Jan") == 0 && std::strcmp(stamp.month, "Dec") == 0;
    return hasYearBefore && fromLastYear ? today.year - 1 : today.year;
}

} // namespace NQ::logLines
