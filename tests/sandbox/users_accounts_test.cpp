// Users and groups as the real account tools make them, and what writes to user nodes really do.

#include "nodes/ids.h"
#include "tests/support/Lines.h"
#include "tests/support/Machine.h"
#include "tests/support/Plugin.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <cstdlib>
#include <ctime>
#include <filesystem>
#include <string>
#include <unistd.h>
#include <vector>

namespace
{

using Texts = std::vector<std::string>;

constexpr unsigned int jdoeId = 4711;

std::string outputOf(std::string const& command)
{
    FILE* const pipe = popen(command.c_str(), "r");
    std::string text;
    char piece[512];
    while (std::fgets(piece, sizeof piece, pipe))
        text += piece;
    pclose(pipe);
    return text;
}

void run(std::string const& command)
{
    ASSERT_EQ(std::system(command.c_str()), 0) << command;
}

IC::PropertyValue written(std::string const& text)
{
    return {text, true};
}

/** Local midnight of a day, as a host hands over a point in time. */
IC::PropertyValue midnight(int year, int month, int day)
{
    std::tm fields{};
    fields.tm_year = year - 1900;
    fields.tm_mon = month - 1;
    fields.tm_mday = day;
    fields.tm_isdst = -1;
    return {IC::Number(std::mktime(&fields), 0), true};
}

/** A machine with the user jdoe, whose password was changed on 15 January 2020. */
class RealAccounts : public testing::Test
{
protected:
    RealAccounts()
    {
        useZone("UTC0");
        std::filesystem::current_path("/tmp");
        run("useradd -u 4711 -U -m -c 'John Doe' -s /bin/sh -p first jdoe");
        run("chage -d 2020-01-15 -m 1 -M 90 -W 14 -I 20 -E 2030-06-01 jdoe");
    }

    /** Loads the plug-in and notes every command line from then on. */
    void load()
    {
        plugin.initialize();
        machine::recordShell();
    }

    void write(unsigned int id, IC::PropertyValue const& value)
    {
        EXPECT_EQ(jdoe().setProperty(id, value).getStatus(), 0);
    }

    IC::MutableNode& jdoe() const
    {
        return plugin.node(NODES::userType, "jdoe");
    }

    /** One line of what chage lists for jdoe, without the blanks between label and colon. */
    static std::string listed(std::string const& label)
    {
        for (std::string const& line : linesOf(outputOf("chage -l jdoe")))
            if (line.rfind(label, 0) == 0)
                return line.substr(line.find(": ") + 2);
        return "(none)";
    }

