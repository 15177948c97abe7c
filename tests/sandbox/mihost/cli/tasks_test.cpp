// mihost user and mihost group: tasks with their own names, in a pipe and at a terminal.

#include "tests/sandbox/mihost/cli/Login.h"
#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"
#include "tests/support/TerminalRun.h"

#include <algorithm>

namespace tasks_test
{

class Tasks : public testing::Test
{
protected:
    Tasks()
    {
        setenv("LC_ALL", "C.UTF-8", 1);
        machine::lay("plain");
        machine::writeIdRanges();
        machine::run("groupadd staff && groupadd crew && "
                     "useradd -m -s /bin/sh -c 'J. Doe' -G crew jdoe");
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

    struct Refusal {
        Lines arguments;
        std::string message;
    };

    /** Expects that nothing is changed. */
    static void expectRefused(std::vector<Refusal> const& refusals, int code = 2)
    {
        machine::recordShell();
        for (Refusal const& each : refusals)
            EXPECT_EQ(mihostRun(each.arguments), failed(code, each.message));
        EXPECT_EQ(changes(), Lines());
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
        EXPECT_EQ(mihostRun(row.arguments), printed(""));
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
    EXPECT_EQ(mihostRun({"user", "add", "locked"}).code, 0);
    EXPECT_EQ(machine::entry("/etc/shadow", "locked").at(1), "!");
}

TEST_F(Tasks, AddAndRemoveMembers)
{
    Json const report = mihostJson({"group", "add-member", "staff", "jdoe"});
    EXPECT_EQ(report["status"], 0);
    EXPECT_EQ(report["changes"][0]["file"], "/etc/group");
    EXPECT_EQ(machine::entry("/etc/group", "staff").at(3), "jdoe");
    EXPECT_EQ(machine::entry("/etc/group", "crew").at(3), "jdoe");
    EXPECT_EQ(mihostRun({"group", "remove-member", "staff", "jdoe"}).code, 0);
    EXPECT_EQ(machine::entry("/etc/group", "staff").at(3), "");
    EXPECT_EQ(machine::entry("/etc/group", "crew").at(3), "jdoe");
}

TEST_F(Tasks, ReportThatThereIsNoExpiryToRemove)
{
    EXPECT_EQ(mihostRun({"user", "expire", "jdoe", "never"}),
              failed(0, "nothing changed: account expiry of jdoe is already never"));
}

TEST_F(Tasks, RefuseToLoseAnExpiryThatIsNotADay)
{
    machine::run("sed -i '/^jdoe:/s/[^:]*:$/99999999:/' /etc/shadow");
    std::string const shadow = machine::read("/etc/shadow");
    ASSERT_TRUE(holds(shadow, ":99999999:"));
    expectRefused({{{"user", "age", "jdoe", "--max-days", "5"},
                    "user age: the account's expiry, day '99999999', is not a day that can be "
                    "kept (set it with 'mihost user expire' first)"}});
    EXPECT_EQ(machine::read("/etc/shadow"), shadow);
}

TEST_F(Tasks, RefuseUnknownNamesAndSuggestTheNearest)
{
    expectRefused(
        {{{"user", "delete", "jdo", "-y"}, "user delete: no account 'jdo' (did you mean jdoe?)"},
         {{"user", "set-shell", "nobody-here", "/bin/sh"},
          "user set-shell: no account 'nobody-here' (see 'mihost list users')"},
         {{"group", "add-member", "stuff", "jdoe"},
          "group add-member: no group 'stuff' (did you mean staff?)"},
         {{"group", "remove-member", "crew", "jdo"},
          "group remove-member: no account 'jdo' (did you mean jdoe?)"}},
        4);
}

TEST_F(Tasks, RefuseWrongValuesAndToDeleteUnasked)
{
    expectRefused({
        {{"user", "add", "asmith", "--shell", "bash"},
         "user add: --shell is not an absolute path (it must begin with '/')"},
        {{"user", "age", "jdoe", "--max-days", "-1"},
         "user age: --max-days is not a number (it must be 1 to 9 decimal digits)"},
        {{"user", "age", "jdoe"},
         "user age: nothing to change (use --min-days, --max-days, --warn-days, --inactive-days)"},
        {{"user", "expire", "jdoe", "tomorrow"},
         "user expire: DAY is not a day (use YYYY-MM-DD, such as 2030-12-31)"},
        {{"user", "add", "a;b"}, "user add: NAME contains the shell metacharacter ';'"},
        {{"group", "add", "1000"},
         "group add: NAME consists of digits only, so tools would read it as an id"},
        {{"user", "delete", "jdoe"},
         "user delete: not a terminal (add --yes to delete the account jdoe)"},
        {{"group", "delete", "crew"},
         "group delete: not a terminal (add --yes to delete the group crew)"},
    });
}

TEST_F(Tasks, AskForANewPasswordTwice)
{
    auto const typeAndRepeat = [](std::string const& repeated) {
        TerminalRun run({"user", "set-password", "jdoe"});
        run.waitFor("New password: ");
        run.type("Secret-1\n");
        run.waitFor("Repeat the new password: ");
        run.type(repeated + "\n");
        int const code = run.end();
        EXPECT_FALSE(holds(run.output(), "Secret"));
        return Outcome{code, run.output(), ""};
    };
    std::string const before = machine::read("/etc/shadow");
    Outcome const differing = typeAndRepeat("Secret-2");
    EXPECT_EQ(differing.code, 2);
    EXPECT_TRUE(holds(differing.out, "mihost: user set-password: the passwords differ, so nothing "
                                     "was changed"));
    EXPECT_EQ(machine::read("/etc/shadow"), before);
    EXPECT_EQ(typeAndRepeat("Secret-1").code, 0);
    EXPECT_TRUE(opens("jdoe", "Secret-1"));
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
    struct Row {
        char const* file;
        char const* reason;
    };
    std::vector<Refusal> refusals = {
        {{"user", "set-password", "jdoe"}, "user set-password: Password: standard input is empty"}};
    for (Row const& row : {
             Row{"/root/none",
                 "cannot read the password file '/root/none': No such file or directory"},
             Row{"/root", "cannot read the password file '/root': Is a directory"},
             Row{"/root/two",
                 "the password file '/root/two' has 2 lines (put the password on one line)"},
             Row{"/root/empty",
                 "the password file '/root/empty' has 0 lines (put the password on one line)"},
             Row{"/root/blank", "the password is empty"},
         })
        refusals.push_back({{"user", "set-password", "jdoe", "--password-file", row.file},
                            std::string("user set-password: ") + row.reason});
    expectRefused(refusals);
}

TEST_F(Tasks, ShowAnAccountThatIsNamedLikeATask)
{
    machine::run("useradd -M -c 'Odd Name' add");
    EXPECT_TRUE(holds(mihostRun({"user", "--", "add"}).out, "Odd Name"));
}

TEST_F(Tasks, ReadNoPasswordFromTheScriptOfTheShell)
{
    EXPECT_EQ(mihostRun({"shell"}, "user set-password jdoe\nSecret-1\n"),
              failed(2, "line 1: user set-password: cannot read a password from standard input, "
                        "which is the script (use --password-file FILE)"));
    EXPECT_FALSE(opens("jdoe", "Secret-1"));
    machine::write("/root/secret", "Secret-3\n", 0600);
    EXPECT_EQ(mihostRun({"shell"}, "user set-password jdoe --password-file /root/secret\n").code,
              0);
    EXPECT_TRUE(opens("jdoe", "Secret-3"));
}

} // namespace tasks_test
