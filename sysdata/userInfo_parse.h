#ifndef SYSDATA_USERINFO_PARSE_H
#define SYSDATA_USERINFO_PARSE_H

#include "util/internal.h"

#include <string>
#include <string_view>

/** The texts that user records are read from. Nothing here does I/O or logs. */
namespace NQ
{

namespace USER_INFO
{

/** The result of searching a line. */
enum class Scan { absent, valid, invalid };

/**
 * The next line that contains "deny=", without its end; empty if there is none.
 *
 * @param rules  then starts after that line
 */
MI_INTERNAL std::string takeDenyLine(std::string_view& rules);

/**
 * Reads the number after the first "deny=" of a line of the login service's rules.
 *
 * @param deny  set only by a valid line
 */
MI_INTERNAL Scan scanDeny(std::string const& line, long& deny);

struct MI_INTERNAL LabelledDate {
    std::string month; // as "Jan"
    int day = 0;
    int year = 0;
};

/**
 * Reads a date of the form "LABEL : Mon DD, YYYY".
 *
 * Contract: the readable parts of an invalid date replace the old value, and "never" counts as a
 * date in 2038 only if a day and a year follow it.
 *
 * @param line   NUL-terminated
 * @param label  may be anywhere in a line that is not absent, at the start of a valid one
 * @param date   the date read so far
 */
MI_INTERNAL Scan scanLabelledDate(char const* line, char const* label, LabelledDate& date);

struct MI_INTERNAL CalendarDay {
    int year = 0;
    int month = 0;
    int day = 0;
};

/** Reads "YYYY-MM-DD 00:00:00"; fields that cannot be read stay 0. */
MI_INTERNAL CalendarDay scanDay(char const* text);

} // namespace USER_INFO

} // namespace NQ

#endif
