#include "util/MyProcess.h"

#include "util/log.h"
#include "util/textTools.h"

#include <cstring>

namespace NQ
{

std::string loggerMyProcess = "Veltrix.IC.MI.OsSwMI.MyProcess";

namespace
{

log::Unit const unit{loggerMyProcess, "MyProcess"};

// By month number; 0 holds a name that matches no month.
char const* const monthNames[] = {"   ", "Jan", "Feb", "Mar", "Apr", "May", "Jun",
                                  "Jul", "Aug", "Sep", "Oct", "Nov", "Dec"};
constexpr int lastMonth = 12;

int monthField(char const* name)
{
    for (int month = 1; month <= lastMonth; ++month)
        if (std::strcmp(name, monthNames[month]) == 0)
            return month - 1;
    return 0;
}

} // namespace

MyProcess::MyProcess() : stream_(nullptr) {}

MyProcess::~MyProcess()
{
    if (stream_)
        pclose(stream_);
}

FILE* MyProcess::mypopen(char const* command, char const* mode)
{
    stream_ = popen(command, mode);
    return stream_;
}

char* strget(char* str, char c)
{
    log::Scope const scope(unit);
    char* start = str;
    while (*start != '\0' && *start == c)
        ++start;
    for (char* at = start; *at != '\0'; ++at)
        if (*at == '\n')
            *at = '\0';
    return start;
}

void Tokenize(std::string const& text, std::vector<std::string>& tokens,
              std::string const& delimiters)
{
    log::Scope const scope(unit);
    bool const secret = text.find("Password") != std::string::npos;
    for (std::string const& token : text::split(text, delimiters)) {
        if (!secret)
            scope.progress("str.substr(lastPos, pos - lastPos) = ", token);
        tokens.push_back(token);
    }
}

time_t to_time_t(int year, char* month, int day, int weekday, int hour, int minute, int second,
                 int isdst)
{
    log::Scope const scope(unit);
    if (year <= 1900) {
        scope.error("Invalid YY: YY = ", year);
        return 0;
    }
    std::tm fields{};
    fields.tm_year = year - 1900;
    fields.tm_mon = monthField(month);
    fields.tm_mday = day;
    fields.tm_wday = weekday;
    fields.tm_hour = hour;
    fields.tm_min = minute;
    fields.tm_sec = second;
    fields.tm_isdst = isdst;
    time_t const seconds = std::mktime(&fields);
    return seconds == -1 ? 0 : seconds;
}

time_t ito_time_t(int year, int month, int day, int weekday, int hour, int minute, int second,
                  int isdst)
{
    log::Scope const scope(unit);
    char name[4];
    std::strcpy(name, monthNames[month >= 1 && month <= lastMonth ? month : 0]);
    return to_time_t(year, name, day, weekday, hour, minute, second, isdst);
}

} // namespace NQ
