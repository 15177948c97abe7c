#include "mihost/cli/doctor/Diagnosis.h"

#include "host/Properties.h"
#include "mihost/cli/accounts/AccountFiles.h"
#include "mihost/cli/accounts/LocalNames.h"
#include "mihost/cli/accounts/LoginDefs.h"
#include "mihost/cli/change/PasswordHash.h"
#include "mihost/cli/doctor/FileChecks.h"
#include "mihost/cli/log/LogFile.h"
#include "mihost/cli/log/LogLine.h"
#include "mihost/cli/plugin/CommandTap.h"
#include "mihost/cli/system/Privilege.h"
#include "mihost/cli/system/TextFile.h"

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <fmt/format.h>
#include <sstream>
#include <sys/utsname.h>
#include <unistd.h>

namespace mihost
{

namespace
{

constexpr char releaseFile[] = "/etc/release";

/** Checks the effective rights of this process, not those of its user. */
Problem accessProblem(std::string const& path, int mode = R_OK)
{
    if (faccessat(AT_FDCWD, path.c_str(), mode, AT_EACCESS) == 0)
        return std::nullopt;
    return std::strerror(errno);
}

bool isThere(std::string const& path)
{
    return !accessProblem(path);
}

/** The same command on every system. */
Fix everywhere(std::string const& command)
{
    return {command, command, command};
}

// Commands.

struct CommandNeed {
    char const* command;
    char const* effect;
    // The packages that have it.
    char const* debian;
    char const* redHat;
    char const* opensuse;
};

constexpr CommandNeed commandNeeds[] = {
    {"/bin/sh", "everything read or changed by a command", "dash", "bash", "bash"},
    {"lsmod", "all drivers", "kmod", "kmod", "kmod"},
    {"modinfo", "versions and descriptions of drivers", "kmod", "kmod", "kmod"},
    {"wc", "all log entries", "coreutils", "coreutils", "coreutils"},
    {"sed", "messages and times of log entries", "sed", "sed", "sed"},
    {"date", "times of log entries", "coreutils", "coreutils", "coreutils"},
    {"stat", "install-date of os", "coreutils", "coreutils", "coreutils"},
    {"grep", "install-date of os", "grep", "grep", "grep"},
    {"cat", "os-version of os", "coreutils", "coreutils", "coreutils"},
    {"tr", "os-version of os", "coreutils", "coreutils", "coreutils"},
    {"cut", "os-version of os", "coreutils", "coreutils", "coreutils"},
    {"chage", "writing inactive-time and password-expiration of users", "passwd", "shadow-utils",
     "shadow"},
    {"chpasswd", "writing password of users", "passwd", "shadow-utils", "shadow"},
    {"rm", "writing password of users: the file with the hash is not removed", "coreutils",
     "coreutils", "coreutils"},
    {"userdel", "writing delete of users", "passwd", "shadow-utils", "shadow"},
    {"/usr/sbin/useradd", "the method UserAdd", "passwd", "shadow-utils", "shadow"},
    {"/usr/sbin/userdel", "the method UserDel", "passwd", "shadow-utils", "shadow"},
    {"/usr/sbin/usermod", "the methods that change users and memberships", "passwd", "shadow-utils",
     "shadow"},
    {"/usr/sbin/groupadd", "the method LocalGroupAdd", "passwd", "shadow-utils", "shadow"},
    {"/usr/sbin/groupdel", "the method LocalGroupDel", "passwd", "shadow-utils", "shadow"},
    {"/usr/bin/chage", "the methods UserAdd and UserSetAttrib", "passwd", "shadow-utils", "shadow"},
    {"/usr/bin/passwd", "passwords in methods", "passwd", "passwd", "shadow"},
    {"/usr/bin/id", "the methods LocalGroupAddUser and LocalGroupDelUser", "coreutils", "coreutils",
     "coreutils"},
    {"/sbin/shutdown", "restart and halt", "systemd-sysv", "systemd", "systemd-sysvinit"},
};

/** The first of the directories that has the command; empty for none. */
std::string folderOf(std::string const& command, std::string const& path)
{
    std::istringstream folders(path);
    for (std::string folder; std::getline(folders, folder, ':');)
        if (!accessProblem(fmt::format("{}/{}", folder, command), X_OK))
            return folder;
    return "";
}

/** A command that is looked for through PATH, which for ordinary users is often too short. */
Need needOfPath(CommandNeed const& row, Need need)
{
    std::string const usual = "/usr/local/sbin:/usr/local/bin:/usr/sbin:/usr/bin:/sbin:/bin";
    char const* const path = std::getenv("PATH");
    if (!folderOf(row.command, path ? path : usual).empty())
        return need;
    need.problem = "not found in PATH";
    if (std::string const folder = folderOf(row.command, usual); !folder.empty())
        need.fix = everywhere(fmt::format("PATH=$PATH:{} mihost", folder));
    return need;
}

Need needOf(CommandNeed const& row)
{
    Need need{fmt::format("command {}", row.command),
              std::nullopt,
              row.effect,
              {fmt::format("apt-get install {}", row.debian),
               fmt::format("dnf install {}", row.redHat),
               fmt::format("zypper install {}", row.opensuse)},
              ""};
    if (row.command[0] != '/')
        return needOfPath(row, need);
    need.problem = accessProblem(row.command, X_OK);
    return need;
}

/** Whether packages of Red Hat and similar systems can be installed. */
bool hasRedHatPackages()
{
    return isThere("/usr/bin/dnf") || isThere("/usr/bin/yum");
}

/** Fixed by a package of Red Hat and similar systems only. */
Need redHatNeed(std::string const& what, Problem const& problem, std::string const& effect,
                std::string const& redHat, std::string const& noFix)
{
    return {what, problem, effect, {"", redHat, ""}, hasRedHatPackages() ? "" : noFix};
}

/** If this file exists, UserAdd passes an option that newer versions of useradd lack. */
std::vector<Need> groupOption()
{
    if (!isThere("/etc/redhat-release"))
        return {};
    std::string const said = commandTap::outputOf("LC_ALL=C /usr/sbin/useradd -n 2>&1");
    bool const isUnknown = said.find("invalid option") != std::string::npos;
    return {{"useradd -n",
             isUnknown ? Problem("not supported by useradd") : std::nullopt,
             "the method UserAdd",
             {},
             "the useradd of this system has no such option: add accounts with useradd itself"}};
}

// Surroundings.

struct CapabilityNeed {
    cap_value_t capability;
    char const* name;
    char const* effect;
};

constexpr CapabilityNeed capabilityNeeds[] = {
    {CAP_SYS_ADMIN, "CAP_SYS_ADMIN", "--sandbox and --overlay"},
    {CAP_DAC_OVERRIDE, "CAP_DAC_OVERRIDE", "passwords and ageing of users, every change"},
    {CAP_CHOWN, "CAP_CHOWN", "every change of accounts and groups"},
};

/** Root lacks some in containers and in restricted services. */
std::vector<Need> capabilities()
{
    std::vector<Need> needs;
    for (CapabilityNeed const& row : capabilityNeeds)
        needs.push_back(
            {fmt::format("capability {}", row.name),
             hasCapability(row.capability) ? std::nullopt : Problem("root lacks it"),
             row.effect,
             {},
             "no process can gain it: grant it where this container or service is started"});
    return needs;
}

std::vector<Need> surroundings()
{
    char const* const language = std::getenv("LANG");
    bool const isRoot = geteuid() == 0;
    std::string const localectl = "localectl set-locale LANG=C.UTF-8";
    std::vector<Need> needs = {
        {"root's privileges", isRoot ? std::nullopt : Problem("not run as root"),
         "passwords and ageing of users, every change", everywhere("sudo mihost"), ""},
        {"locale in LANG",
         language && *language ? std::nullopt : Problem("LANG is not set"),
         "language-edition and code-set of os",
         {"update-locale LANG=C.UTF-8", localectl, localectl},
         ""},
    };
    if (isThere(systemLog))
        needs.push_back({"permission to empty the system log", accessProblem(systemLog, W_OK),
                         "clear-log", everywhere("sudo mihost"), ""});
    if (isRoot) {
        std::vector<Need> const ofRoot = capabilities();
        needs.insert(needs.end(), ofRoot.begin(), ofRoot.end());
    }
    return needs;
}

std::vector<Need> commandLines()
{
    std::vector<Need> needs;
    for (CommandNeed const& row : commandNeeds)
        needs.push_back(needOf(row));
    if (isThere("/usr/bin/passwd"))
        needs.push_back(redHatNeed(
            "passwd --stdin",
            passwdReadsStdin() ? std::nullopt : Problem("not supported by passwd"),
            "Password in methods: mihost passes a hash, other hosts store the plain text",
            "dnf install passwd", "the passwd of this system has no such option"));
    return needs;
}

// Files.

constexpr char missingConfiguration[] =
    "apt-get install --reinstall -o Dpkg::Options::=--force-confmiss login";

std::vector<Need> accounts()
{
    std::vector<Need> needs = {
        {"id ranges in /etc/login.defs",
         isThere(loginDefsFile) ? problemOfRanges(contentOf(loginDefsFile))
                                : accessProblem(loginDefsFile),
         "ordinary users, ordinary groups",
         {missingConfiguration, "dnf reinstall shadow-utils", "cp /usr/etc/login.defs /etc"},
         ""},
        {"accounts in /etc/passwd",
         accessProblem(accountFile),
         "all users",
         {"cp /usr/share/base-passwd/passwd.master /etc/passwd", "dnf reinstall setup",
          "systemd-sysusers"},
         ""},
        {"groups in /etc/group",
         accessProblem(groupFile),
         "all groups",
         {"cp /usr/share/base-passwd/group.master /etc/group", "dnf reinstall setup",
          "systemd-sysusers"},
         ""},
        {"login failures in /etc/pam.d/login",
         accessProblem("/etc/pam.d/login"),
         "max-login-failures of users",
         {missingConfiguration, "dnf reinstall util-linux", "cp /usr/lib/pam.d/login /etc/pam.d"},
         ""},
        {"passwords in /etc/shadow", accessProblem(shadowFile), "passwords and ageing of users",
         everywhere("sudo mihost, or pwconv"), ""},
    };
    if (isThere(accountFile))
        needs.push_back({"format of /etc/passwd", problemOfAccounts(contentOf(accountFile)),
                         "that user; after a line that is too long, all users", everywhere("vipw"),
                         ""});
    if (isThere(groupFile))
        needs.push_back({"format of /etc/group", problemOfGroups(contentOf(groupFile)),
                         "that group", everywhere("vigr"), ""});
    if (isThere(accountFile) && isThere(shadowFile))
        needs.push_back(
            {"order of /etc/shadow",
             problemOfShadow(localNames(*findKind(IC::nodeType::user)), contentOf(shadowFile)),
             "passwords and ageing of that user and all later ones", everywhere("pwconv; pwck -s"),
             ""});
    return needs;
}

/** One of several files will do. */
Problem noneOf(std::vector<std::string> const& files)
{
    if (std::any_of(files.begin(), files.end(), isThere))
        return std::nullopt;
    return "no known file exists";
}

std::vector<Need> release()
{
    std::vector<std::string> const dated = {"/etc/SuSE-release", "/etc/UnitedLinux-release",
                                            "/etc/redhat-release"};
    std::vector<std::string> named = dated;
    named.emplace_back("/etc/vmware-release");
    Problem version = noneOf(named);
    if (version && isThere(releaseFile))
        version = problemOfRelease(contentOf(releaseFile));
    named.emplace_back(releaseFile);

    std::string const write =
        "(. /etc/os-release; printf '%s\\nVERSION = %s\\nPATCHLEVEL = 0\\n' \"$PRETTY_NAME\" "
        "\"$VERSION_ID\") >/etc/release";
    std::string const install = "dnf install system-release";
    return {
        {"name in a release file",
         noneOf(named),
         "os-name is just \"Linux\"",
         {write, install, write},
         ""},
        {"version in a release file", version, "os-version of os", {write, install, write}, ""},
        redHatNeed("date of a release file", noneOf(dated), "install-date of os", install,
                   "such a file would make this another distribution"),
    };
}

/** Why no module is listed. Empty if lsmod is missing; that is reported separately. */
Problem emptyModuleList(std::string const& file)
{
    bool const isListed = linesOf(commandTap::outputOf("lsmod 2>/dev/null")).size() > 1;
    if (isListed || commandTap::outputOf("command -v lsmod").empty())
        return std::nullopt;
    if (!isThere(file))
        return "this kernel has no " + file;
    return "none is loaded";
}

std::vector<Need> modules()
{
    std::string const file = "/proc/modules";
    bool const takesModules = isThere(file);
    std::string const advice = takesModules ? "modprobe MODULE" : "";
    std::vector<Need> needs = {{"loaded kernel modules", emptyModuleList(file), "all drivers",
                                everywhere(advice),
                                takesModules ? "" : "this kernel has no loadable modules"}};
    utsname system{};
    if (linesOf(contentOf(file)).empty() || uname(&system) != 0)
        return needs;
    needs.push_back(
        {"module files of the kernel",
         accessProblem(fmt::format("/lib/modules/{}", system.release)),
         "versions and descriptions of drivers",
         {"apt-get install linux-image-$(uname -r)", "dnf install kernel-modules-$(uname -r)",
          "zypper install --force kernel-default"},
         ""});
    return needs;
}

std::vector<Need> log()
{
    std::string const traditional =
        "echo '$ActionFileDefaultTemplate RSYSLOG_TraditionalFileFormat' "
        ">/etc/rsyslog.d/00-stamp.conf; systemctl restart rsyslog";
    std::vector<Need> needs = {
        {"system log in /var/log/messages",
         accessProblem(systemLog),
         "all log entries",
         {"apt-get install rsyslog; echo '*.info;authpriv.none -/var/log/messages;"
          "RSYSLOG_TraditionalFileFormat' >/etc/rsyslog.d/messages.conf; systemctl restart rsyslog",
          "dnf install rsyslog; systemctl enable --now rsyslog",
          "zypper install rsyslog; systemctl enable --now rsyslog"},
         ""}};
    if (!isThere(systemLog))
        return needs;
    needs.push_back({"traditional time stamps in the system log",
                     problemOfStamps(LogFile(systemLog).newestLines(mostLogEntries)),
                     "messages and times of log entries", everywhere(traditional), ""});
    return needs;
}

} // namespace

std::vector<Need> diagnose()
{
    std::vector<Need> all = surroundings();
    for (Need const& need : diagnoseMachine())
        all.push_back(need);
    return all;
}

std::vector<Need> diagnoseMachine()
{
    std::vector<Need> all;
    for (auto const part : {commandLines, groupOption, accounts, release, modules, log})
        for (Need const& need : part())
            all.push_back(need);
    return all;
}

} // namespace mihost
