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

    static int change(std::string const& method, std::string const& group)
    {
        return execute(method, {text("LocalGroupName", group), text("DomainAndMember", "jdoe")});
    }

    /** The line that reads the present groups, and the one that sets this list. */
    Lines linesThatSet(std::string const& groups) const
    {
        return {idLine_, "/usr/sbin/usermod -G " + groups + " \"jdoe\" 2>&1"};
    }

    static constexpr char add[] = "LocalGroupAddUser";
    static constexpr char remove[] = "LocalGroupDelUser";
    std::string const idLine_ = "/usr/bin/id \"jdoe\" 2>&1";
};

TEST_F(GroupMemberChanges, SetTheListWithTheGroupOrWithoutIt)
{
    struct {
        char const* what;
        char const* method;
        char const* group;
        std::string groups; // as id shows them
        char const* list;
    } const cases[] = {
        {"after the present ones", add, "staff", groupsOfJdoe,
         "jdoe,\"jdoe\",\"sudo\",\"users\",\"staff\""},
        {"taken from the list", remove, "sudo", groupsOfJdoe, "jdoe,\"jdoe\",\"users\""},
        {"the primary group only", remove, "sudo", "gid=100(users) groups=27(sudo)", "users"},
        {"names that only begin alike", remove, "sudo",
         "gid=100(users) groups=100(users),27(sudo),28(sudoers),29(su)",
         "users,\"users\",\"sudoers\",\"su\""},
        {"the primary group stays", remove, "jdoe", groupsOfJdoe, "jdoe,\"sudo\",\"users\""},
        // The quoted group begins with a double quote, and "#" is the character after that.
        {"unless it compares as one more", remove, "sudo",
         "gid=1001(#jdoe) groups=27(sudo),100(users)", "\"users\""},
        {"two more", remove, "sudo", "gid=1001($jdoe) groups=27(sudo),100(users)",
         "$jdoe,\"users\""},
        {"one less", remove, "sudo", "gid=1001(!jdoe) groups=27(sudo),100(users)",
         "!jdoe,\"users\""},
        {"a later character", remove, "sudo", "gid=1001(\"t) groups=27(sudo),100(users)",
         "\"users\""},
        {"such a group is kept when one is added", add, "users", "gid=1001(#jdoe) groups=27(sudo)",
         "#jdoe,\"sudo\",\"users\""},
        {"another language", add, "staff", "gid=100(users) Gruppen=100(users),27(sudo)",
         "users,\"users\",\"sudo\",\"staff\""},
        {"no list", add, "staff", "gid=100(users)", "users,\"staff\""},
        {"no equals sign", add, "staff", "gid 100(users)", "users,\"staff\""},
        {"the list after the word groups", add, "staff",
         "gid=100(users) egid=5(tty) groups=27(sudo)", "users,\"sudo\",\"staff\""},
        {"a primary group without a name", add, "staff", "gid=5000", "\"staff\""},
        {"and a list", remove, "sudo", "gid=5000 groups=5000,27(sudo),100(users)", "\"users\""},
        {"a group twice", add, "sudo", groupsOfJdoe, "jdoe,\"jdoe\",\"sudo\",\"users\",\"sudo\""},
        {"not a member", remove, "staff", groupsOfJdoe, "jdoe,\"jdoe\",\"sudo\",\"users\""},
        {"a name that is cut off", add, "staff", "gid=100(us", "\"staff\""},
    };
    for (auto const& [what, method, group, groups, list] : cases) {
        identity("uid=1001(jdoe) " + groups + "\n");
        EXPECT_EQ(change(method, group), 0) << what;
        EXPECT_EQ(commands_.ran, linesThatSet(list)) << what;
    }
}

TEST_F(GroupMemberChanges, KeepAUserInItsOnlyNamedGroup)
{
    // The empty list ends the arguments before the member, and usermod complains.
    identity("uid=1001(jdoe) gid=5000 groups=5000,27(sudo)\n");
    std::string const line = "/usr/sbin/usermod -G 2>&1";
    commands_.answers[line] = "usermod: option requires an argument -- 'G'\n";
    EXPECT_EQ(change(remove, "sudo"), 1);
    EXPECT_EQ(commands_.ran, (Lines{idLine_, line}));
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
        EXPECT_EQ(change(add, "staff"), 1);
        EXPECT_EQ(commands_.ran, Lines{idLine_});
    }
}

TEST_F(GroupMemberChanges, FailIfAToolCannotBeStarted)
{
    commands_.otherwise.reset();
    EXPECT_EQ(change(add, "staff"), 1);
    EXPECT_EQ(commands_.ran, Lines{idLine_});
    identity(identityOfJdoe);
    EXPECT_EQ(change(add, "staff"), 1);
    EXPECT_EQ(commands_.ran.size(), 2U);
}

TEST_F(GroupMemberChanges, FailIfUsermodPrintsAnyOtherLine)
{
    identity(identityOfJdoe);
    commands_.answers[linesThatSet("jdoe,\"jdoe\",\"sudo\",\"users\",\"staff\"").at(1)] =
        "usermod: group 'staff' does not exist\n";
    EXPECT_EQ(change(add, "staff"), 1);
    commands_.answers[linesThatSet("jdoe,\"sudo\",\"users\"").at(1)] =
        "usermod: `jdoe' is primary group name\n";
    EXPECT_EQ(change(remove, "jdoe"), 0);
}

TEST_F(GroupMemberChanges, TakeTheirNamesFromTextParametersOnly)
{
    identity(identityOfJdoe);
    EXPECT_EQ(execute("LocalGroupAddUser", {text("DomainAndMember", "jdoe"),
                                            {"LocalGroupName", "CMPI_uint32", "1"},
                                            {"Colour", "CMPI_boolean", "red"},
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
    EXPECT_FALSE(NQ::OsInfo().groupMemberChanges(
        "anything", {text("LocalGroupName", "sudo"), text("DomainAndMember", "jdoe")}));
    EXPECT_EQ(commands_.ran, linesThatSet("jdoe,\"jdoe\",\"users\""));
    commands_.ran.clear();
    EXPECT_TRUE(call("LocalGroupDelUser,LocalGroupName:CMPI_string:users,"
                     "DomainAndMember:CMPI_string:jdoe"));
    EXPECT_EQ(commands_.ran, linesThatSet("jdoe,\"jdoe\",\"sudo\""));
}

TEST_F(GroupMemberChanges, LogTheOutputOfTheTools)
{
    identity(identityOfJdoe);
    Recording const log;
    change(add, "staff");
    EXPECT_EQ(
        log.texts(),
        (Lines{"OsNode::executeMethod: entry", "groupMemberChanges: entry", "executeCommand: entry",
               "executeCommand: exit", "outputBuffer: " + identityOfJdoe, "executeCommand: entry",
               "executeCommand: exit", "outputBuffer: ", "groupMemberChanges: exit",
               "OsNode::executeMethod: exit"}));
}

} // namespace method_members_test
