// The shell lines of each method, with each parameter in each relevant place.

#include "tests/support/Lines.h"
#include "tests/sysdata/MethodTest.h"

#include <ostream>

namespace method_commands_test
{

struct LineCase {
    char const* name;
    char const* call;
    Lines lines;
};

[[maybe_unused]] void PrintTo(LineCase const& test, std::ostream* out)
{
    *out << test.call;
}

std::string nameOf(testing::TestParamInfo<LineCase> const& test)
{
    return test.param.name;
}

class MethodLines : public MethodTest, public testing::WithParamInterface<LineCase>
{
};

TEST_P(MethodLines, AreExactlyThese)
{
    EXPECT_TRUE(call(GetParam().call));
    EXPECT_EQ(commands_.ran, GetParam().lines);
    EXPECT_EQ(commands_.open, 0);
}

INSTANTIATE_TEST_SUITE_P(
    OfUserAdd, MethodLines,
    testing::Values(
        LineCase{"Plain",
                 "UserAdd,UserName:CMPI_string:jdoe",
                 {"/usr/sbin/useradd jdoe 2>&1;echo rc=$? 2>&1", "/usr/bin/chage -E -1 jdoe 2>&1"}},
        LineCase{"WithoutUserName",
                 "UserAdd",
                 {"/usr/sbin/useradd 2>&1;echo rc=$? 2>&1", "/usr/bin/chage -E -1 2>&1"}},
        LineCase{"Comment",
                 "UserAdd,UserName:CMPI_string:jdoe,Comment:CMPI_string:Test",
                 {"/usr/sbin/useradd jdoe -c Test 2>&1;echo rc=$? 2>&1",
                  "/usr/bin/chage -E -1 jdoe 2>&1"}},
        LineCase{"ScriptPath",
                 "UserAdd,ScriptPath:CMPI_string:/bin/sh,UserName:CMPI_string:jdoe",
                 {"/usr/sbin/useradd -s /bin/sh jdoe 2>&1;echo rc=$? 2>&1",
                  "/usr/bin/chage -E -1 jdoe 2>&1"}},
        LineCase{"HomeDir",
                 "UserAdd,UserName:CMPI_string:jdoe,HomeDir:CMPI_string:/home/j,"
                 "Comment:CMPI_string:Test",
                 {"/usr/sbin/useradd jdoe -d /home/j -m -c Test 2>&1;echo rc=$? 2>&1",
                  "/usr/bin/chage -E -1 jdoe 2>&1"}},
        LineCase{"Password",
                 "UserAdd,UserName:CMPI_string:jdoe,Password:CMPI_string:secret",
                 {"/usr/sbin/useradd jdoe -p secret 2>&1;echo rc=$? 2>&1",
                  "echo secret | /usr/bin/passwd jdoe --stdin 2>&1",
                  "/usr/bin/chage -E -1 jdoe 2>&1"}},
        LineCase{"GroupName",
                 "UserAdd,UserName:CMPI_string:jdoe,GroupName:CMPI_string:staff",
                 {"/usr/sbin/useradd jdoe staff 2>&1;echo rc=$? 2>&1",
                  "/usr/bin/chage -E -1 jdoe 2>&1"}},
        LineCase{"IgnoresFullNameWhole",
                 "UserAdd,UserName:CMPI_string:jdoe,FullName:CMPI_string:John",
                 {"/usr/sbin/useradd jdoe 2>&1;echo rc=$? 2>&1", "/usr/bin/chage -E -1 jdoe 2>&1"}},
        LineCase{"IgnoresOtherNamesWhole",
                 "UserAdd,Colour:CMPI_string:red,UserName:CMPI_string:jdoe,"
                 "UserName:CMPI_uint32:3,daysMustKeepPassword:CMPI_string:4,"
                 "Comment:CMPI_dateTime:20101231000000.000000+000,"
                 "passwordExpirationDate:CMPI_string:5",
                 {"/usr/sbin/useradd jdoe 2>&1;echo rc=$? 2>&1", "/usr/bin/chage -E -1 jdoe 2>&1"}},
        LineCase{"NumbersGoToTheAgingList",
                 "UserAdd,daysMustKeepPassword:CMPI_uint32:1,UserName:CMPI_string:jdoe,"
                 "daysMustChangePasswordAfter:CMPI_uint32:2,"
                 "daysWarnBeforePasswordExpire:CMPI_uint32:3,daysExpireAfter:CMPI_uint32:4",
                 {"/usr/sbin/useradd jdoe 2>&1;echo rc=$? 2>&1",
                  "/usr/bin/chage -m 1 -M 2 -W 3 -I 4 -E -1 jdoe 2>&1"}},
        LineCase{"ExpiryGoesToTheAgingList",
                 "UserAdd,passwordExpirationDate:CMPI_dateTime:20101231000000.000000+000,"
                 "UserName:CMPI_string:jdoe,daysExpireAfter:CMPI_uint32:4",
                 {"/usr/sbin/useradd jdoe 2>&1;echo rc=$? 2>&1",
                  "/usr/bin/chage -E 2010-12-31 -I 4 jdoe 2>&1"}},
        LineCase{"BlankExpiryEndsTheAgingList",
                 "UserAdd,UserName:CMPI_string:jdoe,passwordExpirationDate:CMPI_dateTime:,"
                 "daysExpireAfter:CMPI_uint32:4",
                 {"/usr/sbin/useradd jdoe 2>&1;echo rc=$? 2>&1", "/usr/bin/chage -E 2>&1"}},
        LineCase{"EscapesBlanks",
                 "UserAdd,UserName:CMPI_string:j doe,Comment:CMPI_string: two  words",
                 {"/usr/sbin/useradd j\\ doe -c \\ two\\ \\ words 2>&1;echo rc=$? 2>&1",
                  "/usr/bin/chage -E -1 j doe 2>&1"}},
        LineCase{"EscapesNothingElse",
                 "UserAdd,UserName:CMPI_string:jdoe,Comment:CMPI_string:a\tb'c\"d\\e$f",
                 {"/usr/sbin/useradd jdoe -c a\tb'c\"d\\e$f 2>&1;echo rc=$? 2>&1",
                  "/usr/bin/chage -E -1 jdoe 2>&1"}}),
    nameOf);

INSTANTIATE_TEST_SUITE_P(
    OfUserDel, MethodLines,
    testing::Values(
        LineCase{"Plain", "UserDel,UserName:CMPI_string:jdoe", {"/usr/sbin/userdel jdoe 2>&1"}},
        LineCase{
            "NoGuardForRoot", "UserDel,UserName:CMPI_string:root", {"/usr/sbin/userdel root 2>&1"}},
        LineCase{"NoGuardForQuotedRoot",
                 "UserDel,UserName:CMPI_string:\"root\"",
                 {"/usr/sbin/userdel \"root\" 2>&1"}},
        LineCase{"NumbersGoToTheMainList",
                 "UserDel,UserName:CMPI_string:jdoe,daysExpireAfter:CMPI_uint32:4",
                 {"/usr/sbin/userdel jdoe -I 4 2>&1"}}),
    nameOf);

INSTANTIATE_TEST_SUITE_P(
    OfUserSetAttrib, MethodLines,
    testing::Values(
        LineCase{"RemovesAnExpiryThatIsNotGiven",
                 "UserSetAttrib,UserName:CMPI_string:jdoe,daysMustKeepPassword:CMPI_uint32:3",
                 {"/usr/bin/chage jdoe -m 3 -E -1 2>&1"}},
        LineCase{"KeepsTheOrderWritten",
                 "UserSetAttrib,daysExpireAfter:CMPI_uint32:4,"
                 "daysMustChangePasswordAfter:CMPI_uint32:2,UserName:CMPI_string:jdoe,"
                 "daysWarnBeforePasswordExpire:CMPI_uint32:3,daysMustKeepPassword:CMPI_uint32:1",
                 {"/usr/bin/chage -I 4 -M 2 jdoe -W 3 -m 1 -E -1 2>&1"}},
        LineCase{"SetsAnExpiry",
                 "UserSetAttrib,UserName:CMPI_string:jdoe,"
                 "passwordExpirationDate:CMPI_dateTime:20100507000000.000000+000,"
                 "daysExpireAfter:CMPI_uint32:soon",
                 {"/usr/bin/chage jdoe -E 2010-5-7 -I soon 2>&1"}},
        LineCase{"BlankExpiryEndsTheList",
                 "UserSetAttrib,UserName:CMPI_string:jdoe,passwordExpirationDate:CMPI_dateTime:,"
                 "daysExpireAfter:CMPI_uint32:4",
                 {"/usr/bin/chage jdoe -E 2>&1"}},
        LineCase{"TakesNumbersUnchanged",
                 "UserSetAttrib,UserName:CMPI_string:jdoe,daysExpireAfter:CMPI_uint32: 4 5",
                 {"/usr/bin/chage jdoe -I  4 5 -E -1 2>&1"}},
        LineCase{"TextsGoToTheMainList",
                 "UserSetAttrib,UserName:CMPI_string:jdoe,Comment:CMPI_string:Test",
                 {"/usr/bin/chage jdoe -c Test -E -1 2>&1"}}),
    nameOf);

INSTANTIATE_TEST_SUITE_P(
    OfLocalGroups, MethodLines,
    testing::Values(LineCase{"Add",
                             "LocalGroupAdd,GroupName:CMPI_string:staff",
                             {"/usr/sbin/groupadd staff 2>&1"}},
                    LineCase{"AddKeepsTheOrderWritten",
                             "LocalGroupAdd,GroupName:CMPI_string:staff,"
                             "daysExpireAfter:CMPI_uint32:4",
                             {"/usr/sbin/groupadd staff -I 4 2>&1"}},
                    LineCase{"DelKeepsTheOrderWritten",
                             "LocalGroupDel,UserName:CMPI_string:jdoe,GroupName:CMPI_string:staff",
                             {"/usr/sbin/groupdel jdoe staff 2>&1"}},
                    LineCase{"Del",
                             "LocalGroupDel,GroupName:CMPI_string:my staff",
                             {"/usr/sbin/groupdel my\\ staff 2>&1"}}),
    nameOf);

INSTANTIATE_TEST_SUITE_P(
    OfUsermod, MethodLines,
    testing::Values(
        LineCase{"FullName",
                 "UserSetFullName,UserName:CMPI_string:jdoe,FullName:CMPI_string:John Smith",
                 {"/usr/sbin/usermod -c John\\ Smith jdoe 2>&1"}},
        LineCase{"ScriptPath",
                 "UserSetScriptPath,UserName:CMPI_string:jdoe,ScriptPath:CMPI_string:/bin/false",
                 {"/usr/sbin/usermod -s /bin/false jdoe 2>&1"}},
        LineCase{"HomeDir",
                 "UserSetHomeDir,UserName:CMPI_string:jdoe,HomeDir:CMPI_string:/home/j2",
                 {"/usr/sbin/usermod -d /home/j2 -m jdoe 2>&1"}},
        LineCase{"Password",
                 "UserSetPassword,Password:CMPI_string:se cret,UserName:CMPI_string:jdoe",
                 {"/usr/sbin/usermod -p se\\ cret jdoe 2>&1",
                  "echo se cret | /usr/bin/passwd jdoe --stdin 2>&1"}},
        LineCase{"PutsTheRawAccountNameLast",
                 "UserSetHomeDir,UserName:CMPI_string:j doe,HomeDir:CMPI_string:/h,"
                 "Comment:CMPI_string:Test,daysExpireAfter:CMPI_uint32:4,"
                 "passwordExpirationDate:CMPI_dateTime:20101231000000.000000+000",
                 {"/usr/sbin/usermod -d /h -m -c Test -I 4 -E 2010-12-31 j doe 2>&1"}},
        LineCase{"FullNameIsForItsOwnMethodOnly",
                 "UserSetHomeDir,FullName:CMPI_string:John,UserName:CMPI_string:jdoe",
                 {"/usr/sbin/usermod jdoe 2>&1"}},
        LineCase{"TakesTheLastOfSeveralAccountNames",
                 "UserSetScriptPath,UserName:CMPI_string:one,ScriptPath:CMPI_string:/bin/sh,"
                 "UserName:CMPI_string:two",
                 {"/usr/sbin/usermod -s /bin/sh two 2>&1"}}),
    nameOf);

INSTANTIATE_TEST_SUITE_P(
    OfAnyMethod, MethodLines,
    testing::Values(LineCase{"EchoTheCodeIfUseraddIsInTheLine",
                             "UserDel,UserName:CMPI_string:useradder",
                             {"/usr/sbin/userdel useradder 2>&1;echo rc=$? 2>&1"}},
                    LineCase{"RunWithTheParametersBeforeABlankOne",
                             "UserSetHomeDir,UserName:CMPI_string:jdoe,HomeDir:CMPI_string:",
                             {"/usr/sbin/usermod jdoe 2>&1"}}),
    nameOf);

class Methods : public MethodTest
{
};

TEST_F(Methods, AddUsersWithoutAGroupOnARedhatMachine)
{
    files_.write("/etc/redhat-release", "");
    std::string const line = "/usr/sbin/useradd -n jdoe 2>&1;echo rc=$? 2>&1";
    commands_.answers[line] = "rc=0\n";
    EXPECT_TRUE(call("UserAdd,UserName:CMPI_string:jdoe"));
    EXPECT_EQ(commands_.ran, (Lines{line, "/usr/bin/chage -E -1 jdoe 2>&1"}));
}

TEST_F(Methods, PassTheRedhatOptionToUseraddOnly)
{
    files_.write("/etc/redhat-release", "");
    EXPECT_TRUE(call("UserDel,UserName:CMPI_string:jdoe"));
    EXPECT_EQ(commands_.ran, Lines{"/usr/sbin/userdel jdoe 2>&1"});
}

TEST_F(Methods, OmitTheOptionOfAnEmptyPath)
{
    EXPECT_EQ(execute("UserSetHomeDir", {text("HomeDir", ""), text("ScriptPath", ""),
                                         text("Comment", "x"), text("UserName", "jdoe")}),
              0);
    EXPECT_EQ(commands_.ran, Lines{"/usr/sbin/usermod -c x jdoe 2>&1"});
}

TEST_F(Methods, EndTheListAtAnyOtherEmptyValue)
{
    EXPECT_EQ(execute("UserSetFullName", {text("FullName", ""), text("UserName", "jdoe")}), 0);
    EXPECT_EQ(commands_.ran, Lines{"/usr/sbin/usermod -c 2>&1"});
}

TEST_F(Methods, RefuseAnUnknownNameWithoutRunningAnything)
{
    for (char const* name : {"", "useradd", "userAdd", "UserAdd ", "UserSetShell"}) {
        Recording const log;
        EXPECT_EQ(execute(name, {text("UserName", "jdoe")}), 1);
        EXPECT_EQ(log.texts(6000), Lines{std::string("Unknown method: ") + name});
    }
    EXPECT_EQ(commands_.ran, Lines());
}

TEST_F(Methods, RefuseAnUnknownParameterTypeWithoutRunningAnything)
{
    Recording const log;
    EXPECT_EQ(execute("UserAdd", {text("UserName", "jdoe"), {"Colour", "CMPI_boolean", "red"}}), 1);
    EXPECT_EQ(log.texts(6000), Lines{"Unknown parameter type: CMPI_boolean"});
    EXPECT_EQ(commands_.ran, Lines());
}

TEST_F(Methods, OpenPipesForReading)
{
    std::string mode;
    libc::hooks().popen = [&](char const*, char const* asked) -> FILE* {
        mode = asked;
        return nullptr;
    };
    execute("UserDel", {text("UserName", "jdoe")});
    EXPECT_EQ(mode, "r");
}

TEST_F(Methods, DoNothingForATextWithoutAMethod)
{
    EXPECT_FALSE(call(""));
    EXPECT_FALSE(call(",,"));
    EXPECT_EQ(commands_.ran, Lines());
}

TEST_F(Methods, DoNothingForARejectedText)
{
    EXPECT_FALSE(call("UserDel,UserName:CMPI_string:jdoe,Colour:CMPI_boolean:red"));
    EXPECT_EQ(commands_.ran, Lines());
}

class Shadowing : public MethodTest
{
protected:
    bool shadowing_ = false;

