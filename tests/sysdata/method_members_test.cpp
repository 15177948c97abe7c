// Adding members to groups and removing them.

#include "tests/sysdata/MethodTest.h"

namespace method_members_test
{

std::string const groupsOfJdoe = "gid=1001(jdoe) groups=1001(jdoe),27(sudo),100(users)";
std::string const identityOfJdoe = "uid=1001(jdoe) " + groupsOfJdoe + "\n";

class GroupMemberChanges : public MethodTest
{
protected:
    /** Lets id print this about jdoe. */
    void identity(std::string const& output)
    {
        commands_.answers[idLine_] = output;
        commands_.ran.clear();
    }

    int add(std::string const& group)
    {
        return change("LocalGroupAddUser", group);
    }

    int remove(std::string const& group)
    {
        return change("LocalGroupDelUser", group);
    }

    /** The line that reads the present groups, and the one that sets this list. */
    Lines linesThatSet(std::string const& groups) const
    {
        return {idLine_, "/usr/sbin/usermod -G " + groups + " \"jdoe\" 2>&1"};
    }

    /** The list that is set when jdoe, whom id shows in these groups, is added to another one. */
    std::string added(std::string const& group, std::string const& groups = groupsOfJdoe)
    {
        identity("uid=1001(jdoe) " + groups + "\n");
        EXPECT_EQ(add(group), 0);
        return listSet();
    }

    /** The list that is set when jdoe is removed from a group. */
    std::string removed(std::string const& group, std::string const& groups = groupsOfJdoe)
    {
        identity("uid=1001(jdoe) " + groups + "\n");
        EXPECT_EQ(remove(group), 0);
        return listSet();
    }

    std::string const idLine_ = "/usr/bin/id \"jdoe\" 2>&1";

private:
    /** What usermod was run with, after id and nothing else. */
    std::string listSet() const
    {
        if (commands_.ran.size() != 2)
            return std::to_string(commands_.ran.size()) + " commands";
        std::string const start = "/usr/sbin/usermod -G ";
        std::string const end = " \"jdoe\" 2>&1";
        std::string const& line = commands_.ran[1];
        std::string const list = line.substr(0, line.size() - end.size()).substr(start.size());
        EXPECT_EQ(commands_.ran, linesThatSet(list));
        return list;
    }

