// What the account tools print decides whether a method succeeded.

#include "tests/sysdata/MethodTest.h"

namespace method_judging_test
{

class Judging : public MethodTest
{
protected:
    /** The status of one method whose main command prints this. */
    int statusOf(std::string const& output)
    {
        commands_.answers["/usr/sbin/userdel jdoe 2>&1"] = output;
        return execute("UserDel", {text("UserName", "jdoe")});
    }

    /** The status of UserAdd whose two commands print these. */
    int statusOf(std::string const& useradd, std::string const& chage)
    {
        commands_.answers[useraddLine_] = useradd;
        commands_.answers[chageLine_] = chage;
        return execute("UserAdd", {text("UserName", "jdoe")});
    }

    std::string const useraddLine_ = "/usr/sbin/useradd jdoe 2>&1;echo rc=$? 2>&1";
    std::string const chageLine_ = "/usr/bin/chage -E -1 jdoe 2>&1";
};

TEST_F(Judging, TreatsSilenceAndFourKnownBeginningsAsSuccess)
{
    for (char const* output :
         {"", "Aging information changed", "Aging information changed.\n",
          "Aging information not changed.\nand more\n", "no crontab for", "no crontab for jdoe\n",
          "usermod: no changes", "usermod: no changes\n"})
        EXPECT_EQ(statusOf(output), 0) << output;
    for (std::string const& output :
         {std::string("userdel: user 'jdoe' does not exist\n"), std::string("\n"), std::string("x"),
          std::string("\0", 1), std::string(" Aging information changed\n"),
          std::string("userdel: no crontab for jdoe\n"), std::string("Aging information change"),
          std::string("no crontab fo"), std::string("usermod: no change"),
          std::string("aging information changed\n"), std::string("rc=0\n")})
        EXPECT_EQ(statusOf(output), 1) << output;
}

TEST_F(Judging, FailsIfTheMainCommandCannotBeStarted)
{
    commands_.otherwise.reset();
    Recording const log;
    EXPECT_EQ(execute("UserDel", {text("UserName", "jdoe")}), 1);
    EXPECT_EQ(log.texts(6000), Lines{"Cannot open process: /usr/sbin/userdel"});
}

TEST_F(Judging, AcceptsTheNoticeOfChageForUserSetAttrib)
{
    std::string const line = "/usr/bin/chage jdoe -m 3 -E -1 2>&1";
    commands_.answers[line] = "Aging information changed.\n";
    EXPECT_TRUE(call("UserSetAttrib,UserName:CMPI_string:jdoe,daysMustKeepPassword:CMPI_uint32:3"));
    EXPECT_EQ(commands_.ran, Lines{line});
}

TEST_F(Judging, SetsTheAgeingOfANewUserUnlessUseraddFails)
{
    struct {
        char const* useradd;
        char const* chage;
        int status;
    } const cases[] = {
        {"rc=0\n", "", 0},
        {"useradd: warning: the home directory already exists.\nrc=0\n", "", 0},
        {"no crontab for jdoe\nrc=9\n", "", 0},
        {"usermod: no changes\nrc=9\n", "", 0},
        {"useradd: src=0\nrc=9\n", "", 0},
        {"rc=0\n", "chage: invalid date\n", 1},
        {"rc=0\n", "Aging information changed\n", 0},
        {"rc=0\n", "Aging information not changed\n", 0},
        {"rc=0\n", "chage: Aging information changed\n", 1},
        {"rc=0\n", "no crontab for jdoe\n", 1},
        {"rc=0\n", "usermod: no changes\n", 1},
        {"rc=0\n", "rc=0\n", 1},
    };
    for (auto const& [useradd, chage, status] : cases) {
        commands_.ran.clear();
        Recording const log;
        EXPECT_EQ(statusOf(useradd, chage), status) << useradd << chage;
        EXPECT_EQ(commands_.ran, (Lines{useraddLine_, chageLine_}));
        EXPECT_EQ(log.remarks(), (Lines{std::string("outputBuffer: ") + useradd,
                                        std::string("outputBuffer: ") + chage}));
    }
    commands_.ran.clear();
    EXPECT_EQ(statusOf("useradd: user 'jdoe' already exists\nrc=9\n", ""), 1);
    EXPECT_EQ(commands_.ran, Lines{useraddLine_});
}

TEST_F(Judging, FailsIfTheAgeingOfANewUserCannotBeStarted)
{
    commands_.otherwise.reset();
    commands_.answers[useraddLine_] = "Aging information changed\nrc=0\n";
    EXPECT_EQ(execute("UserAdd", {text("UserName", "jdoe")}), 1);
    EXPECT_EQ(commands_.ran, (Lines{useraddLine_, chageLine_}));
}

class SettingAPassword : public Judging
{
protected:
    std::string const usermodLine_ = "/usr/sbin/usermod -p secret jdoe 2>&1";
    std::string const passwdLine_ = "echo secret | /usr/bin/passwd jdoe --stdin 2>&1";

