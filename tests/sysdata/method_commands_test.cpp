// The shell lines of each method, with each parameter in each relevant place.

#include "tests/support/Lines.h"
#include "tests/sysdata/MethodTest.h"

namespace method_commands_test
{

class Methods : public MethodTest
{
};

TEST_F(Methods, RunExactlyTheseLines)
{
    struct {
        char const* call;
        Lines lines;
    } const cases[] = {
        // of UserAdd
        {"UserAdd,UserName:CMPI_string:jdoe",
         {"/usr/sbin/useradd jdoe 2>&1;echo rc=$? 2>&1", "/usr/bin/chage -E -1 jdoe 2>&1"}},
        {"UserAdd", {"/usr/sbin/useradd 2>&1;echo rc=$? 2>&1", "/usr/bin/chage -E -1 2>&1"}},
        {"UserAdd,UserName:CMPI_string:jdoe,Comment:CMPI_string:Test",
         {"/usr/sbin/useradd jdoe -c Test 2>&1;echo rc=$? 2>&1", "/usr/bin/chage -E -1 jdoe 2>&1"}},
        {"UserAdd,ScriptPath:CMPI_string:/bin/sh,UserName:CMPI_string:jdoe",
         {"/usr/sbin/useradd -s /bin/sh jdoe 2>&1;echo rc=$? 2>&1",
          "/usr/bin/chage -E -1 jdoe 2>&1"}},
        {"UserAdd,UserName:CMPI_string:jdoe,HomeDir:CMPI_string:/home/j,"
         "Comment:CMPI_string:Test",
         {"/usr/sbin/useradd jdoe -d /home/j -m -c Test 2>&1;echo rc=$? 2>&1",
          "/usr/bin/chage -E -1 jdoe 2>&1"}},
        {"UserAdd,UserName:CMPI_string:jdoe,Password:CMPI_string:secret",
         {"/usr/sbin/useradd jdoe -p secret 2>&1;echo rc=$? 2>&1",
          "echo secret | /usr/bin/passwd jdoe --stdin 2>&1", "/usr/bin/chage -E -1 jdoe 2>&1"}},
        {"UserAdd,UserName:CMPI_string:jdoe,GroupName:CMPI_string:staff",
         {"/usr/sbin/useradd jdoe staff 2>&1;echo rc=$? 2>&1", "/usr/bin/chage -E -1 jdoe 2>&1"}},
        // ignores full name whole
        {"UserAdd,UserName:CMPI_string:jdoe,FullName:CMPI_string:John",
         {"/usr/sbin/useradd jdoe 2>&1;echo rc=$? 2>&1", "/usr/bin/chage -E -1 jdoe 2>&1"}},
        // ignores other names whole
        {"UserAdd,Colour:CMPI_string:red,UserName:CMPI_string:jdoe,"
         "UserName:CMPI_uint32:3,daysMustKeepPassword:CMPI_string:4,"
         "Comment:CMPI_dateTime:20101231000000.000000+000,"
         "passwordExpirationDate:CMPI_string:5",
         {"/usr/sbin/useradd jdoe 2>&1;echo rc=$? 2>&1", "/usr/bin/chage -E -1 jdoe 2>&1"}},
        // numbers go to the aging list
        {"UserAdd,daysMustKeepPassword:CMPI_uint32:1,UserName:CMPI_string:jdoe,"
         "daysMustChangePasswordAfter:CMPI_uint32:2,"
         "daysWarnBeforePasswordExpire:CMPI_uint32:3,daysExpireAfter:CMPI_uint32:4",
         {"/usr/sbin/useradd jdoe 2>&1;echo rc=$? 2>&1",
          "/usr/bin/chage -m 1 -M 2 -W 3 -I 4 -E -1 jdoe 2>&1"}},
        // expiry goes to the aging list
        {"UserAdd,passwordExpirationDate:CMPI_dateTime:20101231000000.000000+000,"
         "UserName:CMPI_string:jdoe,daysExpireAfter:CMPI_uint32:4",
         {"/usr/sbin/useradd jdoe 2>&1;echo rc=$? 2>&1",
          "/usr/bin/chage -E 2010-12-31 -I 4 jdoe 2>&1"}},
        // blank expiry ends the aging list
        {"UserAdd,UserName:CMPI_string:jdoe,passwordExpirationDate:CMPI_dateTime:,"
         "daysExpireAfter:CMPI_uint32:4",
         {"/usr/sbin/useradd jdoe 2>&1;echo rc=$? 2>&1", "/usr/bin/chage -E 2>&1"}},
        // escapes blanks
        {"UserAdd,UserName:CMPI_string:j doe,Comment:CMPI_string: two  words",
         {"/usr/sbin/useradd j\\ doe -c \\ two\\ \\ words 2>&1;echo rc=$? 2>&1",
          "/usr/bin/chage -E -1 j doe 2>&1"}},
        // escapes nothing else
        {"UserAdd,UserName:CMPI_string:jdoe,Comment:CMPI_string:a\tb'c\"d\\e$f",
         {"/usr/sbin/useradd jdoe -c a\tb'c\"d\\e$f 2>&1;echo rc=$? 2>&1",
          "/usr/bin/chage -E -1 jdoe 2>&1"}},
        // of UserDel
        {"UserDel,UserName:CMPI_string:jdoe", {"/usr/sbin/userdel jdoe 2>&1"}},
        // no guard for root
        {"UserDel,UserName:CMPI_string:root", {"/usr/sbin/userdel root 2>&1"}},
        // no guard for quoted root
        {"UserDel,UserName:CMPI_string:\"root\"", {"/usr/sbin/userdel \"root\" 2>&1"}},
        // numbers go to the main list
        {"UserDel,UserName:CMPI_string:jdoe,daysExpireAfter:CMPI_uint32:4",
         {"/usr/sbin/userdel jdoe -I 4 2>&1"}},
        // of UserSetAttrib
        // removes an expiry that is not given
        {"UserSetAttrib,UserName:CMPI_string:jdoe,daysMustKeepPassword:CMPI_uint32:3",
         {"/usr/bin/chage jdoe -m 3 -E -1 2>&1"}},
        {"UserSetAttrib,daysExpireAfter:CMPI_uint32:4,"
         "daysMustChangePasswordAfter:CMPI_uint32:2,UserName:CMPI_string:jdoe,"
         "daysWarnBeforePasswordExpire:CMPI_uint32:3,daysMustKeepPassword:CMPI_uint32:1",
         {"/usr/bin/chage -I 4 -M 2 jdoe -W 3 -m 1 -E -1 2>&1"}},
        {"UserSetAttrib,UserName:CMPI_string:jdoe,"
         "passwordExpirationDate:CMPI_dateTime:20100507000000.000000+000,"
         "daysExpireAfter:CMPI_uint32:soon",
         {"/usr/bin/chage jdoe -E 2010-5-7 -I soon 2>&1"}},
        // blank expiry ends the list
        {"UserSetAttrib,UserName:CMPI_string:jdoe,passwordExpirationDate:CMPI_dateTime:,"
         "daysExpireAfter:CMPI_uint32:4",
         {"/usr/bin/chage jdoe -E 2>&1"}},
        // takes numbers unchanged
        {"UserSetAttrib,UserName:CMPI_string:jdoe,daysExpireAfter:CMPI_uint32: 4 5",
         {"/usr/bin/chage jdoe -I  4 5 -E -1 2>&1"}},
        // texts go to the main list
        {"UserSetAttrib,UserName:CMPI_string:jdoe,Comment:CMPI_string:Test",
         {"/usr/bin/chage jdoe -c Test -E -1 2>&1"}},
        // of LocalGroupAdd and LocalGroupDel
        {"LocalGroupAdd,GroupName:CMPI_string:staff", {"/usr/sbin/groupadd staff 2>&1"}},
        {"LocalGroupAdd,GroupName:CMPI_string:staff,"
         "daysExpireAfter:CMPI_uint32:4",
         {"/usr/sbin/groupadd staff -I 4 2>&1"}},
        {"LocalGroupDel,UserName:CMPI_string:jdoe,GroupName:CMPI_string:staff",
         {"/usr/sbin/groupdel jdoe staff 2>&1"}},
        {"LocalGroupDel,GroupName:CMPI_string:my staff", {"/usr/sbin/groupdel my\\ staff 2>&1"}},
        // of the methods that run usermod
        {"UserSetFullName,UserName:CMPI_string:jdoe,FullName:CMPI_string:John Smith",
         {"/usr/sbin/usermod -c John\\ Smith jdoe 2>&1"}},
        {"UserSetScriptPath,UserName:CMPI_string:jdoe,ScriptPath:CMPI_string:/bin/false",
         {"/usr/sbin/usermod -s /bin/false jdoe 2>&1"}},
        {"UserSetHomeDir,UserName:CMPI_string:jdoe,HomeDir:CMPI_string:/home/j2",
         {"/usr/sbin/usermod -d /home/j2 -m jdoe 2>&1"}},
        {"UserSetPassword,Password:CMPI_string:se cret,UserName:CMPI_string:jdoe",
         {"/usr/sbin/usermod -p se\\ cret jdoe 2>&1",
          "echo se cret | /usr/bin/passwd jdoe --stdin 2>&1"}},
        // puts the raw account name last
        {"UserSetHomeDir,UserName:CMPI_string:j doe,HomeDir:CMPI_string:/h,"
         "Comment:CMPI_string:Test,daysExpireAfter:CMPI_uint32:4,"
         "passwordExpirationDate:CMPI_dateTime:20101231000000.000000+000",
         {"/usr/sbin/usermod -d /h -m -c Test -I 4 -E 2010-12-31 j doe 2>&1"}},
        // full name is for its own method only
        {"UserSetHomeDir,FullName:CMPI_string:John,UserName:CMPI_string:jdoe",
         {"/usr/sbin/usermod jdoe 2>&1"}},
        // takes the last of several account names
        {"UserSetScriptPath,UserName:CMPI_string:one,ScriptPath:CMPI_string:/bin/sh,"
         "UserName:CMPI_string:two",
         {"/usr/sbin/usermod -s /bin/sh two 2>&1"}},
        // of any method
        // echo the code if useradd is in the line
        {"UserDel,UserName:CMPI_string:useradder",
         {"/usr/sbin/userdel useradder 2>&1;echo rc=$? 2>&1"}},
        // run with the parameters before a blank one
        {"UserSetHomeDir,UserName:CMPI_string:jdoe,HomeDir:CMPI_string:",
         {"/usr/sbin/usermod jdoe 2>&1"}},
    };
    for (auto const& [text, lines] : cases) {
        commands_.ran.clear();
        commands_.modes.clear();
        EXPECT_TRUE(call(text)) << text;
        EXPECT_EQ(commands_.ran, lines) << text;
        EXPECT_EQ(commands_.modes, Lines(lines.size(), "r"));
        EXPECT_EQ(commands_.open, 0);
    }
}

TEST_F(Methods, PassTheRedhatOptionToUseraddOnly)
{
    files_.write("/etc/redhat-release", "");
    std::string const line = "/usr/sbin/useradd -n jdoe 2>&1;echo rc=$? 2>&1";
    commands_.answers[line] = "rc=0\n";
    EXPECT_TRUE(call("UserAdd,UserName:CMPI_string:jdoe"));
    EXPECT_TRUE(call("UserDel,UserName:CMPI_string:jdoe"));
    EXPECT_EQ(commands_.ran,
              (Lines{line, "/usr/bin/chage -E -1 jdoe 2>&1", "/usr/sbin/userdel jdoe 2>&1"}));
}

TEST_F(Methods, OmitAnEmptyPathAndEndAtAnyOtherEmptyValue)
{
    EXPECT_EQ(execute("UserSetHomeDir", {text("HomeDir", ""), text("ScriptPath", ""),
                                         text("Comment", "x"), text("UserName", "jdoe")}),
              0);
    EXPECT_EQ(execute("UserSetFullName", {text("FullName", ""), text("UserName", "jdoe")}), 0);
    EXPECT_EQ(commands_.ran,
              (Lines{"/usr/sbin/usermod -c x jdoe 2>&1", "/usr/sbin/usermod -c 2>&1"}));
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

TEST_F(Methods, DoNothingForATextWithoutAMethodOrARejectedOne)
{
    for (char const* text : {"", ",,", "UserDel,UserName:CMPI_string:jdoe,Colour:CMPI_boolean:red"})
        EXPECT_FALSE(call(text)) << text;
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
    for (bool const expected : {false, true}) {
        shadowing_ = !expected;
        EXPECT_EQ(ask(), 0);
        EXPECT_EQ(shadowing_, expected);
        EXPECT_TRUE(call("GetShadowing")); // in either case
        files_.write("/etc/shadow", "");
    }
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