    static int change(char const* method, std::string const& group)
    {
        return execute(method, {text("LocalGroupName", group), text("DomainAndMember", "jdoe")});
    }
};

TEST_F(GroupMemberChanges, AddTheGroupAfterThePresentOnes)
{
    EXPECT_EQ(added("staff"), "jdoe,\"jdoe\",\"sudo\",\"users\",\"staff\"");
}

TEST_F(GroupMemberChanges, RemoveTheGroupFromTheList)
{
    EXPECT_EQ(removed("sudo"), "jdoe,\"jdoe\",\"users\"");
}

TEST_F(GroupMemberChanges, KeepThePrimaryGroupAsTheOnlyOne)
{
    EXPECT_EQ(removed("sudo", "gid=100(users) groups=27(sudo)"), "users");
}

TEST_F(GroupMemberChanges, KeepGroupsWhoseNamesOnlyBeginAlike)
{
    EXPECT_EQ(removed("sudo", "gid=100(users) groups=100(users),27(sudo),28(sudoers),29(su)"),
              "users,\"users\",\"sudoers\",\"su\"");
}

TEST_F(GroupMemberChanges, KeepThePrimaryGroupEvenIfItIsRemoved)
{
    EXPECT_EQ(removed("jdoe"), "jdoe,\"sudo\",\"users\"");
}

TEST_F(GroupMemberChanges, LoseAPrimaryGroupThatComparesAsOneMore)
{
    // The quoted group begins with a double quote, and "#" is the character after that.
    EXPECT_EQ(removed("sudo", "gid=1001(#jdoe) groups=27(sudo),100(users)"), "\"users\"");
    EXPECT_EQ(removed("sudo", "gid=1001($jdoe) groups=27(sudo),100(users)"), "$jdoe,\"users\"");
    EXPECT_EQ(removed("sudo", "gid=1001(!jdoe) groups=27(sudo),100(users)"), "!jdoe,\"users\"");
    EXPECT_EQ(removed("sudo", "gid=1001(\"t) groups=27(sudo),100(users)"), "\"users\"");
}

TEST_F(GroupMemberChanges, KeepSuchAPrimaryGroupWhenAdded)
{
    EXPECT_EQ(added("users", "gid=1001(#jdoe) groups=27(sudo)"), "#jdoe,\"sudo\",\"users\"");
}

TEST_F(GroupMemberChanges, FindTheListInOtherLanguages)
{
    EXPECT_EQ(added("staff", "gid=100(users) Gruppen=100(users),27(sudo)"),
              "users,\"users\",\"sudo\",\"staff\"");
}

TEST_F(GroupMemberChanges, WorkForAMemberOfOnlyThePrimaryGroup)
{
    EXPECT_EQ(added("staff", "gid=100(users)"), "users,\"staff\"");
}

TEST_F(GroupMemberChanges, FindTheListAfterTheWordGroups)
{
    EXPECT_EQ(added("staff", "gid=100(users) egid=5(tty) groups=27(sudo)"),
              "users,\"sudo\",\"staff\"");
}

TEST_F(GroupMemberChanges, WorkForAPrimaryGroupWithoutAName)
{
    EXPECT_EQ(added("staff", "gid=5000"), "\"staff\"");
    EXPECT_EQ(removed("sudo", "gid=5000 groups=5000,27(sudo),100(users)"), "\"users\"");
}

TEST_F(GroupMemberChanges, KeepAUserInItsOnlyNamedGroup)
{
    // The empty list ends the arguments before the member, and usermod complains.
    identity("uid=1001(jdoe) gid=5000 groups=5000,27(sudo)\n");
    std::string const line = "/usr/sbin/usermod -G 2>&1";
    commands_.answers[line] = "usermod: option requires an argument -- 'G'\n";
    EXPECT_EQ(remove("sudo"), 1);
    EXPECT_EQ(commands_.ran, (Lines{idLine_, line}));
}

TEST_F(GroupMemberChanges, IgnoreACutOffName)
{
    identity("uid=1001(jdoe) gid=100(us");
    EXPECT_EQ(add("staff"), 0);
    EXPECT_EQ(commands_.ran, linesThatSet("\"staff\""));
}

TEST_F(GroupMemberChanges, WorkForNamesThatHoldTheSearchedWords)
{
    commands_.answers["/usr/bin/id \"groupsgid\" 2>&1"] =
        "uid=1001(groupsgid) gid=1002(groups) groups=1002(groups),27(gid=)\n";
    EXPECT_EQ(execute("LocalGroupAddUser",
                      {text("LocalGroupName", "staff"), text("DomainAndMember", "groupsgid")}),
              0);
    EXPECT_EQ(commands_.ran.back(), "/usr/sbin/usermod -G groups,\"groups\",\"gid=\",\"staff\""
                                    " \"groupsgid\" 2>&1");
}

TEST_F(GroupMemberChanges, AreNotMadeIfIdKnowsNothing)
{
    for (char const* output : {"", "id: jdoe: No such user\n", "uid=1(jdoe)\n",
                               "id: gid: No such user\n", "id: 'jdoe': no such user\n"}) {
        identity(output);
        EXPECT_EQ(add("staff"), 1);
        EXPECT_EQ(commands_.ran, Lines{idLine_});
    }
}

TEST_F(GroupMemberChanges, AreNotMadeIfIdCannotBeStarted)
{
    commands_.otherwise.reset();
    EXPECT_EQ(add("staff"), 1);
    EXPECT_EQ(commands_.ran, Lines{idLine_});
}

TEST_F(GroupMemberChanges, FailIfUsermodPrintsAnything)
{
    identity(identityOfJdoe);
    commands_.answers[linesThatSet("jdoe,\"jdoe\",\"sudo\",\"users\",\"staff\"").at(1)] =
        "usermod: group 'staff' does not exist\n";
    EXPECT_EQ(add("staff"), 1);
}

TEST_F(GroupMemberChanges, SucceedForThePrimaryGroup)
{
    identity(identityOfJdoe);
    commands_.answers[linesThatSet("jdoe,\"sudo\",\"users\"").at(1)] =
        "usermod: `jdoe' is primary group name.\n";
    EXPECT_EQ(remove("jdoe"), 0);
}

TEST_F(GroupMemberChanges, FailIfUsermodCannotBeStarted)
{
    identity(identityOfJdoe);
    commands_.otherwise.reset();
    EXPECT_EQ(add("staff"), 1);
    EXPECT_EQ(commands_.ran.size(), 2U);
}

TEST_F(GroupMemberChanges, TakeTheirNamesFromTextParametersOnly)
{
    identity(identityOfJdoe);
    EXPECT_EQ(execute("LocalGroupAddUser", {text("DomainAndMember", "jdoe"),
                                            {"LocalGroupName", "CMPI_uint32", "1"},
                                            text("LocalGroupName", "my staff"),
                                            {"DomainAndMember", "CMPI_dateTime", "2010-5-7"},
                                            text("GroupName", "other")}),
              0);
    EXPECT_EQ(commands_.ran, linesThatSet("jdoe,\"jdoe\",\"sudo\",\"users\",\"my staff\""));
}

TEST_F(GroupMemberChanges, QuoteAMemberThatIsNotGiven)
{
    EXPECT_EQ(execute("LocalGroupAddUser", {}), 1);
    EXPECT_EQ(commands_.ran, Lines{"/usr/bin/id \"\" 2>&1"});
}

TEST_F(GroupMemberChanges, RemoveForAnyMethodButTheOneThatAdds)
{
    identity(identityOfJdoe);
    NQ::OsInfo info;
    EXPECT_FALSE(info.groupMemberChanges(
        "anything", {text("LocalGroupName", "sudo"), text("DomainAndMember", "jdoe")}));
    EXPECT_EQ(commands_.ran, linesThatSet("jdoe,\"jdoe\",\"users\""));
}

TEST_F(GroupMemberChanges, AreMadeByAMethodCall)
{
    identity(identityOfJdoe);
    EXPECT_TRUE(call("LocalGroupDelUser,LocalGroupName:CMPI_string:users,"
                     "DomainAndMember:CMPI_string:jdoe"));
    EXPECT_EQ(commands_.ran, linesThatSet("jdoe,\"jdoe\",\"sudo\""));
}

TEST_F(GroupMemberChanges, LogTheOutputOfTheTools)
{
    identity(identityOfJdoe);
    Recording const log;
    add("staff");
    EXPECT_EQ(
        log.texts(),
        (Lines{"OsNode::executeMethod: entry", "groupMemberChanges: entry", "executeCommand: entry",
               "executeCommand: exit", "outputBuffer: " + identityOfJdoe, "executeCommand: entry",
               "executeCommand: exit", "outputBuffer: ", "groupMemberChanges: exit",
               "OsNode::executeMethod: exit"}));
}

TEST_F(GroupMemberChanges, ListAGroupTwiceIfItIsAddedAgain)
{
    EXPECT_EQ(added("sudo"), "jdoe,\"jdoe\",\"sudo\",\"users\",\"sudo\"");
    EXPECT_EQ(removed("staff"), "jdoe,\"jdoe\",\"sudo\",\"users\""); // not a member
}

TEST_F(GroupMemberChanges, AreMadeWhateverTypesOtherParametersHave)
{
    identity(identityOfJdoe);
    EXPECT_EQ(execute("LocalGroupAddUser", {text("LocalGroupName", "staff"),
                                            {"Colour", "CMPI_boolean", "red"},
                                            text("DomainAndMember", "jdoe")}),
              0);
    EXPECT_EQ(commands_.ran, linesThatSet("jdoe,\"jdoe\",\"sudo\",\"users\",\"staff\""));
}

} // namespace method_members_test
