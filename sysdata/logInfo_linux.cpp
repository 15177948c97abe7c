#include "sysdata/logInfo_linux.h"

#include "sysdata/logInfo_parse.h"
#include "util/MyProcess.h"
#include "util/file.h"
#include "util/log.h"
#include "util/textTools.h"

#include <cstdio>
#include <cstring>

namespace NQ
{

std::string loggerLogInfo = "Veltrix.IC.MI.OsSwMI.LogInfo";

namespace
{

using logLines::lineSize;
using logLines::stampLength;

log::Unit const unit{loggerLogInfo, "logInfo_linux"};

constexpr char countCommand[] = "wc -l /var/log/messages";
constexpr char fetchCommand[] = "sed -n '%dp' /var/log/messages";

/** One line of a command's output; empty if there is none. */
void readLine(FILE* output, char (&line)[lineSize])
{
    if (!std::fgets(line, sizeof line, output))
        line[0] = '\0';
}

/** @param entry  all NUL; keeps at least one at its end */
void readEntry(logInfo& log, unsigned int index, char (&entry)[lineSize])
{
    log.getLog(log.getMaxLine() - index + 1, entry, sizeof entry - 1);
}

/** Whether the index can be read; logs if not. */
bool isReadable(logInfo& log, unsigned int index, char const* label, log::Scope const& scope)
{
    // Contract: counted once for the message, also when there will be none, and again to compare.
    unsigned int const countForMessage = log.getMaxLine();
    unsigned int const count = log.getMaxLine();
    if (count + 1 >= index)
        return true;
    scope.error("Invalid index: getMaxLine()=", countForMessage, label, index);
    return false;
}

void logInvalid(log::Scope const& scope, char const* text)
{
    scope.error("Invalid format: buffer = ", text);
}

} // namespace

logInfo::logInfo() = default;

logInfo::~logInfo() = default;

unsigned int logInfo::getMaxLine()
{
    log::Scope const scope(unit);
    MyProcess process;
    FILE* const output = process.mypopen(countCommand, "r");
    if (!output) {
        scope.error("Cannot open process: ", countCommand);
        return 0;
    }
    char line[lineSize];
    readLine(output, line);
    scope.progress("buffer = ", line);
    unsigned int count = 0;
    if (!logLines::findCount(line, count))
        logInvalid(scope, line);
    return count;
}

void logInfo::getLog(unsigned int line, char* buffer, int length)
{
    log::Scope const scope(unit);
    char command[lineSize];
    std::snprintf(command, sizeof command, fetchCommand, static_cast<int>(line));
    MyProcess process;
    FILE* const output = process.mypopen(command, "r");
    if (!output) {
        scope.error(fetchCommand); // Contract: without the number
        buffer[0] = '\0';
        return;
    }
    char text[lineSize];
    readLine(output, text);
    scope.progress("buffer = ", text);
    std::strncpy(buffer, strget(text, ' '), static_cast<std::size_t>(length));
}

bool logInfo::getData(std::string& text, unsigned int index)
{
    log::Scope const scope(unit);
    if (!isReadable(*this, index, ", Index=", scope))
        return false;
    char entry[lineSize] = "";
    readEntry(*this, index, entry);
    char const* const message = entry + stampLength + 1;
    text = std::string("*") + message + "*";
    return true;
}

bool logInfo::getCreationTime(long& time, unsigned int index)
{
    log::Scope const scope(unit);
    if (!isReadable(*this, index, ", logIndex=", scope))
        return false;
    char entry[lineSize] = "";
    readEntry(*this, index, entry);
    char stampText[stampLength + 1] = "";
    std::memcpy(stampText, entry, stampLength);
    logLines::Stamp stamp;
    if (!logLines::findStamp(stampText, stamp)) {
        logInvalid(scope, stampText);
        return false;
    }

    logLines::Today today;
    MyProcess process;
    if (FILE* const output = process.mypopen("date", "r")) {
        char line[lineSize];
        readLine(output, line);
        if (!logLines::findToday(line, today)) {
            logInvalid(scope, line);
            return false;
        }
    } else {
        scope.error("Cannot opne process: date"); // Contract: spelled so
    }
    time = to_time_t(logLines::yearOf(stamp, today), stamp.month, stamp.day, 0, stamp.hour,
                     stamp.minute, stamp.second, -1);
    return true;
}

bool logInfo::clearLog()
{
    log::Scope const scope(unit);
    files::File const log("/var/log/messages", "w");
    return log.stream() != nullptr;
}

void logInfo::strreplace(char* str, char from, char to)
{
    log::Scope const scope(unit);
    text::replaceAfterFirst(str, from, to);
}

} // namespace NQ
