#include "mihost/cli/Diagnosis.h"

#include "mihost/cli/AccountFiles.h"
#include "mihost/cli/CommandTap.h"
#include "mihost/cli/Lines.h"

#include <algorithm>
#include <cctype>
#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <deque>
#include <fmt/format.h>
#include <fmt/ranges.h>
#include <fstream>
#include <set>
#include <sstream>
#include <sys/utsname.h>
#include <unistd.h>

namespace mihost
{

namespace
{

using Problem = std::optional<std::string>;

constexpr char accountFile[] = "/etc/passwd";
constexpr char logFile[] = "/var/log/messages";
constexpr std::size_t longestAccountLine = 4094; // with its end and a NUL it fills the buffer
constexpr std::size_t newestLines = 50;

std::vector<std::string> namesIn(std::string const& path)
{
    std::vector<std::string> names;
    for (std::string const& line : linesOf(contentOf(path)))
        names.push_back(line.substr(0, line.find(':')));
    return names;
}

std::vector<std::string> newestLogLines()
{
    std::ifstream file(logFile);
    std::deque<std::string> newest;
    for (std::string line; std::getline(file, line);) {
        newest.push_back(line);
        if (newest.size() > newestLines)
            newest.pop_front();
    }
    return {newest.begin(), newest.end()};
}

Problem accessProblem(std::string const& path, int mode)
{
    if (access(path.c_str(), mode) == 0)
        return std::nullopt;
    return std::strerror(errno);
}

Problem commandProblem(std::string const& command)
{
    if (command[0] == '/')
        return accessProblem(command, X_OK);
    char const* const path = std::getenv("PATH");
    std::istringstream folders(path ? path : "/usr/local/sbin:/usr/local/bin:/usr/sbin:/usr/bin");
    for (std::string folder; std::getline(folders, folder, ':');)
        if (!accessProblem(folder + "/" + command, X_OK))
            return std::nullopt;
    return "not found in PATH";
}

struct CommandNeed {
    char const* command;
    char const* cost;
    char const* debian; // package
    char const* redHat; // package
};

// clang-format off
constexpr CommandNeed commandNeeds[] = {
    {"/bin/sh", "everything that is learnt or changed by a command", "dash", "bash"},
    {"lsmod", "all drivers", "kmod", "kmod"},
    {"modinfo", "versions and descriptions of drivers", "kmod", "kmod"},
    {"wc", "all log entries", "coreutils", "coreutils"},
    {"sed", "messages and times of log entries", "sed", "sed"},
    {"date", "times of log entries", "coreutils", "coreutils"},
    {"stat", "install-date of os", "coreutils", "coreutils"},
    {"grep", "install-date of os", "grep", "grep"},
    {"cat", "os-version of os", "coreutils", "coreutils"},
    {"tr", "os-version of os", "coreutils", "coreutils"},
    {"cut", "os-version of os", "coreutils", "coreutils"},
    {"chage", "writing inactive-time and password-expiration of users", "passwd", "shadow-utils"},
    {"chpasswd", "writing password of users", "passwd", "shadow-utils"},
    {"rm", "writing password of users: a file with the hash stays", "coreutils", "coreutils"},
    {"userdel", "writing delete of users", "passwd", "shadow-utils"},
    {"/usr/sbin/useradd", "the method UserAdd", "passwd", "shadow-utils"},
    {"/usr/sbin/userdel", "the method UserDel", "passwd", "shadow-utils"},
    {"/usr/sbin/usermod", "the methods that change users and memberships", "passwd", "shadow-utils"},
    {"/usr/sbin/groupadd", "the method LocalGroupAdd", "passwd", "shadow-utils"},
    {"/usr/sbin/groupdel", "the method LocalGroupDel", "passwd", "shadow-utils"},
    {"/usr/bin/chage", "the methods UserAdd and UserSetAttrib", "passwd", "shadow-utils"},
    {"/usr/bin/passwd", "passwords in methods", "passwd", "passwd"},
    {"/usr/bin/id", "the methods LocalGroupAddUser and LocalGroupDelUser", "coreutils", "coreutils"},
    {"/sbin/shutdown", "restart and halt", "systemd-sysv", "systemd"},
};
// clang-format on

Need needOf(CommandNeed const& row)
{
    return {fmt::format("command {}", row.command), commandProblem(row.command), row.cost,
            fmt::format("apt-get install {}", row.debian),
            fmt::format("dnf install {}", row.redHat)};
}

/** Whether passwd takes a password from a pipe; it does not on every distribution. */
Problem passwordPipeProblem()
{
    std::string const program = "/usr/bin/passwd";
    if (auto const problem = commandProblem(program))
        return problem;
    if (commandTap::outputOf("LC_ALL=C " + program + " --help 2>&1").find("--stdin") !=
        std::string::npos)
        return std::nullopt;
    return "passwd does not know it";
}

Problem releaseProblem()
{
    static constexpr char const* files[] = {"/etc/release", "/etc/vmware-release",
                                            "/etc/redhat-release", "/etc/SuSE-release",
                                            "/etc/UnitedLinux-release"};
    for (char const* file : files)
        if (!accessProblem(file, R_OK))
            return std::nullopt;
    return "none of the files that are known";
}

Problem logWriteProblem()
{
    if (accessProblem(logFile, F_OK))
        return std::nullopt; // told of on its own
    return accessProblem(logFile, W_OK);
}

Problem moduleFilesProblem()
{
    if (linesOf(contentOf("/proc/modules")).empty())
        return std::nullopt; // none is loaded
    utsname system{};
    if (uname(&system) != 0)
        return "the kernel does not tell its release";
    return accessProblem(fmt::format("/lib/modules/{}", system.release), R_OK);
}

Problem localeProblem()
{
    char const* const language = std::getenv("LANG");
    if (language && *language)
        return std::nullopt;
    return "LANG is not set";
}

Problem rootProblem()
{
    if (geteuid() == 0)
        return std::nullopt;
    return "not run as root";
}

Problem shadowOrderProblem()
{
    if (accessProblem(shadowFile, R_OK))
        return std::nullopt; // told of on its own
    return problemOfShadowOrder(namesIn(accountFile), namesIn(shadowFile));
}

Problem rangesProblem()
{
    auto const unreadable = accessProblem("/etc/login.defs", R_OK);
    return unreadable ? unreadable : problemOfRanges(contentOf("/etc/login.defs"));
}

bool isStamp(std::string const& line)
{
    static std::set<std::string> const months = {"Jan", "Feb", "Mar", "Apr", "May", "Jun",
                                                 "Jul", "Aug", "Sep", "Oct", "Nov", "Dec"};
    constexpr std::string_view pattern = "... dd dd:dd:dd "; // d a digit, the day's first one may
    if (line.size() < pattern.size())                        // be a blank
        return false;
    for (std::size_t at = 0; at < pattern.size(); ++at) {
        bool const isDigit = std::isdigit(static_cast<unsigned char>(line[at])) != 0;
        bool const fits = pattern[at] == '.' || (pattern[at] == 'd' && isDigit) ||
                          (at == 4 && line[at] == ' ') || pattern[at] == line[at];
        if (!fits)
            return false;
    }
    return months.count(line.substr(0, 3)) != 0;
}

bool isAccount(std::string const& line)
{
    std::vector<std::string> fields(1);
    for (char const character : line) {
        if (character == ':')
            fields.emplace_back();
        else
            fields.back() += character;
    }
    auto const isNumber = [](std::string const& field) {
        return !field.empty() && field.find_first_not_of("0123456789") == std::string::npos;
    };
    return fields.size() == 7 && !fields[0].empty() && isNumber(fields[2]) && isNumber(fields[3]);
}

} // namespace

std::optional<std::string> problemOfRanges(std::string const& text)
{
    std::vector<std::string> missing;
    for (std::string const key : {"UID_MIN", "UID_MAX", "GID_MIN", "GID_MAX"}) {
        auto const lines = linesOf(text);
        if (std::none_of(lines.begin(), lines.end(), [&key](std::string const& line) {
                return line.compare(0, key.size(), key) == 0;
            }))
            missing.push_back(key);
    }
    if (missing.empty())
        return std::nullopt;
    return fmt::format("no line begins with {}", fmt::join(missing, ", "));
}

std::optional<std::string> problemOfAccounts(std::string const& text)
{
    auto const lines = linesOf(text);
    for (std::size_t at = 0; at < lines.size(); ++at) {
        std::string const& line = lines[at];
        if (line.size() > longestAccountLine)
            return fmt::format("line {} is longer than {} bytes", at + 1, longestAccountLine);
        bool const isSkipped = line.find_first_not_of(" \t") == std::string::npos || line[0] == '#';
        if (!isSkipped && !isAccount(line))
            return fmt::format("line {} is malformed", at + 1);
    }
    return std::nullopt;
}

std::optional<std::string> problemOfShadowOrder(std::vector<std::string> const& accounts,
                                                std::vector<std::string> const& shadow)
{
    auto entry = shadow.begin();
    for (std::string const& account : accounts) {
        auto const found = std::find(entry, shadow.end(), account);
        if (found == shadow.end())
            return fmt::format("'{}' does not stand there in the order of {}", account,
                               accountFile);
        entry = found + 1;
    }
    return std::nullopt;
}

std::optional<std::string> problemOfStamps(std::vector<std::string> const& lines)
{
    auto const other = std::find_if(lines.rbegin(), lines.rend(),
                                    [](std::string const& line) { return !isStamp(line); });
    if (other == lines.rend())
        return std::nullopt;
    return fmt::format("a line begins with '{}' rather than a stamp like 'Jan  2 03:04:05 '",
                       other->substr(0, 16));
}

std::vector<Need> diagnose()
{
    std::vector<Need> needs = {
        {"root's privileges", rootProblem(), "passwords and ageing of users, every change",
         "sudo mihost", "sudo mihost"},
        {"locale in LANG", localeProblem(), "language-edition and code-set of os",
         "update-locale LANG=C.UTF-8", "localectl set-locale LANG=C.UTF-8"},
    };
    for (CommandNeed const& row : commandNeeds)
        needs.push_back(needOf(row));
    char const* const rsyslog = "apt-get install rsyslog; echo "
                                "'*.info;authpriv.none -/var/log/messages;"
                                "RSYSLOG_TraditionalFileFormat' >/etc/rsyslog.d/messages.conf; "
                                "systemctl restart rsyslog";
    char const* const traditional =
        "echo '$ActionFileDefaultTemplate RSYSLOG_TraditionalFileFormat' "
        ">/etc/rsyslog.d/00-stamp.conf; systemctl restart rsyslog";
    std::vector<Need> const files = {
        {"passwd --stdin", passwordPipeProblem(),
         "Password in methods: it is stored as it is and opens nothing",
         "set passwords with passwd", "dnf install passwd"},
        {"accounts in /etc/passwd", accessProblem(accountFile, R_OK), "all users",
         "cp /usr/share/base-passwd/passwd.master /etc/passwd", "dnf reinstall setup"},
        {"form of /etc/passwd", problemOfAccounts(contentOf(accountFile)),
         "the users from that line on", "vipw", "vipw"},
        {"passwords in /etc/shadow", accessProblem(shadowFile, R_OK),
         "passwords and ageing of users", "sudo mihost, or pwconv", "sudo mihost, or pwconv"},
        {"order of /etc/shadow", shadowOrderProblem(),
         "passwords and ageing of that user and all behind it", "pwck -s", "pwck -s"},
        {"groups in /etc/group", accessProblem("/etc/group", R_OK), "all groups",
         "cp /usr/share/base-passwd/group.master /etc/group", "dnf reinstall setup"},
        {"id ranges in /etc/login.defs", rangesProblem(), "ordinary users, ordinary groups",
         "apt-get install --reinstall -o Dpkg::Options::=--force-confmiss login",
         "dnf reinstall shadow-utils"},
        {"login failures in /etc/pam.d/login", accessProblem("/etc/pam.d/login", R_OK),
         "max-login-failures of users",
         "apt-get install --reinstall -o Dpkg::Options::=--force-confmiss login",
         "dnf reinstall util-linux"},
        {"release file", releaseProblem(), "os-name, os-version and install-date of os",
         "(. /etc/os-release; printf '%s\\nVERSION = %s\\nPATCHLEVEL = 0\\n' \"$PRETTY_NAME\" "
         "\"$VERSION_ID\") >/etc/release",
         "dnf install system-release"},
        {"module files of the kernel", moduleFilesProblem(), "versions and descriptions of drivers",
         "apt-get install linux-image-$(uname -r)", "dnf install kernel-modules-$(uname -r)"},
        {"system log in /var/log/messages", accessProblem(logFile, R_OK), "all log entries",
         rsyslog, "dnf install rsyslog; systemctl enable --now rsyslog"},
        {"classic stamps in the system log", problemOfStamps(newestLogLines()),
         "messages and times of log entries", traditional, traditional},
        {"leave to empty the system log", logWriteProblem(), "clear-log", "sudo mihost",
         "sudo mihost"},
    };
    needs.insert(needs.end(), files.begin(), files.end());
    return needs;
}

} // namespace mihost