    Plugin plugin;
};

TEST_F(RealAccounts, StandInTheTreeAsUseraddAndChageMadeThem)
{
    load();
    IC::MutableNode const& node = jdoe();
    EXPECT_EQ(stored(node, NODES::id), std::to_string(jdoeId));
    EXPECT_EQ(stored(node, NODES::groupId), std::to_string(jdoeId));
    EXPECT_EQ(stored(node, NODES::fullName), "John Doe");
    EXPECT_EQ(stored(node, NODES::homeDir), "/home/jdoe");
    EXPECT_EQ(stored(node, NODES::scriptPath), "/bin/sh");
    EXPECT_EQ(stored(node, NODES::password), "first");
    EXPECT_EQ(stored(node, NODES::pwdMinDays), "1");
    EXPECT_EQ(stored(node, NODES::pwdMaxDays), "90");
    EXPECT_EQ(stored(node, NODES::pwdWarnDays), "14");
    EXPECT_EQ(stored(node, NODES::pwdExpDays), "20");
    EXPECT_EQ(stored(node, NODES::lastPwdChange), "2020-01-15 00:00:00");
    EXPECT_EQ(stored(node, NODES::inactiveTime), "2030-06-01 00:00:00");
    EXPECT_EQ(stored(node, NODES::passwordExpiration), "2030-06-01 00:00:00");
    EXPECT_EQ(machine::ran(), Texts{});
}

TEST_F(RealAccounts, HaveTheirDatesAtLocalMidnightWestAndEastOfGreenwich)
{
    for (char const* zone : {"EST5", "CET-1"}) {
        useZone(zone);
        Plugin other;
        other.initialize();
        EXPECT_EQ(stored(other.node(NODES::userType, "jdoe"), NODES::lastPwdChange),
                  "2020-01-15 00:00:00")
            << zone;
    }
}

TEST_F(RealAccounts, CountLiveWithoutARefresh)
{
    load();
    IC::MutableNode const& node = jdoe();
    unsigned int const before = *property(node, NODES::elementCount);
    run("useradd newcomer");
    EXPECT_EQ(static_cast<unsigned int>(*property(node, NODES::elementCount)), before + 1);
    EXPECT_EQ(plugin.find(NODES::userType, "newcomer"), nullptr);
}

TEST_F(RealAccounts, HaveNoShadowFactsForAProcessThatMayNotReadThem)
{
    ASSERT_EQ(seteuid(65534), 0);
    plugin.initialize();
    ASSERT_EQ(seteuid(0), 0);
    EXPECT_EQ(stored(jdoe(), NODES::fullName), "John Doe");
    EXPECT_EQ(stored(jdoe(), NODES::password), "");
    EXPECT_EQ(stored(jdoe(), NODES::pwdMaxDays), "0");
    EXPECT_EQ(stored(jdoe(), NODES::pwdExpDays), "0");
    EXPECT_EQ(stored(jdoe(), NODES::inactiveTime), "1970-01-01 00:00:00");
}

TEST_F(RealAccounts, GetANewPasswordThatIsWritten)
{
    load();
    write(NODES::password, written("$6$salt$newhash"));
    EXPECT_EQ(machine::ran(), Texts{"chpasswd -e < usrandpwd ; rm -f usrandpwd"});
    EXPECT_EQ(machine::entry("/etc/shadow", "jdoe").at(1), "$6$salt$newhash");
    EXPECT_FALSE(std::filesystem::exists("usrandpwd"));
}

TEST_F(RealAccounts, KeepTheirPasswordWhereChpasswdFails)
{
    machine::fake("/usr/sbin/chpasswd", "exit 1\n");
    load();
    write(NODES::password, written("$6$salt$newhash"));
    EXPECT_EQ(machine::entry("/etc/shadow", "jdoe").at(1), "first");
    EXPECT_FALSE(std::filesystem::exists("usrandpwd"));
    EXPECT_EQ(stored(jdoe(), NODES::password), "$6$salt$newhash");
}

TEST_F(RealAccounts, BecomeInactiveOnADateThatIsWrittenAsText)
{
    load();
    write(NODES::inactiveTime, written("2020-05-14 00:00:00"));
    EXPECT_EQ(machine::ran(), (Texts{"chage -l jdoe", "chage -I 30 jdoe"}));
    EXPECT_EQ(listed("Password expires"), "Apr 14, 2020");
    EXPECT_EQ(listed("Password inactive"), "May 14, 2020");
}

TEST_F(RealAccounts, BecomeInactiveOnADateThatIsWrittenAsADate)
{
    load();
    for (char const* zone : {"UTC0", "EST5", "CET-1"}) {
        useZone(zone);
        run("chage -I 20 jdoe");
        machine::forget();
        write(NODES::inactiveTime, midnight(2020, 5, 15));
        EXPECT_EQ(machine::ran(), (Texts{"chage -l jdoe", "chage -I 31 jdoe"})) << zone;
        EXPECT_EQ(listed("Password inactive"), "May 15, 2020") << zone;
    }
}

TEST_F(RealAccounts, GetAnInactivityOf99999DaysWhereTheDateLiesBeforeTheExpiry)
{
    load();
    write(NODES::inactiveTime, written("2020-04-13 00:00:00"));
    EXPECT_EQ(machine::ran(), (Texts{"chage -l jdoe", "chage -I 99999 jdoe"}));
    EXPECT_EQ(machine::entry("/etc/shadow", "jdoe").at(6), "99999");
}

TEST_F(RealAccounts, HaveTheirPasswordExpireOnADateThatIsWrittenAsText)
{
    load();
    write(NODES::passwordExpiration, written("2020-02-14 00:00:00"));
    EXPECT_EQ(machine::ran(), (Texts{"chage -l jdoe", "chage -M 30 jdoe"}));
    EXPECT_EQ(listed("Password expires"), "Feb 14, 2020");
}

TEST_F(RealAccounts, HaveTheirPasswordExpireOnADateThatIsWrittenAsADate)
{
    load();
    write(NODES::passwordExpiration, midnight(2020, 2, 15));
    EXPECT_EQ(machine::ran(), (Texts{"chage -l jdoe", "chage -M 31 jdoe"}));
    EXPECT_EQ(listed("Password expires"), "Feb 15, 2020");
}

TEST_F(RealAccounts, CountFrom1970WhereThePasswordNeverExpires)
{
    run("chage -M -1 jdoe");
    load();
    write(NODES::inactiveTime, written("2020-05-14 00:00:00"));
    EXPECT_EQ(machine::ran(), (Texts{"chage -l jdoe", "chage -I 18396 jdoe"}));
}

TEST_F(RealAccounts, AreNotDeletedSinceUserdelIsGivenTheirUid)
{
    load();
    write(NODES::deleteUser, {IC::Number(1U), true});
    EXPECT_EQ(machine::ran(), Texts{"userdel -r 4711"});
    EXPECT_FALSE(machine::entry("/etc/passwd", "jdoe").empty());
    EXPECT_TRUE(std::filesystem::exists("/home/jdoe"));
}

TEST_F(RealAccounts, AreDeletedWithTheirHomeWhereTheUidIsTheName)
{
    run("useradd --badname -u 4712 -m 4712");
    load();
    IC::PropertyValue const yes(IC::Number(1U), true);
    EXPECT_EQ(plugin.node(NODES::userType, "4712").setProperty(NODES::deleteUser, yes).getStatus(),
              0);
    EXPECT_EQ(machine::ran(), Texts{"userdel -r 4712"});
    EXPECT_TRUE(machine::entry("/etc/passwd", "4712").empty());
    EXPECT_FALSE(std::filesystem::exists("/home/4712"));
}

TEST_F(RealAccounts, StandInTheirGroupsAsGroupaddAndUsermodMadeThem)
{
    run("useradd -g jdoe -M anna");
    run("groupadd -g 4713 team");
    run("usermod -a -G team jdoe");
    load();
    EXPECT_EQ(stored(plugin.node(NODES::groupType, "jdoe"), NODES::id), "4711");
    EXPECT_EQ(stored(plugin.node(NODES::groupType, "jdoe"), NODES::members), "jdoe,anna");
    EXPECT_EQ(stored(plugin.node(NODES::groupType, "team"), NODES::id), "4713");
    EXPECT_EQ(stored(plugin.node(NODES::groupType, "team"), NODES::members), "jdoe");
    EXPECT_EQ(machine::ran(), Texts{});
}

TEST_F(RealAccounts, HaveTheirGroupsCountedLiveWithoutARefresh)
{
    load();
    IC::MutableNode const& group = plugin.node(NODES::groupType, "jdoe");
    unsigned int const before = *property(group, NODES::elementCount);
    run("groupadd team");
    EXPECT_EQ(static_cast<unsigned int>(*property(group, NODES::elementCount)), before + 1);
    EXPECT_EQ(plugin.find(NODES::groupType, "team"), nullptr);
}

/** What stands in one property of all nodes of a type, in their order. */
Texts all(Plugin const& plugin, unsigned int type, unsigned int id)
{
    Texts found;
    for (IC::MutableNode const* node : plugin.nodes(type))
        found.push_back(stored(*node, id));
    return found;
}

TEST(LaidMachine, ShowsItsUsersAndGroupsInTheOrderOfItsFiles)
{
    machine::lay("users-and-groups");
    Plugin plugin;
    plugin.initialize();
    EXPECT_EQ(all(plugin, NODES::userType, NODES::name), (Texts{"root", "anna", "ben", "carl"}));
    EXPECT_EQ(all(plugin, NODES::userType, NODES::maxLoginFailures), (Texts{"3", "3", "3", "3"}));
    EXPECT_EQ(all(plugin, NODES::groupType, NODES::name), (Texts{"root", "anna", "ben", "team"}));
    EXPECT_EQ(all(plugin, NODES::groupType, NODES::members),
              (Texts{"root", "anna", "ben", "anna,ben,carl"}));
}

TEST(LaidMachine, ShowsAGroupOfTenThousandMembersWhole)
{
    machine::lay("users-and-groups");
    std::string members = "user10000";
    for (int user = 10001; user < 20000; ++user)
        members += ",user" + std::to_string(user);
    machine::write("/etc/group", "root:x:0:\nlarge:x:5000:" + members + "\nlast:x:5001:\n");
    Plugin plugin;
    plugin.initialize();
    EXPECT_EQ(all(plugin, NODES::groupType, NODES::members), (Texts{"root", members, ""}));
}

} // namespace
