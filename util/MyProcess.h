#ifndef UTIL_MYPROCESS_H
#define UTIL_MYPROCESS_H

#include <cstdio>
#include <ctime>
#include <string>
#include <vector>

namespace NQ
{

/** Logger category of this source unit. */
extern std::string loggerMyProcess;

/**
 * One read pipe to a shell command, closed by the destructor. Logs nothing.
 *
 * Holders of the object never close the stream themselves. No exit status is ever read.
 */
class MyProcess
{
public:
    MyProcess();
    ~MyProcess();
    MyProcess(MyProcess const&) = delete;
    MyProcess& operator=(MyProcess const&) = delete;

    /**
     * Starts a command. A second start on the same object loses the first stream unclosed.
     *
     * @param command  shell command line
     * @param mode     popen mode, always "r" here
     * @return the stream, owned by this object, or null if the command could not be started
     */
    FILE* mypopen(char const* command, char const* mode);

private:
    FILE* stream_;
};

/**
 * The value part of an output line: skips leading characters equal to c and overwrites every
 * newline after them with NUL.
 *
 * @param str  writable, not null; changed in place
 * @return a pointer into str
 */
char* strget(char* str, char c);

/**
 * Appends every maximal run of characters of the text that holds no delimiter. The list is not
 * cleared. The tokens of a text that holds "Password" anywhere are not logged.
 */
void Tokenize(std::string const& text, std::vector<std::string>& tokens,
              std::string const& delimiters);

/**
 * Calendar fields to seconds since 1970, read as local time; fields out of range are carried over.
 *
 * @param year     full year, 1901 or later
 * @param month    "Jan" to "Dec", exactly; anything else counts as January
 * @param weekday  has no effect
 * @param isdst    daylight saving: positive yes, 0 no, negative for the system to decide
 * @return 0 on failure
 */
time_t to_time_t(int year, char* month, int day, int weekday, int hour, int minute, int second,
                 int isdst);

/** As to_time_t, with the month as a number; one outside 1 to 12 counts as January. */
time_t ito_time_t(int year, int month, int day, int weekday, int hour, int minute, int second,
                  int isdst);

} // namespace NQ

#endif