    int setPassword()
    {
        return execute("UserSetPassword", {text("UserName", "jdoe"), text("Password", "secret")});
    }
};

TEST_F(SettingAPassword, IgnoresTheOutputOfPasswd)
{
    commands_.answers[passwdLine_] = "passwd: unrecognized option '--stdin'\n";
    EXPECT_EQ(setPassword(), 0);
    EXPECT_EQ(commands_.ran, (Lines{usermodLine_, passwdLine_}));
}

TEST_F(SettingAPassword, StopsIfTheMainCommandFails)
{
    commands_.answers[usermodLine_] = "usermod: user 'jdoe' does not exist\n";
    EXPECT_EQ(setPassword(), 1);
    EXPECT_EQ(commands_.ran, Lines{usermodLine_});
    commands_.ran.clear();
    commands_.answers[usermodLine_] = "usermod: no changes\n";
    EXPECT_EQ(setPassword(), 0);
    EXPECT_EQ(commands_.ran, (Lines{usermodLine_, passwdLine_}));
}

TEST_F(SettingAPassword, ComesBetweenTheTwoCommandsOfUserAdd)
{
    std::string const useraddLine = "/usr/sbin/useradd -p secret jdoe 2>&1;echo rc=$? 2>&1";
    commands_.answers[useraddLine] = "rc=0\n";
    EXPECT_EQ(execute("UserAdd", {text("Password", "secret"), text("UserName", "jdoe")}), 0);
    EXPECT_EQ(commands_.ran, (Lines{useraddLine, passwdLine_, chageLine_}));
}

TEST_F(SettingAPassword, IsDoneForAnyMethodWithAPassword)
{
    EXPECT_EQ(execute("UserSetFullName", {text("UserName", "jdoe"), text("FullName", "J"),
                                          text("Password", "secret")}),
              0);
    EXPECT_EQ(commands_.ran, (Lines{"/usr/sbin/usermod -c J -p secret jdoe 2>&1", passwdLine_}));
}

TEST_F(SettingAPassword, RunsIncompleteLinesForAnEmptyOne)
{
    EXPECT_EQ(execute("UserSetPassword", {text("UserName", "jdoe"), text("Password", "")}), 0);
    EXPECT_EQ(commands_.ran, (Lines{"/usr/sbin/usermod -p 2>&1", "echo 2>&1"}));
}

TEST_F(SettingAPassword, RunsNothingWithoutAUserName)
{
    Recording const log;
    EXPECT_EQ(execute("LocalGroupAdd", {text("GroupName", "g"), text("Password", "secret")}), 0);
    EXPECT_EQ(commands_.ran, Lines{"/usr/sbin/groupadd g -p secret 2>&1"});
    EXPECT_EQ(log.texts(6000), Lines{"No user name for the password"});
}

} // namespace method_judging_test