    int ask()
    {
        return NQ::OsInfo().executeMethod("GetShadowing", {text("UserName", "jdoe")}, shadowing_);
    }
};

TEST_F(Shadowing, IsReportedIfTheShadowFileCanBeOpened)
{
    files_.write("/etc/shadow", "");
    EXPECT_EQ(ask(), 0);
    EXPECT_TRUE(shadowing_);
    EXPECT_EQ(commands_.ran, Lines());
}

TEST_F(Shadowing, IsNotReportedWithoutAShadowFile)
{
    shadowing_ = true;
    EXPECT_EQ(ask(), 0);
    EXPECT_FALSE(shadowing_);
    EXPECT_EQ(commands_.ran, Lines());
}

TEST_F(Methods, LogUnderTheNamesThatHostsKnow)
{
    Recording const log;
    EXPECT_TRUE(call("UserDel,UserName:CMPI_string:jdoe"));
    Lines found;
    for (LogRecord const& record : log.records()) {
        if (record.trace || record.file != "osInfo_linux" ||
            record.function == "parseMethodAndParams")
            continue;
        EXPECT_EQ(record.category, "Veltrix.IC.MI.OsSwMI.OsInfo");
        EXPECT_EQ(record.level, 3000);
        found.push_back(record.function + " | " + record.text);
    }
    EXPECT_EQ(
        found,
        (Lines{"setCreateUser | OsNode::setCreateUser: entry",
               "executeMethod | OsNode::executeMethod: entry",
               "executeCommand | executeCommand: entry", "executeCommand | executeCommand: exit",
               "executeMethod | outputBuffer: ", "executeMethod | OsNode::executeMethod: exit",
               "setCreateUser | OsNode::setCreateUser: exit"}));
}

TEST_F(Methods, LogTheirExitOnEveryPath)
{
    for (char const* text : {"UserSetShell", "UserDel,A:CMPI_boolean:b", "GetShadowing",
                             "LocalGroupAddUser", "UserDel,UserName:CMPI_string:jdoe"}) {
        Recording const log;
        call(text);
        EXPECT_EQ(log.texts().front(), "OsNode::setCreateUser: entry");
        EXPECT_EQ(log.texts().back(), "OsNode::setCreateUser: exit");
        EXPECT_EQ(log.has("OsNode::executeMethod: entry", 3000),
                  log.has("OsNode::executeMethod: exit", 3000));
    }
}

TEST_F(Shadowing, DoesNotAffectTheResultOfACall)
{
    EXPECT_TRUE(call("GetShadowing"));
    files_.write("/etc/shadow", "");
    EXPECT_TRUE(call("GetShadowing"));
}

TEST_F(Shadowing, IsKeptByEveryOtherMethod)
{
    for (bool const before : {true, false}) {
        for (char const* method :
             {"UserAdd", "UserDel", "UserSetAttrib", "LocalGroupAdd", "LocalGroupDel",
              "LocalGroupAddUser", "LocalGroupDelUser", "UserSetFullName", "UserSetScriptPath",
              "UserSetHomeDir", "UserSetPassword", "Unknown"}) {
            shadowing_ = before;
            NQ::OsInfo().executeMethod(method, {text("UserName", "jdoe")}, shadowing_);
            EXPECT_EQ(shadowing_, before) << method;
        }
        files_.write("/etc/shadow", "");
    }
}

} // namespace method_commands_test
