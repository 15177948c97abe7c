// Writes that would change an account or group other than the intended one are refused before any
// command runs.

#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"

#include <algorithm>
#include <filesystem>

namespace harm_test
{

constexpr char hash[] = "$6$saltsalt$hashhashhash";

/** Whether a command line with this beginning reached the shell. */
bool ran(std::string const& start)
{
    Lines const lines = machine::ran();
    return std::any_of(lines.begin(), lines.end(),
                       [&start](std::string const& line) { return line.rfind(start, 0) == 0; });
}

void addAccount(std::string const& arguments)
{
    machine::run("/usr/sbin/useradd -s /bin/sh " + arguments);
}

class MihostHarm : public testing::Test
{
protected:
    MihostHarm()
    {
        machine::lay("plain");
        machine::write("/etc/login.defs", "UID_MIN 1000\nUID_MAX 60000\nGID_MIN 1000\n"
                                          "GID_MAX 60000\nUSERGROUPS_ENAB yes\n");
        machine::recordShell();
    }
};

TEST_F(MihostHarm, DoesNotDeleteAnotherAccountNamedLikeTheUid)
{
    addAccount("-m -u 1500 jdoe");
    addAccount("-m -u 1077 the1500th");
    // Some useradd tools allow this name.
    machine::run("sed -i 's/^the1500th:/1500:/' /etc/passwd /etc/shadow");
    EXPECT_EQ(
        mihostRun({"--yes", "set", "user:jdoe", "delete", "true"}),
        failed(2, "nothing is run for user:jdoe: userdel would get the UID 1500, which is "
                  "the name of another account: '1500' would be deleted (use 'mihost user delete "
                  "jdoe', which keeps the home directory)"));
    EXPECT_FALSE(ran("userdel"));
    EXPECT_FALSE(machine::entry("/etc/passwd", "1500").empty());
    EXPECT_FALSE(machine::entry("/etc/passwd", "jdoe").empty());
    EXPECT_TRUE(std::filesystem::exists("/home/the1500th"));
}

TEST_F(MihostHarm, RunsNoUserdelThatWouldFindNoAccount)
{
    addAccount("-M -u 1500 jdoe");
    Outcome const outcome =
        mihostRun({"set", "user:jdoe", "delete", "true"}); // refused without a prompt
    EXPECT_EQ(outcome.code, 2);
    EXPECT_TRUE(holds(outcome.err, "accepts only names (use 'mihost user delete jdoe'"));
    EXPECT_FALSE(ran("userdel"));
    EXPECT_EQ(mihostRun({"call", "UserDel", "UserName=jdoe"}).code, 0);
    EXPECT_TRUE(machine::entry("/etc/passwd", "jdoe").empty());
}

TEST_F(MihostHarm, WritesNothingForANodeThatNamesAnotherUid)
{
    addAccount("-M -u 1500 jdoe");
    addAccount("-M -u 1501 ann");
    std::string const shadow = machine::read("/etc/shadow");
    for (std::string const write : {"inactive-time 2030-01-01", "password-expiration 2030-01-01",
                                    "password '$6$saltsalt$hashhashhash'", "delete true --yes"}) {
        // Both in memory only, but read by the write.
        Outcome const named = mihostRun(
            {"shell", "--keep-going"}, "set user:jdoe user-id 1501\nset user:jdoe " + write + "\n");
        EXPECT_EQ(named.code, 2) << write;
        EXPECT_TRUE(holds(named.err, "'jdoe' is now an account with UID 1500, not 1501"));
    }
    EXPECT_FALSE(ran("chage") || ran("chpasswd") || ran("userdel"));
    EXPECT_EQ(machine::read("/etc/shadow"), shadow);
    EXPECT_EQ(mihostRun({"set", "user:jdoe", "password", hash}).code, 0);
    EXPECT_EQ(machine::entry("/etc/shadow", "jdoe").at(1), hash);
}

class MihostMembership : public MihostHarm
{
protected:
    MihostMembership()
    {
        addAccount("-M -u 1500 jdoe");
        machine::run("groupadd crew");
    }

    /** Adds jdoe to a new group of this name, even if groupadd would refuse the name. */
    static void addToGroup(std::string const& name)
    {
        machine::write("/etc/group", machine::read("/etc/group") + name + ":x:1700:jdoe\n");
    }
};

TEST_F(MihostMembership, IsNotChangedIfAnotherGroupOrAccountWouldBe)
{
    struct Row {
        char const* group; // jdoe is in this one, too
        char const* reason;
        std::string member = "jdoe";
    };
    std::string const groups = machine::read("/etc/group");
    for (Row const& row :
         {Row{"x`touch${IFS}/root/PWNED`",
              "its group 'x`touch${IFS}/root/PWNED`' contains the shell metacharacter '`'"},
          Row{"x)(root",
              "id printed: uid=1500(jdoe) gid=1500(jdoe) groups=1500(jdoe),1700(x)(root), "
              "which is not its usual form"},
          Row{"0", "its group '0' has a name that usermod reads as a GID"},
          Row{"root", "its group 'root' has GID 1700, but usermod finds GID 0"},
          Row{"staff", "id reads it as a UID, that of the account 'jdoe'", "1500"}}) {
        machine::write("/etc/group", groups);
        addToGroup(row.group);
        std::string const message =
            "the groups of '" + row.member + "' are not changed: " + row.reason;
        for (std::string const method : {"LocalGroupAddUser", "LocalGroupDelUser"}) {
            EXPECT_EQ(
                mihostRun({"call", method, "LocalGroupName=crew", "DomainAndMember=" + row.member}),
                failed(2, message));
            EXPECT_EQ(mihostRun({"set", "os", "create-user",
                                 method +
                                     ",LocalGroupName:CMPI_string:crew,"
                                     "DomainAndMember:CMPI_string:" +
                                     row.member}),
                      failed(2, message));
        }
    }
    EXPECT_FALSE(ran("/usr/sbin/usermod"));
    EXPECT_FALSE(std::filesystem::exists("/root/PWNED"));
}

TEST_F(MihostMembership, IsChangedForHarmlessGroups)
{
    addToGroup("staff-2");
    Lines const add = {"call", "LocalGroupAddUser", "LocalGroupName=crew"};
    Lines known = add;
    known.emplace_back("DomainAndMember=jdoe");
    EXPECT_EQ(mihostRun(known).code, 0);
    EXPECT_EQ(machine::entry("/etc/group", "crew").at(3), "jdoe");
    EXPECT_EQ(machine::entry("/etc/group", "staff-2").at(3), "jdoe");
    Lines unknown = add;
    unknown.emplace_back("DomainAndMember=no-such");
    Outcome const outcome = mihostRun(unknown); // left to the plug-in
    EXPECT_EQ(outcome.code, 1);
    EXPECT_TRUE(holds(outcome.err, "no such user"));
}

} // namespace harm_test
