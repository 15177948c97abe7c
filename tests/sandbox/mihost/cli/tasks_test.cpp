// mihost user and mihost group: tasks with their own names, in a pipe and at a terminal.

#include "tests/support/Lines.h"
#include "tests/support/Machine.h"
#include "tests/support/Program.h"
#include "tests/support/TerminalRun.h"

#include <algorithm>
#include <crypt.h>
#include <cstdlib>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

namespace tasks_test
{

bool opens(std::string const& account, std::string const& password)
{
    std::string const hash = machine::entry("/etc/shadow", account).at(1);
    char const* const again = crypt(password.c_str(), hash.c_str());
    return again && !hash.empty() && hash == again;
}

class Tasks : public testing::Test
{
protected:
    Tasks()
    {
        setenv("LC_ALL", "C.UTF-8", 1);
        setenv("TERM", "xterm", 1);
        machine::lay("plain");
        machine::write("/etc/login.defs",
                       "UID_MIN 1000\nUID_MAX 60000\nGID_MIN 1000\nGID_MAX 60000\n");
        for (char const* line : {"/usr/sbin/groupadd staff", "/usr/sbin/groupadd crew",
                                 "/usr/sbin/useradd -m -s /bin/sh -c 'J. Doe' -G crew jdoe"})
            EXPECT_EQ(std::system(line), 0) << line;
    }

    /** The command lines that change an account or a group. */
    static Lines changes()
    {
        Lines lines = machine::ran();
        lines.erase(std::remove_if(lines.begin(), lines.end(),
                                   [](std::string const& line) {
                                       return line.find("/usr/sbin/") != 0 &&
                                              line.find("/usr/bin/chage") != 0;
                                   }),
                    lines.end());
        return lines;
    }

