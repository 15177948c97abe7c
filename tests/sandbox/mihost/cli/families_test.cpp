// Every command on machines that are laid out as Fedora and openSUSE are today.

#include "TestPaths.h"
#include "mihost/cli/commands/CommandRows.h"
#include "tests/sandbox/mihost/cli/Login.h"
#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"

#include <cstdlib>
#include <filesystem>
#include <map>
#include <set>

namespace families_test
{

/** A command, its exit code and a text that it prints. Each sees the changes of earlier ones. */
struct Row {
    Lines arguments;
    int code;
    std::string text;
    std::string input = "";
};

/** @return the names of the commands */
std::set<std::string> runAll(std::vector<Row> const& rows)
{
    std::set<std::string> names;
    for (Row const& row : rows) {
        Lines arguments = {"--yes"};
        arguments.insert(arguments.end(), row.arguments.begin(), row.arguments.end());
        Outcome const outcome = mihostRun(arguments, row.input);
        std::string line = "mihost";
        for (std::string const& argument : row.arguments)
            line += " " + argument;
        EXPECT_EQ(outcome.code, row.code) << line << '\n' << outcome.out << outcome.err;
        EXPECT_TRUE(holds((outcome.out + outcome.err), row.text))
            << line << outcome.out << outcome.err;
        names.insert(row.arguments[0]);
    }
    return names;
}

std::set<std::string> everyCommand()
{
    std::set<std::string> names;
    for (mihost::CommandRow const* row : mihost::commandTable())
        names.insert(row->name);
    return names;
}

TEST(Fedora, AcceptsEveryCommand)
{
    setenv("LANG", "C.UTF-8", 1);
    machine::lay("fedora");
    std::set<std::string> const names = runAll({
        {{"tree"}, 0, "Operating System: Fedora release 43 (Forty Three)"},
        {{"get", "os", "os-version", "-o", "value"}, 0, "43\n"},
        {{"get", "user:nora", "max-login-failures", "-o", "value"}, 0, "0\n"},
        {{"list", "users", "--columns", "user-name,user-id"}, 0, "olaf       1001\n"},
        {{"list", "groups", "--columns", "group-name"}, 0, "everyone\n"},
        {{"list", "drivers"}, 0, "exvirtio_net"},
        {{"list", "log", "-n", "1"}, 0, "dnf5-makecache"},
        {{"user", "nora"}, 0, "wheel (10)"},
        {{"group", "everyone"}, 0, "member249"},
        {{"user", "set-shell", "nora", "/bin/sh"}, 0, ""},
        {{"user", "set-password", "olaf"}, 0, "", "Fjord-17\n"},
        {{"user", "add", "jdoe"}, 1, "invalid option -- 'n'"},
        {{"group", "add", "crew"}, 0, ""},
        {{"group", "add-member", "crew", "olaf"}, 0, ""},
        {{"set", "user:olaf", "password-expiration", "2031-12-30"},
         0,
         "sets the password\'s maximum age"},
        {{"call", "LocalGroupDel", "GroupName=everyone"}, 0, ""},
        {{"refresh"}, 0, ""},
        {{"watch", "--count", "1", "os", "os-name"}, 0, "Fedora"},
        {{"shell"}, 0, "Fedora release 43", "get os os-name\n"},
        {{"doctor"}, 0, "no fix   useradd -n"},
        {{"metrics"}, 0, "name=\"Fedora release 43 (Forty Three)\",version=\"43\""},
        {{"check", "--rounds", "2", PLUGIN_FILE}, 0, "passed"},
        {{"version"}, 0, "mihost"},
        {{"properties"}, 0, "os-name"},
        {{"methods"}, 0, "UserAdd"},
        {{"clear-log"}, 0, ""},
        {{"power", "restart"}, 0, "shutdown"},
    });
    EXPECT_EQ(names, everyCommand());
    EXPECT_TRUE(opens("olaf", "Fjord-17"));
    EXPECT_EQ(machine::entry("/etc/passwd", "nora").at(6), "/bin/sh");
    EXPECT_EQ(machine::entry("/etc/group", "crew").at(3), "olaf");
    EXPECT_TRUE(machine::entry("/etc/group", "everyone").empty());
    EXPECT_EQ(machine::read("/var/log/messages"), "");
}

TEST(Fedora, AddsAnAccountIfUseraddTakesN)
{
    setenv("LANG", "C.UTF-8", 1);
    machine::lay("fedora");
    std::filesystem::rename("/usr/sbin/useradd", "/usr/sbin/useradd.debian");
    machine::fake("/usr/sbin/useradd", "for argument; do\n" // Fedora's: -n is as -N
                                       "    shift\n"
                                       "    [ \"$argument\" != -n ] || argument=-N\n"
                                       "    set -- \"$@\" \"$argument\"\n"
                                       "done\n"
                                       "exec /usr/sbin/useradd.debian \"$@\"\n");
    machine::record("/usr/sbin/useradd");
    runAll({
        {{"user", "add", "jdoe", "--full-name", "J. Doe"}, 0, ""},
        {{"user", "jdoe"}, 0, "users (100)"},
        {{"get", "user:jdoe", "full-name", "-o", "value"}, 0, "J. Doe\n"},
        {{"doctor"}, 0, "ok       useradd -n\n"},
        {{"user", "delete", "jdoe"}, 0, ""},
    });
    std::vector<Lines> const calls = machine::calls("/usr/sbin/useradd");
    ASSERT_FALSE(calls.empty());
    EXPECT_EQ(calls[0].front(), "-n");
    EXPECT_TRUE(machine::entry("/etc/passwd", "jdoe").empty());
}

TEST(Opensuse, AcceptsEveryCommand)
{
    setenv("LANG", "C.UTF-8", 1);
    machine::lay("opensuse");
    machine::remove("/etc/pam.d/login"); // it is below /usr there
    std::set<std::string> const names = runAll({
        {{"tree"}, 0, "Operating System: Linux"},
        {{"get", "os", "os-version"}, 1, "property 134 is not set"},
        {{"get", "user:paula", "max-login-failures", "-o", "value"}, 0, "0\n"},
        {{"list", "users", "--columns", "user-name,user-id"}, 0, "quinn      1001\n"},
        {{"list", "groups", "--columns", "group-name"}, 0, "everyone\n"},
        {{"list", "drivers"}, 0, "exbtrfs"},
        {{"list", "log", "-n", "1"}, 0, "wickedd"},
        {{"user", "paula"}, 0, "wheel (497)"},
        {{"group", "everyone"}, 0, "member249"},
        {{"user", "add", "jdoe", "--full-name", "J. Doe"}, 0, ""},
        {{"user", "set-shell", "paula", "/bin/sh"}, 0, ""},
        {{"user", "set-password", "quinn"}, 0, "", "Delta-17\n"},
        {{"user", "jdoe"}, 0, "users (100)"},
        {{"user", "delete", "jdoe"}, 0, ""},
        {{"group", "add", "crew"}, 0, ""},
        {{"group", "add-member", "crew", "quinn"}, 0, ""},
        {{"set", "user:quinn", "password-expiration", "2031-12-30"},
         0,
         "sets the password\'s maximum age"},
        {{"call", "LocalGroupDel", "GroupName=everyone"}, 0, ""},
        {{"refresh"}, 0, ""},
        {{"watch", "--count", "1", "os", "os-name"}, 0, "Linux"},
        {{"shell"}, 0, "Linux", "get os os-name\n"},
        {{"doctor"}, 1, "traditional time stamps in the system log"},
        {{"metrics"}, 0, "name=\"Linux\""},
        {{"check", "--rounds", "2", PLUGIN_FILE}, 0, "passed"},
        {{"version"}, 0, "mihost"},
        {{"properties"}, 0, "os-name"},
        {{"methods"}, 0, "UserAdd"},
        {{"clear-log"}, 0, ""},
        {{"power", "halt"}, 0, "shutdown"},
    });
    EXPECT_EQ(names, everyCommand());
    EXPECT_TRUE(opens("quinn", "Delta-17"));
    EXPECT_EQ(machine::entry("/etc/passwd", "paula").at(6), "/bin/sh");
    EXPECT_TRUE(machine::entry("/etc/passwd", "jdoe").empty());
    EXPECT_EQ(machine::entry("/etc/group", "crew").at(3), "quinn");
    EXPECT_TRUE(machine::entry("/etc/group", "everyone").empty());
    EXPECT_EQ(machine::read("/var/log/messages"), "");
}

TEST(Opensuse, HasNoOrdinaryAccountsIfLoginDefsIsBelowUsrOnly)
{
    setenv("LANG", "C.UTF-8", 1);
    machine::lay("opensuse");
    machine::remove("/etc/login.defs");
    runAll({
        {{"list", "users", "--columns", "user-name", "--no-headers"}, 0, "root\n"},
        {{"get", "user:paula"}, 4, "no"},
        {{"user", "paula"}, 0, "login.defs"},
        {{"doctor"}, 1, "id ranges in /etc/login.defs"},
    });
}

/** @return how openSUSE fixes each thing that its machine lacks, by name */
std::map<std::string, std::string> advice()
{
    std::map<std::string, std::string> fixes;
    for (auto const& need : mihostJson({"doctor"}))
        if (need["ok"] == false && need["fixable"] == true)
            fixes[need["need"]] = need["opensuse"].is_string() ? need["opensuse"] : "";
    return fixes;
}

TEST(Opensuse, GetsAdviceForItsOwnTools)
{
    setenv("LANG", "C.UTF-8", 1);
    machine::lay("opensuse");
    for (char const* file : {"/usr/sbin/groupdel", "/usr/sbin/lsmod", "/usr/bin/lsmod",
                             "/etc/login.defs", "/etc/pam.d/login", "/var/log/messages"})
        machine::remove(file);
    std::map<std::string, std::string> fixes = advice();
    EXPECT_EQ(fixes["command /usr/sbin/groupdel"], "zypper install shadow");
    EXPECT_EQ(fixes["command lsmod"], "zypper install kmod");
    EXPECT_EQ(fixes["system log in /var/log/messages"],
              "zypper install rsyslog; systemctl enable --now rsyslog");
    for (auto const& [need, fix] : fixes)
        EXPECT_TRUE(!fix.empty() && fix.find("dnf") == std::string::npos &&
                    fix.find("apt-get") == std::string::npos)
            << need << ": " << fix;
    EXPECT_TRUE(holds(mihostRun({"doctor"}).out, "           openSUSE zypper install kmod\n"));

    for (char const* need : {"id ranges in /etc/login.defs", "login failures in /etc/pam.d/login"})
        machine::run(fixes[need]);
    fixes = advice();
    EXPECT_EQ(fixes.count("id ranges in /etc/login.defs"), 0U);
    EXPECT_EQ(fixes.count("login failures in /etc/pam.d/login"), 0U);
}

} // namespace families_test
