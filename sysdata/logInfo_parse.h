#ifndef SYSDATA_LOGINFO_PARSE_H
#define SYSDATA_LOGINFO_PARSE_H

#include "util/internal.h"

#include <cstddef>

namespace NQ
{

/** Parsers for the log's lines and for command output. Not part of the plug-in's interface. */
namespace MI_INTERNAL logLines
{

/** Room for one line and its NUL; what does not fit is left unread. */
constexpr std::size_t lineSize = 512;

/** Characters of a time stamp such as "Jan  2 03:04:05"; one space follows it. */
constexpr std::size_t stampLength = 15;

/** A log line's time stamp, which names no year. */
struct Stamp {
    char month[stampLength + 1] = "";
    int day = 0;
    int hour = 0;
    int minute = 0;
    int second = 0;
};

/** The current year and month, as the command date names them. */
struct Today {
    int year = 0;
    char month[lineSize] = "";
};

/** The number that a line of wc begins with. @return false if there is none */
bool findCount(char const* line, unsigned int& count);

/** @return false unless the text begins with a time stamp */
bool findStamp(char const* text, Stamp& stamp);

/** @param line  weekday, month, day, time, zone and year. @return false for any other form */
bool findToday(char const* line, Today& today);

/** The current year; the one before for an entry of December that is read in January. */
int yearOf(Stamp const& stamp, Today const& today);

} // namespace logLines

} // namespace NQ

#endif
