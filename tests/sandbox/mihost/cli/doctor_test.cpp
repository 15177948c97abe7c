// What the doctor finds on machines that lack one thing or another, and that its advice helps.

#include "TestPaths.h"
#include "tests/support/KernelModules.h"
#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"

#include <set>
#include <sstream>

namespace doctor_test
{

/** A machine that lacks nothing. */
class Doctor : public testing::Test
{
protected:
    Doctor()
    {
        setenv("LANG", "C.UTF-8", 1);
        machine::lay("redhat");
        machine::write("/etc/passwd", "root:x:0:0:root:/root:/bin/sh\n"
                                      "bin:x:1:1::/:/bin/false\n"
                                      "anna:x:1000:1000::/home/anna:/bin/sh\n"
                                      "ben:x:1001:1001::/home/ben:/bin/sh\n");
        machine::write("/etc/shadow",
                       "root:*:19000:0:99999:7:::\nanna:!:19000:0:99999:7:::\n"
                       "ben:!:19000:0:99999:7:::\n",
                       0600);
        machine::write("/etc/group", "root:x:0:\nanna:x:1000:\nben:x:1001:\n");
        machine::writeIdRanges();
        machine::write("/etc/pam.d/login", "auth required pam_unix.so\n");
        machine::write("/var/log/messages", "Jan  2 03:04:05 host x: y\n");
        machine::fake("/usr/bin/passwd", "echo '  --stdin  read it from a pipe'\n");
        machine::fake("/usr/sbin/useradd", "echo 'Usage: useradd'\n");
        machine::fake("/usr/sbin/lsmod", "echo Module Size Used by\necho one 1 0\n");
        for (char const* program : {"/usr/sbin/modinfo", "/sbin/shutdown"})
            machine::fake(program, "");
        kernelModules::load({});
        machine::remove("/proc/modules"); // its modules need no files
    }

    /** The one need of this name. */
    static Json need(std::string const& name)
    {
        for (Json const& each : mihostJson({"doctor"}))
            if (each["need"] == name)
                return each;
        return nullptr;
    }

    static void expectMissing(std::string const& name, std::string const& problem,
                              std::string const& effect)
    {
        Json const found = need(name);
        ASSERT_FALSE(found.is_null()) << name;
        EXPECT_EQ(found["ok"], false) << name;
        EXPECT_EQ(found["problem"], problem) << name;
        EXPECT_EQ(found["effect"], effect) << name;
        EXPECT_EQ(found["fixable"], true) << name;
        EXPECT_EQ(found["no-fix"], nullptr) << name;
        EXPECT_TRUE(found["red-hat"].is_string()) << name;
        EXPECT_EQ(mihostRun({"doctor"}).code, 1) << name;
    }

