// A call that does not fit its command lines runs nothing at all; nothing is ever cut.

#include "tests/sysdata/MethodTest.h"

namespace method_limits_test
{

using Params = std::vector<NQ::ParamInfo>;

class MethodLimits : public MethodTest
{
protected:
    /** Expects that the call runs nothing and logs one message at level 6000. */
    void expectRefused(std::string const& method, Params const& params, std::string const& program)
    {
        commands_.ran.clear();
        Recording const log;
        EXPECT_EQ(execute(method, params), 1);
        EXPECT_EQ(commands_.ran, Lines());
        EXPECT_EQ(log.texts(6000), Lines{"Command line too long: " + program});
    }

    void expectRun(std::string const& method, Params const& params, std::string const& line)
    {
        commands_.ran.clear();
        Recording const log;
        EXPECT_EQ(execute(method, params), 0);
        ASSERT_FALSE(commands_.ran.empty());
        EXPECT_EQ(commands_.ran.front(), line);
        EXPECT_EQ(log.texts(6000), Lines());
    }

    static std::string repeated(std::string const& text, int count)
    {
        std::string all;
        for (; count > 0; --count)
            all += text;
        return all;
    }
};

TEST_F(MethodLimits, Are39Arguments)
{
    // With the account name that usermod takes last, and with the closing arguments of chage.
    struct {
        char const* method;
        std::string program;
        int groups;
        Params others;
        std::string end;
    } const cases[] = {
        {"LocalGroupAdd", "/usr/sbin/groupadd", 39, {}, ""},
        {"UserSetHomeDir", "/usr/sbin/usermod", 38, {text("UserName", "jdoe")}, " jdoe"},
        {"UserSetAttrib", "/usr/bin/chage", 36, {text("UserName", "jdoe")}, " jdoe -E -1"}};
    for (auto const& [method, program, groups, others, end] : cases) {
        Params params(static_cast<std::size_t>(groups), text("GroupName", "g"));
        params.insert(params.end(), others.begin(), others.end());
        expectRun(method, params, program + repeated(" g", groups) + end + " 2>&1");
        params.push_back(text("GroupName", "g"));
        expectRefused(method, params, program);
    }
}

TEST_F(MethodLimits, HoldForTheAgingListBeforeAnythingRuns)
{
    Params params(18, {"daysExpireAfter", "CMPI_uint32", "1"});
    params.push_back(text("UserName", "jdoe"));
    expectRun("UserAdd", params, "/usr/sbin/useradd jdoe 2>&1;echo rc=$? 2>&1");
    EXPECT_EQ(commands_.ran.at(1), "/usr/bin/chage" + repeated(" -I 1", 18) + " -E -1 jdoe 2>&1");
    params.push_back({"daysExpireAfter", "CMPI_uint32", "1"});
    expectRefused("UserAdd", params, "/usr/bin/chage");
}

TEST_F(MethodLimits, Are254CharactersInAnArgument)
{
    std::string const longest(254, 'x');
    expectRun("UserDel", {text("UserName", longest)}, "/usr/sbin/userdel " + longest + " 2>&1");
    expectRefused("UserDel", {text("UserName", longest + "x")}, "/usr/sbin/userdel");
    expectRefused("UserAdd", {text("UserName", "jdoe"), text("Comment", longest + "x")},
                  "/usr/sbin/useradd");
    expectRefused("UserAdd",
                  {text("UserName", "jdoe"), {"daysExpireAfter", "CMPI_uint32", longest + "1"}},
                  "/usr/bin/chage");
    expectRefused("UserSetPassword", {text("UserName", "jdoe"), text("Password", longest + "x")},
                  "/usr/sbin/usermod");
}

TEST_F(MethodLimits, CountTheBackslashesOfEscapedBlanks)
{
    std::string const blanks(127, ' ');
    expectRun("UserSetFullName", {text("FullName", blanks), text("UserName", "jdoe")},
              "/usr/sbin/usermod -c " + repeated("\\ ", 127) + " jdoe 2>&1");
    expectRefused("UserSetFullName", {text("FullName", blanks + "x"), text("UserName", "jdoe")},
                  "/usr/sbin/usermod");
}

TEST_F(MethodLimits, DoNotCountWhatIsIgnored)
{
    expectRun("UserDel",
              {text("UserName", "jdoe"), text("Colour", std::string(6000, 'x')),
               text("FullName", std::string(6000, 'x'))},
              "/usr/sbin/userdel jdoe 2>&1");
}

TEST_F(MethodLimits, Are4999CharactersInALine)
{
    // The program has 18 characters, each argument brings a blank, and " 2>&1" ends the line.
    std::string const longest(254, 'x');
    std::string const last(4999 - 18 - 19 * 255 - 1 - 5, 'x');
    Params params(19, text("GroupName", longest));
    params.push_back(text("GroupName", last));
    std::string const line =
        "/usr/sbin/groupadd" + repeated(" " + longest, 19) + " " + last + " 2>&1";
    ASSERT_EQ(line.size(), 4999U);
    expectRun("LocalGroupAdd", params, line);
    params.back().value += "x";
    expectRefused("LocalGroupAdd", params, "/usr/sbin/groupadd");
}

TEST_F(MethodLimits, HoldForTheAgingLineBeforeAnythingRuns)
{
    // The program has 14 characters, each option with its value 258, and " 2>&1" ends the line.
    std::string const longest(254, '1');
    std::string const user(4999 - 14 - 19 * 258 - 1 - 5, 'x');
    Params params(18, {"daysExpireAfter", "CMPI_uint32", longest});
    params.push_back({"passwordExpirationDate", "CMPI_dateTime", longest});
    params.push_back(text("UserName", user));
    expectRun("UserAdd", params, "/usr/sbin/useradd " + user + " 2>&1;echo rc=$? 2>&1");
    ASSERT_EQ(commands_.ran.size(), 2U);
    EXPECT_EQ(commands_.ran[1].size(), 4999U);
    params.back().value += "x";
    expectRefused("UserAdd", params, "/usr/bin/chage");
}

TEST_F(MethodLimits, DoNotCountWhatFollowsAnEmptyArgument)
{
    Params params(21, text("GroupName", std::string(254, 'x')));
    params.front().value.clear();
    expectRun("LocalGroupAdd", params, "/usr/sbin/groupadd 2>&1");
    expectRefused("LocalGroupAdd", Params(params.begin() + 1, params.end()), "/usr/sbin/groupadd");
}

class MemberLimits : public MethodLimits
{
protected:
    /** The call for a member that is in the primary group and, apart from it, in this group. */
    void prepare(std::string const& other)
    {
        params_ = {text("LocalGroupName", "g"), text("DomainAndMember", "jdoe")};
        commands_.answers[idLine_] = "uid=1000(jdoe) gid=100(users) groups=27(" + other + ")\n";
        commands_.ran.clear();
    }