    static void expectUnchanged(Outcome const& outcome, int code, std::string const& message)
    {
        EXPECT_EQ(outcome.code, code) << message;
        EXPECT_EQ(outcome.out, "") << message;
        EXPECT_EQ(outcome.err, "mihost: " + message + "\n");
        EXPECT_EQ(changes(), Lines()) << message;
    }
};

TEST_F(Tasks, RunTheCommandsOfTheirMethods)
{
    struct Row {
        Lines arguments;
        char const* ran;
    };
    machine::recordShell();
    for (Row const& row : {
             Row{{"user", "set-shell", "jdoe", "/bin/bash"},
                 "/usr/sbin/usermod -s /bin/bash jdoe 2>&1"},
             Row{{"user", "set-home", "jdoe", "/srv/jdoe"},
                 "/usr/sbin/usermod -d /srv/jdoe -m jdoe 2>&1"},
             Row{{"user", "set-name", "jdoe", "Jane Doe"},
                 "/usr/sbin/usermod -c Jane\\ Doe jdoe 2>&1"},
             Row{{"user", "expire", "jdoe", "2031-12-30"},
                 "/usr/bin/chage jdoe -E 2031-12-30 2>&1"},
             Row{{"user", "age", "jdoe", "--max-days", "90", "--min-days", "1", "--warn-days", "7",
                  "--inactive-days", "3"},
                 "/usr/bin/chage jdoe -m 1 -M 90 -W 7 -I 3 -E 2031-12-30 2>&1"},
             Row{{"user", "expire", "jdoe", "never"}, "/usr/bin/chage jdoe -E -1 2>&1"},
             Row{{"user", "delete", "jdoe", "-y"}, "/usr/sbin/userdel jdoe 2>&1"},
             Row{{"group", "add", "builders"}, "/usr/sbin/groupadd builders 2>&1"},
             Row{{"group", "delete", "builders", "-y"}, "/usr/sbin/groupdel builders 2>&1"},
         }) {
        machine::forget();
        Outcome const outcome = mihostRun(row.arguments);
        EXPECT_EQ(outcome.code, 0) << row.ran;
        EXPECT_EQ(outcome.out + outcome.err, "") << row.ran;
        EXPECT_EQ(changes(), Lines{row.ran});
    }
}

TEST_F(Tasks, AddAnAccountWithEveryOption)
{
    Outcome const outcome = mihostRun({"user", "add", "asmith", "--full-name", "A. Smith", "--home",
                                       "/srv/asmith", "--shell", "/bin/sh", "--max-days", "90",
                                       "--expires", "2031-12-30", "--password"},
                                      "Secret-1\n");
    EXPECT_EQ(outcome.code, 0) << outcome.err;
    Lines const account = machine::entry("/etc/passwd", "asmith");
    EXPECT_EQ(account.at(4), "A. Smith");
    EXPECT_EQ(account.at(5), "/srv/asmith");
    EXPECT_EQ(account.at(6), "/bin/sh");
    EXPECT_EQ(machine::entry("/etc/shadow", "asmith").at(4), "90");
    EXPECT_EQ(machine::entry("/etc/shadow", "asmith").at(7), "22643"); // days since 1970
    EXPECT_TRUE(opens("asmith", "Secret-1"));
}

TEST_F(Tasks, AddAnAccountWithALockedPassword)
{
    EXPECT_EQ(mihostRun({"user", "add", "asmith"}).code, 0);
    EXPECT_EQ(machine::entry("/etc/shadow", "asmith").at(1), "!");
}

TEST_F(Tasks, AddAndRemoveMembers)
{
    EXPECT_EQ(mihostRun({"group", "add-member", "staff", "jdoe"}).code, 0);
    EXPECT_EQ(machine::entry("/etc/group", "staff").at(3), "jdoe");
    EXPECT_EQ(machine::entry("/etc/group", "crew").at(3), "jdoe");
    EXPECT_EQ(mihostRun({"group", "remove-member", "staff", "jdoe"}).code, 0);
    EXPECT_EQ(machine::entry("/etc/group", "staff").at(3), "");
    EXPECT_EQ(machine::entry("/etc/group", "crew").at(3), "jdoe");
}

TEST_F(Tasks, ReportThatThereIsNoExpiryToRemove)
{
    Outcome const outcome = mihostRun({"user", "expire", "jdoe", "never"});
    EXPECT_EQ(outcome.code, 0);
    EXPECT_EQ(outcome.err, "mihost: nothing changed: account expiry of jdoe is already never\n");
}

TEST_F(Tasks, RefuseToLoseAnExpiryThatIsNotADay)
{
    ASSERT_EQ(std::system("sed -i '/^jdoe:/s/[^:]*:$/99999999:/' /etc/shadow"), 0);
    std::string const shadow = machine::read("/etc/shadow");
    ASSERT_NE(shadow.find(":99999999:"), std::string::npos) << shadow;
    machine::recordShell();
    expectUnchanged(mihostRun({"user", "age", "jdoe", "--max-days", "5"}), 2,
                    "user age: the account's expiry, day '99999999', is not a day that can be "
                    "kept (set it with 'mihost user expire' first)");
    EXPECT_EQ(machine::read("/etc/shadow"), shadow);
}

TEST_F(Tasks, RefuseUnknownNamesAndSuggestTheNearest)
{
    machine::recordShell();
    expectUnchanged(mihostRun({"user", "delete", "jdo", "-y"}), 4,
                    "user delete: no account 'jdo' (did you mean jdoe?)");
    expectUnchanged(mihostRun({"user", "set-shell", "nobody-here", "/bin/sh"}), 4,
                    "user set-shell: no account 'nobody-here'");
    expectUnchanged(mihostRun({"group", "add-member", "stuff", "jdoe"}), 4,
                    "group add-member: no group 'stuff' (did you mean staff?)");
    expectUnchanged(mihostRun({"group", "remove-member", "crew", "jdo"}), 4,
                    "group remove-member: no account 'jdo' (did you mean jdoe?)");
}

TEST_F(Tasks, RefuseWrongValuesByTheNameOfTheOption)
{
    machine::recordShell();
    expectUnchanged(mihostRun({"user", "add", "asmith", "--shell", "bash"}), 2,
                    "user add: --shell is not an absolute path (it must begin with '/')");
    expectUnchanged(mihostRun({"user", "age", "jdoe", "--max-days", "-1"}), 2,
                    "user age: --max-days is not a number (it must be 1 to 9 decimal digits)");
    expectUnchanged(mihostRun({"user", "age", "jdoe"}), 2,
                    "user age: nothing to change (use --min-days, --max-days, --warn-days, "
                    "--inactive-days)");
    expectUnchanged(mihostRun({"user", "expire", "jdoe", "tomorrow"}), 2,
                    "user expire: DAY is not a day (use YYYY-MM-DD, such as 2030-12-31)");
    expectUnchanged(mihostRun({"user", "add", "a;b"}), 2,
                    "user add: NAME contains the shell metacharacter ';'");
    expectUnchanged(mihostRun({"group", "add", "1000"}), 2,
                    "group add: NAME consists of digits only, so tools would read it as an id");
}

TEST_F(Tasks, RefuseWrongUsage)
{
    struct Row {
        Lines arguments;
        char const* message;
    };
    machine::recordShell();
    for (Row const& row : {
             Row{{"user"}, "user: USER or a command is required (see 'mihost user --help')"},
             Row{{"user", "ad", "asmith"}, "user: no command 'ad' (did you mean add?)"},
             Row{{"user", "jdoe", "delete", "jdoe"},
                 "user delete: unexpected argument 'jdoe' (see 'mihost user delete --help')"},
             Row{{"user", "delete", "jdoe", "staff"},
                 "user delete: unexpected argument 'staff' (see 'mihost user delete --help')"},
             Row{{"user", "add", "asmith", "--shel", "/bin/sh"},
                 "user add: no option '--shel' (did you mean --shell?)"},
             Row{{"user", "set-shell", "jdoe"},
                 "user set-shell: SHELL is required (see 'mihost user set-shell --help')"},
         })
        expectUnchanged(mihostRun(row.arguments), 2, row.message);
}

TEST_F(Tasks, ReportWhyAToolRefused)
{
    Outcome const outcome = mihostRun({"user", "add", "jdoe"});
    EXPECT_EQ(outcome.code, 1);
    EXPECT_EQ(outcome.err.rfind("mihost: user add: ", 0), 0U) << outcome.err;
    EXPECT_NE(outcome.err.find("user 'jdoe' already exists"), std::string::npos) << outcome.err;
}

TEST_F(Tasks, PrintTheirChangesAsJson)
{
    Outcome const outcome = mihostRun({"--json", "group", "add", "builders"});
    auto const report = nlohmann::json::parse(outcome.out);
    EXPECT_EQ(report["status"], 0);
    EXPECT_EQ(report["changed"], true);
    EXPECT_EQ(report["changes"][0]["file"], "/etc/group");
}

TEST_F(Tasks, NeedYesToDeleteWithoutATerminal)
{
    machine::recordShell();
    expectUnchanged(mihostRun({"user", "delete", "jdoe"}), 2,
                    "user delete: not a terminal (add --yes to delete the account jdoe)");
    expectUnchanged(mihostRun({"group", "delete", "crew"}), 2,
                    "group delete: not a terminal (add --yes to delete the group crew)");
}

TEST_F(Tasks, AskAtATerminalBeforeTheyDelete)
{
    TerminalRun refused({"user", "delete", "jdoe"});
    refused.waitFor("Really delete the account jdoe? [y/N] ");
    refused.type("n\n");
    EXPECT_EQ(refused.end(), 2);
    EXPECT_FALSE(machine::entry("/etc/passwd", "jdoe").empty());
    TerminalRun agreed({"user", "delete", "jdoe"});
    agreed.waitFor("Really delete the account jdoe? [y/N] ");
    agreed.type("y\n");
    EXPECT_EQ(agreed.end(), 0);
    EXPECT_TRUE(machine::entry("/etc/passwd", "jdoe").empty());
}

TEST_F(Tasks, AskForANewPasswordTwice)
{
    TerminalRun run({"user", "set-password", "jdoe"});
    run.waitFor("New password: ");
    run.type("Secret-1\n");
    run.waitFor("Repeat the new password: ");
    run.type("Secret-1\n");
    EXPECT_EQ(run.end(), 0) << run.output();
    EXPECT_EQ(run.output().find("Secret"), std::string::npos) << run.output();
    EXPECT_TRUE(opens("jdoe", "Secret-1"));
}

TEST_F(Tasks, SetNoPasswordThatWasTypedDifferently)
{
    std::string const before = machine::read("/etc/shadow");
    TerminalRun run({"user", "set-password", "jdoe"});
    run.waitFor("New password: ");
    run.type("Secret-1\n");
    run.waitFor("Repeat the new password: ");
    run.type("Secret-2\n");
    run.waitFor("mihost: user set-password: the passwords differ, so nothing was changed");
    EXPECT_EQ(run.end(), 2);
    EXPECT_EQ(machine::read("/etc/shadow"), before);
}

TEST_F(Tasks, ReadAPasswordFromAPipeOrAFile)
{
    machine::write("/root/secret", "Secret-3\n", 0600);
    struct Row {
        Lines arguments;
        char const* input;
        char const* password;
    };
    for (Row const& row :
         {Row{{"user", "set-password", "jdoe"}, "Secret-1\n", "Secret-1"},
          Row{{"user", "set-password", "jdoe", "--password-file", "-"}, "Secret-2\n", "Secret-2"},
          Row{{"user", "set-password", "jdoe", "--password-file", "/root/secret"}, "", "Secret-3"},
          Row{{"user", "add", "asmith", "--password-file=/root/secret"}, "", "Secret-3"}}) {
        Outcome const outcome = mihostRun(row.arguments, row.input);
        EXPECT_EQ(outcome.code, 0) << outcome.err;
        EXPECT_TRUE(opens(row.arguments[2], row.password)) << row.arguments.back();
    }
}

TEST_F(Tasks, RefuseAPasswordThatCannotBeRead)
{
    machine::write("/root/two", "one\ntwo\n");
    machine::write("/root/empty", "");
    machine::write("/root/blank", "\n");
    machine::recordShell();
    Lines const set = {"user", "set-password", "jdoe", "--password-file"};
    auto const from = [&set](char const* file) {
        Lines arguments = set;
        arguments.emplace_back(file);
        return mihostRun(arguments);
    };
    std::string const what = "user set-password: ";
    expectUnchanged(from("/root/none"), 2,
                    what + "cannot read the password file '/root/none': No such file or directory");
    expectUnchanged(from("/root"), 2,
                    what + "cannot read the password file '/root': Is a directory");
    expectUnchanged(from("/root/two"), 2,
                    what + "the password file '/root/two' has 2 lines (put the password on one "
                           "line)");
    expectUnchanged(from("/root/empty"), 2,
                    what + "the password file '/root/empty' has 0 lines (put the password on one "
                           "line)");
    expectUnchanged(from("/root/blank"), 2, what + "the password is empty");
    expectUnchanged(mihostRun({"user", "set-password", "jdoe"}), 2,
                    what + "Password: standard input is empty");
}

TEST_F(Tasks, ReadNoPasswordFromTheScriptOfTheShell)
{
    machine::recordShell();
    expectUnchanged(mihostRun({"shell"}, "user set-password jdoe\nSecret-1\n"), 2,
                    "line 1: user set-password: cannot read a password from standard input, which "
                    "is the script (use --password-file FILE)");
    machine::write("/root/secret", "Secret-3\n", 0600);
    EXPECT_EQ(mihostRun({"shell"}, "user set-password jdoe --password-file /root/secret\n").code,
              0);
    EXPECT_TRUE(opens("jdoe", "Secret-3"));
}

TEST_F(Tasks, ShowAnAccountThatIsNamedLikeATask)
{
    ASSERT_EQ(std::system("/usr/sbin/useradd -M -c 'Odd Name' add"), 0);
    for (Lines const& arguments : {Lines{"user", "--", "add"}, Lines{"user", "jdoe"}}) {
        Outcome const outcome = mihostRun(arguments);
        EXPECT_EQ(outcome.code, 0) << outcome.err;
        EXPECT_NE(outcome.out.find(arguments.back()), std::string::npos) << outcome.out;
    }
    EXPECT_NE(mihostRun({"user", "--", "add"}).out.find("Odd Name"), std::string::npos);
    EXPECT_NE(mihostRun({"group", "crew"}).out.find("crew"), std::string::npos);
    EXPECT_EQ(mihostRun({"group", "nosuch"}).code, 4);
}

} // namespace tasks_test