    /** Expects that only this is missing, and that it cannot be fixed here. */
    static void expectNoFix(std::string const& name, std::string const& problem,
                            std::string const& why)
    {
        Json const found = need(name);
        ASSERT_FALSE(found.is_null()) << name;
        EXPECT_EQ(found["ok"], false) << name;
        EXPECT_EQ(found["problem"], problem) << name;
        EXPECT_EQ(found["fixable"], false) << name;
        EXPECT_EQ(found["no-fix"], why) << name;
        Outcome const outcome = mihostRun({"doctor"});
        EXPECT_EQ(outcome.code, 0) << outcome.out;
        EXPECT_TRUE(holds(outcome.out, "no fix   " + name + ": " + problem + "\n"));
        EXPECT_TRUE(holds(outcome.out, "           no fix   " + why + "\n"));
        EXPECT_TRUE(holds(outcome.out, " 1 cannot be fixed here\n"));
    }
};

TEST_F(Doctor, FindsNothingMissingOnACompleteMachine)
{
    Outcome const outcome = mihostRun({"--plugin", "/none.so", "doctor"}); // which it does not load
    EXPECT_EQ(outcome.code, 0);
    EXPECT_EQ(outcome.err, "");
    EXPECT_FALSE(holds(outcome.out, "missing "));
    EXPECT_TRUE(holds(outcome.out, "\n0 of "));
    for (Json const& need : mihostJson({"doctor"})) {
        EXPECT_EQ(need["ok"], true) << need;
        EXPECT_EQ(need["problem"], nullptr) << need;
    }
}

TEST_F(Doctor, ShowsWhatIsMissingLastWithItsEffectAndFix)
{
    machine::remove("/usr/sbin/lsmod");
    machine::remove("/usr/bin/lsmod");
    std::string const out = mihostRun({"doctor"}).out;
    std::string const paragraph = "missing  command lsmod: not found in PATH\n"
                                  "           effect   all drivers\n"
                                  "           Debian   apt-get install kmod\n"
                                  "           Red Hat  dnf install kmod\n"
                                  "           openSUSE zypper install kmod\n"
                                  "1 of ";
    EXPECT_TRUE(holds(out, paragraph));
    EXPECT_GT(out.find(paragraph), out.rfind("\nok  "));
}

TEST_F(Doctor, ChecksEachCommandThatThePluginRuns)
{
    std::set<std::string> commands;
    for (Json const& need : mihostJson({"doctor"}))
        if (startsWith(need["need"], "command "))
            commands.insert(need["need"].get<std::string>().substr(8));
    std::istringstream expected("lsmod modinfo wc sed date stat grep cat tr cut chage chpasswd rm "
                                "userdel /usr/sbin/useradd /usr/sbin/userdel /usr/sbin/usermod "
                                "/usr/sbin/groupadd /usr/sbin/groupdel /usr/bin/chage "
                                "/usr/bin/passwd /usr/bin/id /sbin/shutdown /bin/sh");
    for (std::string command; expected >> command;)
        EXPECT_EQ(commands.count(command), 1U) << command;
    machine::remove("/usr/sbin/groupdel");
    expectMissing("command /usr/sbin/groupdel", "No such file or directory",
                  "the method LocalGroupDel");
}

TEST_F(Doctor, DistinguishesAMissingCommandFromAShortPath)
{
    setenv("PATH", "/usr/bin:/bin", 1);
    expectMissing("command chpasswd", "not found in PATH", "writing password of users");
    EXPECT_EQ(need("command chpasswd")["debian"], "PATH=$PATH:/usr/sbin mihost");
    EXPECT_EQ(need("command chpasswd")["red-hat"], "PATH=$PATH:/usr/sbin mihost");
}

TEST_F(Doctor, ReportsAPasswdWithoutStdin)
{
    machine::fake("/usr/bin/passwd", "echo 'nothing of the kind'\n");
    expectNoFix("passwd --stdin", "not supported by passwd",
                "the passwd of this system has no such option");
    machine::fake("/usr/bin/dnf", "");
    expectMissing("passwd --stdin", "not supported by passwd",
                  "Password in methods: mihost passes a hash, other hosts store the plain text");
}

TEST_F(Doctor, ReportsAUseraddWithoutTheOptionOfItsFamily)
{
    machine::fake("/usr/sbin/useradd",
                  "[ \"$*\" = -n ] && echo \"useradd: invalid option -- 'n'\"\n");
    expectNoFix("useradd -n", "not supported by useradd",
                "the useradd of this system has no such option: add accounts with useradd itself");
    machine::remove("/etc/redhat-release");
    EXPECT_EQ(need("useradd -n"), nullptr);
}

TEST_F(Doctor, ExitsWith1IfOneOfTwoProblemsCanBeFixed)
{
    machine::fake("/usr/bin/passwd", "echo 'nothing of the kind'\n");
    machine::remove("/usr/sbin/groupdel");
    Outcome const outcome = mihostRun({"doctor"});
    EXPECT_EQ(outcome.code, 1);
    EXPECT_TRUE(holds(outcome.out, "2 of "));
    EXPECT_GT(outcome.out.find("missing  command"), outcome.out.find("no fix   passwd"));
}

TEST_F(Doctor, NamesTheCapabilityThatRootLacks)
{
    Outcome const outcome =
        runToEnd({"/usr/bin/setpriv", "--inh-caps=-sys_admin", "--bounding-set=-sys_admin",
                  MIHOST_FILE, "--json", "doctor"});
    EXPECT_EQ(outcome.code, 0) << outcome.out;
    Lines missing;
    for (Json const& each : Json::parse(outcome.out))
        if (each["ok"] == false)
            missing.push_back(each["need"].get<std::string>() + ": " +
                              each["effect"].get<std::string>());
    EXPECT_EQ(missing, Lines{"capability CAP_SYS_ADMIN: --sandbox and --overlay"});
}

TEST_F(Doctor, ReportsAMissingLocaleAndMissingIdRanges)
{
    unsetenv("LANG");
    expectMissing("locale in LANG", "LANG is not set", "language-edition and code-set of os");
    setenv("LANG", "C.UTF-8", 1);
    machine::write("/etc/login.defs", "UID_MIN 1000\nUID_MAX 60000\nGID_MIN 1000\n");
    expectMissing("id ranges in /etc/login.defs", "no line begins with GID_MAX and a number",
                  "ordinary users, ordinary groups");
    machine::remove("/etc/login.defs");
    expectMissing("id ranges in /etc/login.defs", "No such file or directory",
                  "ordinary users, ordinary groups");
}

TEST_F(Doctor, ReportsMissingOrMalformedAccountFiles)
{
    machine::write("/etc/group", "root:x:0:\nstaff:x:fifty:\n");
    expectMissing("format of /etc/group", "line 2 is malformed", "that group");
    machine::remove("/etc/group");
    expectMissing("groups in /etc/group", "No such file or directory", "all groups");
    EXPECT_EQ(need("format of /etc/group"), nullptr);
    machine::write("/etc/passwd", "root:x:0:0::/:/bin/sh\nnonsense\n");
    expectMissing("format of /etc/passwd", "line 2 is malformed",
                  "that user; after a line that is too long, all users");
    machine::remove("/etc/passwd");
    expectMissing("accounts in /etc/passwd", "No such file or directory", "all users");
    machine::remove("/etc/pam.d/login");
    expectMissing("login failures in /etc/pam.d/login", "No such file or directory",
                  "max-login-failures of users");
}

TEST_F(Doctor, ReportsUnsortedShadowEntriesAndAFixThatWorks)
{
    std::string const effect = "passwords and ageing of that user and all later ones";
    machine::write("/etc/shadow",
                   "bin:*:19000:0:99999:7:::\nben:!:19000:0:99999:7:::\n"
                   "anna:!:19000:0:99999:7:::\nroot:*:19000:0:99999:7:::\n",
                   0600);
    expectMissing("order of /etc/shadow",
                  "no entry for 'anna' at its place in the order of /etc/passwd", effect);
    machine::run(need("order of /etc/shadow")["debian"]);
    EXPECT_EQ(need("order of /etc/shadow")["ok"], true);
    machine::remove("/etc/shadow");
    expectMissing("passwords in /etc/shadow", "No such file or directory",
                  "passwords and ageing of users");
    EXPECT_EQ(need("order of /etc/shadow"), nullptr);
}

TEST_F(Doctor, ReportsAMissingReleaseFileAndAFixThatWorks)
{
    machine::remove("/etc/redhat-release");
    machine::write("/etc/os-release", "PRETTY_NAME=\"Some System 12\"\nVERSION_ID=\"12\"\n");
    EXPECT_EQ(need("date of a release file")["no-fix"],
              "such a file would make this another distribution");
    expectMissing("version in a release file", "no known file exists", "os-version of os");
    expectMissing("name in a release file", "no known file exists", "os-name is just \"Linux\"");
    machine::run(need("name in a release file")["debian"]);
    EXPECT_EQ(need("name in a release file")["ok"], true);
    EXPECT_EQ(need("version in a release file")["ok"], true);
    EXPECT_EQ(mihostRun({"get", "os", "os-name", "os-version"}).out,
              "108 os-name     Some System 12\n134 os-version  12.0\n");
    machine::write("/etc/release", "Some System 12\n");
    expectMissing("version in a release file",
                  "no lines like 'VERSION = 1' and 'PATCHLEVEL = 0' after the first",
                  "os-version of os");
}

TEST_F(Doctor, ReportsALogWithoutTraditionalTimeStamps)
{
    machine::write("/var/log/messages", "2026-01-02T03:04:05.678901+00:00 host x: y\n");
    expectMissing("traditional time stamps in the system log",
                  "a line begins with '2026-01-02T03:04' instead of a time stamp like "
                  "'Jan  2 03:04:05 '",
                  "messages and times of log entries");
    machine::remove("/var/log/messages");
    expectMissing("system log in /var/log/messages", "No such file or directory",
                  "all log entries");
    EXPECT_EQ(need("traditional time stamps in the system log"), nullptr);
}

TEST_F(Doctor, ReadsOnlyTheNewestLinesOfALongLog)
{
    std::string log = "2025-01-02T03:04:05 before the change\n";
    for (int line = 0; line < 20000; ++line)
        log += "Jan  2 03:04:05 host x: y\n";
    machine::write("/var/log/messages", log);
    EXPECT_EQ(need("traditional time stamps in the system log")["ok"], true);
    machine::write("/var/log/messages", log + "\x1b[2J\xff\n");
    EXPECT_EQ(need("traditional time stamps in the system log")["ok"], false);
    EXPECT_TRUE(holds(mihostRun({"doctor"}).out, R"(a line begins with '\x1b[2J\xff' instead)"));
}

TEST_F(Doctor, ReportsMissingModulesOrKernelSupport)
{
    machine::fake("/usr/sbin/lsmod", "echo 'Error: no list' >&2\nexit 1\n");
    expectNoFix("loaded kernel modules", "this kernel has no /proc/modules",
                "this kernel has no loadable modules");
    machine::fake("/usr/sbin/lsmod", "echo Module Size Used by\n");
    machine::write("/proc/modules", "");
    expectMissing("loaded kernel modules", "none is loaded", "all drivers");
    EXPECT_EQ(need("loaded kernel modules")["debian"], "modprobe MODULE");
}

TEST_F(Doctor, ReportsMissingPrivilegesOfRoot)
{
    Outcome const outcome = machine::mihostRunAsUser({"--json", "doctor"});
    EXPECT_EQ(outcome.code, 1);
    EXPECT_FALSE(holds(outcome.out, "capability")); // a user has none
    std::set<std::string> missing;
    for (Json const& need : Json::parse(outcome.out))
        if (need["ok"] == false)
            missing.insert(need["need"]);
    for (char const* name :
         {"root's privileges", "passwords in /etc/shadow", "permission to empty the system log"})
        EXPECT_EQ(missing.count(name), 1U) << name;
}

} // namespace doctor_test
