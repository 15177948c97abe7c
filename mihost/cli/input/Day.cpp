#include "mihost/cli/input/Day.h"

#include <algorithm>
#include <charconv>
#include <ctime>
#include <fmt/format.h>

namespace mihost
{

namespace
{

constexpr int firstYear = 1901; // years before it the plug-in takes for none
constexpr int lastYear = 9999;
constexpr std::size_t dayLength = 10;
constexpr long dayOf1970 = 719468; // counted from March 1 of year 0

/** Whether the text looks like the pattern, where 0 stands for any digit. */
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

/** The digits from here on; the caller has looked at them. */
int number(std::string_view text, std::size_t at, std::size_t length)
{
    int value = 0;
    std::from_chars(text.data() + at, text.data() + at + length, value);
    return value;
}

int daysIn(int month, int year)
{
    static constexpr int days[] = {31, 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
    bool const leap = year % 4 == 0 && (year % 100 != 0 || year % 400 == 0);
    return month == 2 && leap ? 29 : days[month - 1];
}

std::optional<Day> dayOfCalendar(Day const& day)
{
    if (day.year < firstYear || day.year > lastYear || day.month < 1 || day.month > 12 ||
        day.day < 1 || day.day > daysIn(day.month, day.year))
        return std::nullopt;
    return day;
}

} // namespace

std::optional<Day> parseDay(std::string_view text)
{
    if (!looksLike(text, "0000-00-00"))
        return std::nullopt;
    return dayOfCalendar({number(text, 0, 4), number(text, 5, 2), number(text, 8, 2)});
}

std::optional<Day> parseDateTime(std::string_view text)
{
    if (!looksLike(text, "00000000000000.000000+000") &&
        !looksLike(text, "00000000000000.000000-000"))
        return std::nullopt;
    return dayOfCalendar({number(text, 0, 4), number(text, 4, 2), number(text, 6, 2)});
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
    // Years begin in March here, so that the day that comes and goes is their last.
    int const year = day.month > 2 ? day.year : day.year - 1;
    int const month = day.month > 2 ? day.month - 3 : day.month + 9;
    int const dayOfYear = (153 * month + 2) / 5 + day.day - 1;
    return 365L * year + year / 4 - year / 100 + year / 400 + dayOfYear - dayOf1970;
}

std::optional<Day> dayOfNumber(long number)
{
    if (number < dayNumber({firstYear, 1, 1}) || number > dayNumber({lastYear, 12, 31}))
        return std::nullopt;
    int year = static_cast<int>(1970 + number / 366); // at most a few years early or late
    while (dayNumber({year, 1, 1}) > number)
        --year;
    while (dayNumber({year + 1, 1, 1}) <= number)
        ++year;
    int month = 12;
    while (dayNumber({year, month, 1}) > number)
        --month;
    return Day{year, month, static_cast<int>(number - dayNumber({year, month, 1})) + 1};
}

std::optional<long> parseTime(std::string_view text)
{
    auto const day = parseDay(text.substr(0, dayLength));
    std::string_view const time = text.substr(std::min(text.size(), dayLength));
    if (!day || (!time.empty() && !looksLike(time, " 00:00:00")))
        return std::nullopt;
    std::tm fields{};
    fields.tm_year = day->year - 1900;
    fields.tm_mon = day->month - 1;
    fields.tm_mday = day->day;
    fields.tm_isdst = -1;
    if (!time.empty()) {
        fields.tm_hour = number(time, 1, 2);
        fields.tm_min = number(time, 4, 2);
        fields.tm_sec = number(time, 7, 2);
    }
    if (fields.tm_hour > 23 || fields.tm_min > 59 || fields.tm_sec > 59)
        return std::nullopt;
    return std::mktime(&fields);
}

} // namespace mihost
