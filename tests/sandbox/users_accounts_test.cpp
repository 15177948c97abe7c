// Users and groups made by the real account tools, and the effects of writes to user nodes.

#include "host/Properties.h"
#include "tests/support/Machine.h"
#include "tests/support/Plugin.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <ctime>
#include <filesystem>
#include <unistd.h>

namespace users_accounts_test
{

constexpr unsigned int jdoeId = 4711;

/** Local midnight of a day, as a host passes a point in time. */
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
        machine::run("useradd -u 4711 -U -m -c 'John Doe' -s /bin/sh -p first jdoe");
        machine::run("chage -d 2020-01-15 -m 1 -M 90 -W 14 -I 20 -E 2030-06-01 jdoe");
    }

    /** Loads the plug-in and records every command line from then on. */
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
        return plugin.node(IC::nodeType::user, "jdoe");
    }

    static std::string shadow(std::size_t field)
    {
        return machine::entry("/etc/shadow", "jdoe").at(field);
    }

    Plugin plugin;
};

TEST_F(RealAccounts, AreInTheTreeAsUseraddAndChageMadeThem)
{
    load();
    IC::MutableNode const& node = jdoe();
    EXPECT_EQ(stored(node, IC::property::id), std::to_string(jdoeId));
    EXPECT_EQ(stored(node, IC::property::groupId), std::to_string(jdoeId));
    EXPECT_EQ(stored(node, IC::property::fullName), "John Doe");
    EXPECT_EQ(stored(node, IC::property::homeDir), "/home/jdoe");
    EXPECT_EQ(stored(node, IC::property::scriptPath), "/bin/sh");
    EXPECT_EQ(stored(node, IC::property::password), "first");
    EXPECT_EQ(stored(node, IC::property::pwdMinDays), "1");
    EXPECT_EQ(stored(node, IC::property::pwdMaxDays), "90");
    EXPECT_EQ(stored(node, IC::property::pwdWarnDays), "14");
    EXPECT_EQ(stored(node, IC::property::pwdExpDays), "20");
    EXPECT_EQ(stored(node, IC::property::lastPwdChange), "2020-01-15 00:00:00");
    EXPECT_EQ(stored(node, IC::property::inactiveTime), "2030-06-01 00:00:00");
    EXPECT_EQ(stored(node, IC::property::passwordExpiration), "2030-06-01 00:00:00");
    EXPECT_EQ(machine::ran(), Lines{});
}

TEST_F(RealAccounts, HaveTheirDatesAtLocalMidnight)
{
    for (char const* zone : {"EST5", "CET-1"}) {
        useZone(zone);
        Plugin other;
        other.initialize();
        EXPECT_EQ(stored(other.node(IC::nodeType::user, "jdoe"), IC::property::lastPwdChange),
                  "2020-01-15 00:00:00")
            << zone;
    }
}

TEST_F(RealAccounts, AndGroupsAreCountedLiveWithoutARefresh)
{
    load();
    for (auto const& [type, command] : {std::pair(IC::nodeType::user, "useradd newcomer"),
                                        std::pair(IC::nodeType::group, "groupadd team")}) {
        IC::MutableNode const& node = plugin.node(type, "jdoe");
        unsigned int const before = *property(node, IC::property::elementCount);
        machine::run(command);
        EXPECT_EQ(text(node, IC::property::elementCount), std::to_string(before + 1)) << command;
    }
    EXPECT_EQ(plugin.find(IC::nodeType::user, "newcomer"), nullptr);
    EXPECT_EQ(plugin.find(IC::nodeType::group, "team"), nullptr);
}

TEST_F(RealAccounts, HaveNoShadowFactsWithoutReadPermission)
{
    ASSERT_EQ(seteuid(65534), 0);
    plugin.initialize();
    ASSERT_EQ(seteuid(0), 0);
    EXPECT_EQ(stored(jdoe(), IC::property::fullName), "John Doe");
    EXPECT_EQ(stored(jdoe(), IC::property::password), "");
    EXPECT_EQ(stored(jdoe(), IC::property::pwdMaxDays), "0");
    EXPECT_EQ(stored(jdoe(), IC::property::pwdExpDays), "0");
    EXPECT_EQ(stored(jdoe(), IC::property::inactiveTime), "1970-01-01 00:00:00");
}

