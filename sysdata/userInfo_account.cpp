// The operations on an account: deletion, ageing, and whether it is locked.

#include "sysdata/userInfo_linux.h"
#include "sysdata/userInfo_log.h"
#include "sysdata/userInfo_parse.h"
#include "util/MyProcess.h"
#include "util/file.h"
#include "util/textTools.h"

#include <cstdint>
#include <cstdio>
#include <cstring>

namespace NQ
{

namespace
{

using USER_INFO::unit;

constexpr long noLimit = 99999;
constexpr long secondsPerDay = 86400;
constexpr std::size_t commandSize = 1024;
constexpr std::size_t lineSize = 1024;
constexpr std::size_t runnerSize = 5000;

// executeLinCommand compares its address, to know that the output buffer is ours.
char passwdProgram[] = "/usr/bin/passwd";

// What error messages begin with; the command follows.
constexpr char misfit[] = "Command does not fit: ";
constexpr char noStart[] = "Cannot open process: command = ";

/** Starts a command and sees it end. @return false when it could not be started */
bool run(char const* command)
{
    MyProcess process;
    return process.mypopen(command, "r") != nullptr;
}

/**
 * The chage command that sets an age in days so that it is reached on a date.
 *
 * @param label   chage's label of the day that the age is counted from
 * @param option  chage's option for the age
 * @return false if a command line did not fit, which has been logged
 */
bool makeAgeCommand(userInfo& info, std::string const& date, std::string const& user, char* label,
                    char const* option, char (&command)[commandSize], log::Scope const& scope)
{
    USER_INFO::CalendarDay const day = USER_INFO::scanDay(date.c_str());
    long const requested = ito_time_t(day.year, day.month, day.day, 0, 0, 0, 0, -1);
    if (!text::print(command, sizeof command, "chage -l %s", user.c_str())) {
        scope.error(misfit, "chage -l");
        return false;
    }
    int const days = static_cast<int>(info.getDays(command, label, requested));
    if (!text::print(command, sizeof command, "chage %s %d %s", option, days, user.c_str())) {
        scope.error(misfit, "chage ", option);
        return false;
    }
    return true;
}

} // namespace

int userInfo::setDelete(std::string user)
{
    log::Scope const scope(unit);
    char command[commandSize];
    if (!text::print(command, sizeof command, "userdel -r %s", user.c_str()))
        scope.error(misfit, "userdel -r");
    else if (!run(command))
        scope.error(noStart, command);
    return 1;
}

bool userInfo::setInactivityTimeout(std::string date, std::string user)
{
    log::Scope const scope(unit);
    char label[] = "Password expires";
    char command[commandSize];
    if (!makeAgeCommand(*this, date, user, label, "-I", command, scope))
        return false;
    bool const started = run(command);
    if (!started)
        scope.error(noStart, command);
    return started;
}

bool userInfo::setPasswordExpiration(std::string date, std::string user)
{
    log::Scope const scope(unit);
    char label[] = "Last password change";
    char command[commandSize];
    if (!makeAgeCommand(*this, date, user, label, "-M", command, scope))
        return false;
    bool const started = run(command);
    if (!started)
        scope.error("Cannot open process: chage -M");
    return started;
}

long userInfo::getDays(char* command, char* label, long reference)
{
    log::Scope const scope(unit);
    MyProcess process;
    FILE* const output = process.mypopen(command, "r");
    if (!output) {
        scope.error(noStart, command);
        return noLimit;
    }
    USER_INFO::LabelledDate date;
    char line[lineSize];
    while (std::fgets(line, sizeof line, output))
        if (USER_INFO::scanLabelledDate(line, label, date) == USER_INFO::Scan::invalid)
            scope.error("Invalid format: buffer = ", line);

    long const found = to_time_t(date.year, date.month.data(), date.day, 0, 0, 0, 0, -1);
    if (found <= reference)
        return (reference - found) / secondsPerDay;
    scope.error("new_day < last_day");
    return noLimit;
}

bool userInfo::findIsAcctDisabled(char* user)
{
    log::Scope const scope(unit);
    bool const suseStyle =
        files::canOpen("/etc/SuSE-release") || files::canOpen("/etc/UnitedLinux-release");
    char const* const args[] = {passwdProgram, "-S", user, ""};
    char output[runnerSize] = "";
    if (!executeLinCommand(passwdProgram, args, output))
        return false;
    if (!suseStyle)
        return std::strstr(output, "Password locked") || std::strstr(output, "Locked password");
    std::string const locked = std::string(user) + " LK";
    return std::strncmp(output, locked.c_str(), locked.size()) == 0;
}

bool userInfo::executeLinCommand(char* command, char const* const* args, char* output)
{
    log::Scope const scope(unit);
    output[0] = '\0';
    std::string line = command;
    for (char const* const* arg = args + 1; **arg != '\0'; ++arg)
        line.append(" ").append(*arg);
    line += " 2>&1";
    if (line.size() >= runnerSize) {
        scope.error(misfit, command);
        return false;
    }
    FILE* const pipe = popen(line.c_str(), "r");
    if (!pipe) {
        // The line itself may contain secrets.
        scope.error("Cannot open process: ", command);
        return false;
    }
    // Contract: no bound is passed, so other callers' buffers count as large enough.
    std::size_t const size = command == passwdProgram ? runnerSize : SIZE_MAX;
    bool const any = files::readToEnd(pipe, output, size);
    pclose(pipe);
    return any;
}

} // namespace NQ
