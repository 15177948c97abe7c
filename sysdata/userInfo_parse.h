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

/** What a line has to say about what is looked for in it. */
enum class Scan { absent, valid, invalid };

/**
 * The next line that holds "deny=", without its end; empty where there is none.
 *
 * @param rules  what follows that line from now on
 */
MI_INTERNAL std::string takeDenyLine(std::string_view& rules);

/**
 * Reads the number behind the first "deny=" of a line of the login service's rules.
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
 * Contract: what could be read of an invalid date replaces what stood in its place, and "never"
 * counts as a date in 2038 only where a day and a year follow it.
 *
 * @param line   NUL-terminated
 * @param label  may stand anywhere in a line that is not absent, and at its start in a valid one
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