TEST_F(RealAccounts, HaveANewPasswordAfterAWriteUnlessChpasswdFails)
{
    load();
    write(IC::property::password, {"$6$salt$newhash", true});
    EXPECT_EQ(machine::ran(), Lines{"chpasswd -e < usrandpwd ; rm -f usrandpwd"});
    EXPECT_EQ(shadow(1), "$6$salt$newhash");
    EXPECT_FALSE(std::filesystem::exists("usrandpwd"));
    machine::fake("/usr/sbin/chpasswd", "exit 1\n");
    write(IC::property::password, {"$6$salt$other", true});
    EXPECT_EQ(shadow(1), "$6$salt$newhash");
    EXPECT_FALSE(std::filesystem::exists("usrandpwd"));
    EXPECT_EQ(stored(jdoe(), IC::property::password), "$6$salt$other");
}

TEST_F(RealAccounts, BecomeInactiveAndExpireOnTheDateWritten)
{
    struct Row {
        unsigned int property;
        IC::PropertyValue value;
        char const* change;
        std::size_t field; // of the shadow file
        char const* days;
    };
    load();
    for (char const* zone : {"UTC0", "EST5", "CET-1"}) {
        useZone(zone);
        for (Row const& row : {
                 Row{IC::property::inactiveTime, {"2020-05-14 00:00:00", true}, "-I 30", 6, "30"},
                 Row{IC::property::inactiveTime, midnight(2020, 5, 15), "-I 31", 6, "31"},
                 Row{IC::property::inactiveTime,
                     {"2020-04-13 00:00:00", true},
                     "-I 99999",
                     6,
                     "99999"}, // before the expiry
                 Row{IC::property::passwordExpiration,
                     {"2020-02-14 00:00:00", true},
                     "-M 30",
                     4,
                     "30"},
                 Row{IC::property::passwordExpiration, midnight(2020, 2, 15), "-M 31", 4, "31"},
             }) {
            SCOPED_TRACE(std::string(zone) + " " + row.change);
            machine::run("chage -I 20 -M 90 jdoe");
            machine::forget();
            write(row.property, row.value);
            EXPECT_EQ(machine::ran(),
                      (Lines{"chage -l jdoe", std::string("chage ") + row.change + " jdoe"}));
            EXPECT_EQ(shadow(row.field), row.days);
        }
    }
}

TEST_F(RealAccounts, CountFrom1970IfThePasswordNeverExpires)
{
    machine::run("chage -M -1 jdoe");
    load();
    write(IC::property::inactiveTime, {"2020-05-14 00:00:00", true});
    EXPECT_EQ(machine::ran(), (Lines{"chage -l jdoe", "chage -I 18396 jdoe"}));
}

TEST_F(RealAccounts, AreDeletedOnlyIfTheUidIsTheName)
{
    machine::run("useradd --badname -u 4712 -m 4712");
    load();
    write(IC::property::deleteUser, {IC::Number(1U), true});
    EXPECT_EQ(machine::ran(), Lines{"userdel -r 4711"});
    EXPECT_FALSE(machine::entry("/etc/passwd", "jdoe").empty());
    EXPECT_TRUE(std::filesystem::exists("/home/jdoe"));
    machine::forget();
    plugin.node(IC::nodeType::user, "4712")
        .setProperty(IC::property::deleteUser, {IC::Number(1U), true});
    EXPECT_EQ(machine::ran(), Lines{"userdel -r 4712"});
    EXPECT_TRUE(machine::entry("/etc/passwd", "4712").empty());
    EXPECT_FALSE(std::filesystem::exists("/home/4712"));
}

TEST_F(RealAccounts, AreInTheirGroupsAsGroupaddAndUsermodMadeThem)
{
    machine::run("useradd -g jdoe -M anna");
    machine::run("groupadd -g 4713 team");
    machine::run("usermod -a -G team jdoe");
    load();
    EXPECT_EQ(stored(plugin.node(IC::nodeType::group, "jdoe"), IC::property::id), "4711");
    EXPECT_EQ(stored(plugin.node(IC::nodeType::group, "jdoe"), IC::property::members), "jdoe,anna");
    EXPECT_EQ(stored(plugin.node(IC::nodeType::group, "team"), IC::property::id), "4713");
    EXPECT_EQ(stored(plugin.node(IC::nodeType::group, "team"), IC::property::members), "jdoe");
    EXPECT_EQ(machine::ran(), Lines{});
}

TEST(LaidMachine, ShowsAllMembersOfAGroupOfTenThousand)
{
    machine::lay("users-and-groups");
    std::string members = "user10000";
    for (int user = 10001; user < 20000; ++user)
        members += ",user" + std::to_string(user);
    machine::write("/etc/group", "root:x:0:\nlarge:x:5000:" + members + "\nlast:x:5001:\n");
    Plugin plugin;
    plugin.initialize();
    EXPECT_EQ(stored(plugin.node(IC::nodeType::group, "large"), IC::property::members), members);
    EXPECT_EQ(stored(plugin.node(IC::nodeType::group, "last"), IC::property::members), "");
}

} // namespace users_accounts_test
