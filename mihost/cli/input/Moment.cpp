#include "mihost/cli/input/Moment.h"

#include "mihost/cli/input/Day.h"

#include <algorithm>
#include <ctime>
#include <sstream>

namespace mihost
{

namespace
{

struct Unit {
    char const* name;
    long seconds;
};

constexpr Unit units[] = {
    {"second", 1}, {"minute", 60}, {"hour", 3600}, {"day", 86400}, {"week", 604800},
};

/** Midnight before now, in local time. */
long midnight(long now, int daysBefore)
{
    std::time_t const time = now;
    std::tm fields{};
    localtime_r(&time, &fields);
    std::tm day{};
    day.tm_year = fields.tm_year;
    day.tm_mon = fields.tm_mon;
    day.tm_mday = fields.tm_mday - daysBefore;
    day.tm_isdst = -1;
    return std::mktime(&day);
}

/** "5 minutes ago" */
std::optional<long> parseAgo(std::string const& text, long now)
{
    constexpr long long most = 1'000'000;
    std::istringstream words(text);
    long long count = 0;
    std::string unit;
    std::string ago;
    std::string more;
    if (!(words >> count >> unit >> ago) || ago != "ago" || words >> more || count < 0 ||
        count > most)
        return std::nullopt;
    for (Unit const& each : units)
        if (unit == each.name || unit == std::string(each.name) + 's')
            return static_cast<long>(std::max(now - count * each.seconds, 0LL));
    return std::nullopt;
}

} // namespace

std::optional<long> parseMoment(std::string const& text, long now)
{
    if (text == "now")
        return now;
    if (text == "today")
        return midnight(now, 0);
    if (text == "yesterday")
        return midnight(now, 1);
    if (auto const ago = parseAgo(text, now))
        return ago;
    return parseTime(text);
}

} // namespace mihost
