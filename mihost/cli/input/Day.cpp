#include "mihost/cli/input/Day.h"

#include <ctime>
#include <fmt/format.h>

namespace mihost
{

namespace
{

constexpr int firstYear = 1901; // the plug-in treats years before it as none
constexpr int lastYear = 9999;
constexpr std::size_t dayLength = 10;
constexpr long secondsPerDay = 24L * 60 * 60;

/** Whether the text matches the pattern, in which 0 means any digit. */
bool looksLike(std::string_view text, std::string_view pattern)
{
    if (text.size() != pattern.size())
        return false;
    for (std::size_t at = 0; at < text.size(); ++at) {
        bool const digit = text[at] >= '0' && text[at] <= '9';
        if (pattern[at] == '0' ? !digit : text[at] != pattern[at])
            return false;
    }
    return true;
}

std::optional<std::tm> parsed(std::string const& text, char const* format)
{
    std::tm fields{};
    fields.tm_isdst = -1;
    char const* const end = strptime(text.c_str(), format, &fields);
    return end && *end == '\0' ? std::optional(fields) : std::nullopt;
}

std::tm fieldsOf(Day const& day)
{
    std::tm fields{};
    fields.tm_year = day.year - 1900;
    fields.tm_mon = day.month - 1;
    fields.tm_mday = day.day;
    return fields;
}

Day dayOf(std::tm const& fields)
{
    return {fields.tm_year + 1900, fields.tm_mon + 1, fields.tm_mday};
}

bool isSame(Day const& one, Day const& other)
{
    return one.year == other.year && one.month == other.month && one.day == other.day;
}

/** @param digits  YYYYMMDD */
std::optional<Day> dayOfCalendar(std::string const& digits)
{
    auto const fields = parsed(digits, "%Y%m%d");
    if (!fields)
        return std::nullopt;
    Day const day = dayOf(*fields);
    // strptime accepts February 31.
    auto const same = dayOfNumber(dayNumber(day));
    return same && isSame(*same, day) ? same : std::nullopt;
}

} // namespace

std::optional<Day> parseDay(std::string_view text)
{
    if (!looksLike(text, "0000-00-00"))
        return std::nullopt;
    return dayOfCalendar(
        fmt::format("{}{}{}", text.substr(0, 4), text.substr(5, 2), text.substr(8)));
}

std::optional<Day> parseDateTime(std::string_view text)
{
    if (!looksLike(text, "00000000000000.000000+000") &&
        !looksLike(text, "00000000000000.000000-000"))
        return std::nullopt;
    return dayOfCalendar(std::string(text.substr(0, 8)));
}

std::string dateTimeText(Day const& day)
{
    return fmt::format("{:04}{:02}{:02}000000.000000+000", day.year, day.month, day.day);
}

std::string dayText(Day const& day)
{
    return fmt::format("{:04}-{:02}-{:02}", day.year, day.month, day.day);
}

long dayNumber(Day const& day)
{
    std::tm fields = fieldsOf(day);
    return timegm(&fields) / secondsPerDay;
}

std::optional<Day> dayOfNumber(long number)
{
    if (number < dayNumber({firstYear, 1, 1}) || number > dayNumber({lastYear, 12, 31}))
        return std::nullopt;
    std::time_t const time = number * secondsPerDay;
    std::tm fields{};
    return dayOf(*gmtime_r(&time, &fields));
}

std::optional<long> parseTime(std::string_view text)
{
    if (!looksLike(text, "0000-00-00") && !looksLike(text, "0000-00-00 00:00:00"))
        return std::nullopt;
    auto const day = parseDay(text.substr(0, dayLength));
    bool const hasTime = text.size() > dayLength;
    auto fields = parsed(std::string(text), hasTime ? "%Y-%m-%d %H:%M:%S" : "%Y-%m-%d");
    if (!day || !fields || fields->tm_sec > 59)
        return std::nullopt;
    return std::mktime(&*fields);
}

std::string timeText(long seconds)
{
    std::time_t const time = seconds;
    std::tm fields{};
    char text[sizeof "YYYY-MM-DD HH:MM:SS"];
    bool const fits = localtime_r(&time, &fields) &&
                      std::strftime(text, sizeof text, "%Y-%m-%d %H:%M:%S", &fields) != 0;
    return fits ? text : "";
}

} // namespace mihost