    std::string const idLine_ = "/usr/bin/id \"jdoe\" 2>&1";
    Params params_;
};

TEST_F(MemberLimits, AreTheRunnersBufferForTheGroupList)
{
    // users,"...","g"
    std::string const ends = "/usr/sbin/usermod -G users,\"\",\"g\" \"jdoe\" 2>&1";
    std::string const longest(4999 - ends.size(), 'x');
    prepare(longest);
    EXPECT_EQ(execute("LocalGroupAddUser", params_), 0);
    EXPECT_EQ(commands_.ran, (Lines{idLine_, "/usr/sbin/usermod -G users,\"" + longest +
                                                 "\",\"g\" \"jdoe\" 2>&1"}));
    prepare(longest + "x");
    Recording const log;
    EXPECT_FALSE(call("LocalGroupAddUser,LocalGroupName:CMPI_string:g,"
                      "DomainAndMember:CMPI_string:jdoe"));
    EXPECT_EQ(commands_.ran, Lines{idLine_});
    EXPECT_EQ(log.texts(6000), Lines{"Command line too long: /usr/sbin/usermod"});
    EXPECT_EQ(log.remarks().back(), "outputBuffer: ");
}

TEST_F(MemberLimits, LetAMemberOf200GroupsJoinOneMore)
{
    prepare("");
    std::string identity = "uid=1000(jdoe) gid=100(users) groups=100(users)";
    std::string list = "users,\"users\",";
    for (int group = 1001; group < 1201; ++group) {
        std::string const name = "project" + std::to_string(group);
        identity += "," + std::to_string(group) + "(" + name + ")";
        list += "\"" + name + "\",";
    }
    commands_.answers[idLine_] = identity + "\n";
    EXPECT_EQ(execute("LocalGroupAddUser", params_), 0);
    EXPECT_EQ(commands_.ran,
              (Lines{idLine_, "/usr/sbin/usermod -G " + list + "\"g\" \"jdoe\" 2>&1"}));
}

TEST_F(MemberLimits, ChangeNothingIfTheOutputOfIdMayBeCut)
{
    // One byte more would be cut off, and with it a group that usermod then takes away.
    std::string const ends = "uid=1000(jdoe) gid=100(users) groups=27()\n";
    std::string const names(4999 - ends.size(), 'x');
    prepare(names);
    Recording const log;
    EXPECT_EQ(execute("LocalGroupDelUser", params_), 1);
    EXPECT_EQ(commands_.ran, Lines{idLine_});
    EXPECT_EQ(log.texts(6000), Lines{"Output too long: /usr/bin/id"});

    prepare(names.substr(1));
    EXPECT_EQ(execute("LocalGroupDelUser", params_), 0);
    EXPECT_EQ(commands_.ran.size(), 2U);
}

TEST_F(MemberLimits, AreTheRunnersBufferForTheMember)
{
    std::string const ends = "/usr/bin/id \"\" 2>&1";
    std::string const longest(4999 - ends.size(), 'x');
    execute("LocalGroupAddUser", {text("LocalGroupName", "g"), text("DomainAndMember", longest)});
    EXPECT_EQ(commands_.ran, Lines{"/usr/bin/id \"" + longest + "\" 2>&1"});
    expectRefused("LocalGroupAddUser",
                  {text("LocalGroupName", "g"), text("DomainAndMember", longest + "x")},
                  "/usr/bin/id");
}

} // namespace method_limits_test
