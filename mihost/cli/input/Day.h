#ifndef MIHOST_CLI_INPUT_DAY_H
#define MIHOST_CLI_INPUT_DAY_H

#include <optional>
#include <string>
#include <string_view>

namespace mihost
{

struct Day {
    int year;
    int month;
    int day;
};

constexpr char dayForm[] = "YYYY-MM-DD, such as 2030-12-31";
constexpr char dateTimeForm[] = "YYYYMMDDhhmmss.ffffff+OOO or -OOO, digits throughout";
constexpr char timeForm[] = "YYYY-MM-DD or \"YYYY-MM-DD HH:MM:SS\", in local time";

/** A day of the calendar as YYYY-MM-DD, of a year that the plug-in can convert. */
std::optional<Day> parseDay(std::string_view text);

/** The day of a date-time as method-call texts hold it. The plug-in uses nothing else of it. */
std::optional<Day> parseDateTime(std::string_view text);

/** The day as such a date-time. */
std::string dateTimeText(Day const& day);

/** The day as YYYY-MM-DD. */
std::string dayText(Day const& day);

/** Days since 1970, as the shadow file counts. */
long dayNumber(Day const& day);

/** The day of such a number; nothing if its year cannot be written. */
std::optional<Day> dayOfNumber(long number);

/** Seconds since 1970 of a point in local time, written as timeForm says. */
std::optional<long> parseTime(std::string_view text);

/** Such a point as "YYYY-MM-DD HH:MM:SS"; empty if its year cannot be written. */
std::string timeText(long seconds);

} // namespace mihost

#endif
