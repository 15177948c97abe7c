#include "sysdata/userInfo_linux.h"

#include "tests/support/Recording.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <ctime>
#include <functional>
#include <string>
#include <vector>

namespace user_record_test
{

using NQ::userInfo;
using NQ::USER_INFO::never;

// The value of an empty shadow field if a long is wider than 32 bits.
constexpr unsigned long allBitsSet = ~0UL;

constexpr char const* east = "CET-1";
constexpr char const* west = "EST5";
constexpr char const* south = "AEST-10AEDT,M10.1.0,M4.1.0/3"; // has summer time in January

TEST(UserRecord, MarksAnEmptyAgeingFieldWith32SetBits)
{
    EXPECT_EQ(never, 0xFFFFFFFFUL);
}

TEST(UserRecord, StartsWithItsNameAndNothingElse)
{
    userInfo user("jdoe");
    EXPECT_EQ(user.getUserName(), "jdoe");
    EXPECT_EQ(user.getUserFullName(), "");
    EXPECT_EQ(user.getUserHomeDir(), "");
    EXPECT_EQ(user.getUserScriptPath(), "");
    EXPECT_EQ(user.getUserPassword(), "");
    EXPECT_EQ(user.getUserId(), "");
    EXPECT_EQ(user.getGroupId(), "");
    EXPECT_FALSE(user.IsUserAcctDisabled());
    EXPECT_FALSE(user.IsDelete());
    EXPECT_EQ(user.getPwdMinDays(), 0U);
    EXPECT_EQ(user.getPwdMaxDays(), 0U);
    EXPECT_EQ(user.getPwdWarnDays(), 0U);
    EXPECT_EQ(user.getPasswordHistoryDepth(), 0);
    EXPECT_EQ(user.getMaxLoginFailures(), 0);
    EXPECT_EQ(user.getPwdInactDays(), 0U);
    EXPECT_EQ(user.getLstPwdChg(), 0U);
    EXPECT_EQ(user.getPwdExpDays(), 0U);
}

TEST(UserRecord, StartsWithEmptyTextsWhenMadeWithoutAName)
{
    userInfo user;
    EXPECT_EQ(user.getUserName(), "");
    EXPECT_EQ(user.getUserFullName(), "");
    EXPECT_EQ(user.getUserHomeDir(), "");
    EXPECT_EQ(user.getUserScriptPath(), "");
    EXPECT_EQ(user.getUserPassword(), "");
    EXPECT_EQ(user.getUserId(), "");
    EXPECT_EQ(user.getGroupId(), "");
}

TEST(UserRecord, KeepsEachTextApart)
{
    userInfo user("name");
    user.setUserFullName("full");
    user.setUserHomeDir("home");
    user.setUserScriptPath("shell");
    user.setUserPassword("password");
    user.setUserId("1000");
    user.setGroupId("100");
    EXPECT_EQ(user.getUserName(), "name");
    EXPECT_EQ(user.getUserFullName(), "full");
    EXPECT_EQ(user.getUserHomeDir(), "home");
    EXPECT_EQ(user.getUserScriptPath(), "shell");
    EXPECT_EQ(user.getUserPassword(), "password");
    EXPECT_EQ(user.getUserId(), "1000");
    EXPECT_EQ(user.getGroupId(), "100");
}

TEST(UserRecord, KeepsEachNumberApart)
{
    useZone("UTC0");
    userInfo user("jdoe");
    user.setPwdMinDays(1);
    user.setPwdMaxDays(2);
    user.setPwdWarnDays(3);
    user.setPwdExpDays(4);
    user.setPwdInactDays(5);
    user.setLstPwdChg(6);
    user.setPasswordHistoryDepth(7);
    user.setMaxLoginFailures(-8);
    user.setUserAcctDisabled(true);
    EXPECT_EQ(user.getPwdMinDays(), 1U);
    EXPECT_EQ(user.getPwdMaxDays(), 2U);
    EXPECT_EQ(user.getPwdWarnDays(), 3U);
    EXPECT_EQ(user.getPwdExpDays(), 4U);
    EXPECT_EQ(user.getPwdInactDays(), 5U * 86400);
    EXPECT_EQ(user.getLstPwdChg(), 6U * 86400);
    EXPECT_EQ(user.getPasswordHistoryDepth(), 7);
    EXPECT_EQ(user.getMaxLoginFailures(), -8);
    EXPECT_TRUE(user.IsUserAcctDisabled());
    EXPECT_FALSE(user.IsDelete());
}

TEST(UserRecord, IsCopiedMemberByMember)
{
    userInfo user("jdoe");
    user.setUserId("1000");
    user.setPwdMaxDays(90);
    userInfo copy(user);
    user.setUserId("1001");
    user.setPwdMaxDays(30);
    EXPECT_EQ(copy.getUserName(), "jdoe");
    EXPECT_EQ(copy.getUserId(), "1000");
    EXPECT_EQ(copy.getPwdMaxDays(), 90U);
}

TEST(UserRecord, ReplacesEmptyAgeingFieldsByDefaults)
{
    for (unsigned long const empty : {never, allBitsSet}) {
        userInfo user("jdoe");
        user.setPwdMinDays(empty);
        user.setPwdMaxDays(empty);
        user.setPwdWarnDays(empty);
        user.setPwdExpDays(empty);
        EXPECT_EQ(user.getPwdMinDays(), 0U);
        EXPECT_EQ(user.getPwdMaxDays(), 99999U);
        EXPECT_EQ(user.getPwdWarnDays(), 7U);
        EXPECT_EQ(user.getPwdExpDays(), 99999U);
    }
}

TEST(UserRecord, StoresEveryOtherNumberOfDaysAsGiven)
{
    for (unsigned long const days : {0UL, 1UL, 7UL, 99998UL, 99999UL, 100000UL, never - 1}) {
        userInfo user("jdoe");
        user.setPwdMinDays(days);
        user.setPwdMaxDays(days);
        user.setPwdWarnDays(days);
        user.setPwdExpDays(days);
        EXPECT_EQ(user.getPwdMinDays(), days);
        EXPECT_EQ(user.getPwdMaxDays(), days);
        EXPECT_EQ(user.getPwdWarnDays(), days);
        EXPECT_EQ(user.getPwdExpDays(), days);
    }
}

unsigned long inactiveTime(unsigned long days)
{
    userInfo user("jdoe");
    user.setPwdInactDays(days);
    return user.getPwdInactDays();
}

unsigned long lastChange(unsigned long days)
{
    userInfo user("jdoe");
    user.setLstPwdChg(days);
    return user.getLstPwdChg();
}

TEST(UserInactiveTime, Is19January2038IfTheFieldIsEmptyOr99999)
{
    for (unsigned long const days : {99999UL, never, allBitsSet}) {
        useZone("UTC0");
        EXPECT_EQ(inactiveTime(days), 2147472000U);
        useZone(east);
        EXPECT_EQ(inactiveTime(days), 2147472000U - 3600);
        useZone(west);
        // A time of 32 bits ends before that midnight, and an unknown time is 0.
        EXPECT_EQ(inactiveTime(days), sizeof(time_t) == 4 ? 0U : 2147472000U + 5 * 3600);
    }
}

TEST(UserInactiveTime, CountsFromLocalMidnightOf1January1970)
{
    useZone("UTC0");
    EXPECT_EQ(inactiveTime(0), 0U);
    EXPECT_EQ(inactiveTime(14000), 1209600000U);
    useZone(east);
    EXPECT_EQ(inactiveTime(14000), 1209600000U - 3600);
    useZone(west);
    EXPECT_EQ(inactiveTime(14000), 1209600000U + 5 * 3600);
}

TEST(UserInactiveTime, IsInSummerTimeIfJanuaryIs)
{
    useZone(south);
    EXPECT_EQ(inactiveTime(99999), 2147472000U - 11 * 3600);
    EXPECT_EQ(inactiveTime(14000), 1209600000U - 11 * 3600);
}

TEST(UserLastChange, IsInSummerTimeIfJanuaryIs)
{
    useZone(south);
    EXPECT_EQ(lastChange(13879), 1199145600U - 11 * 3600);
}

TEST(UserInactiveTime, CountsTheDaysAround99999LikeAnyOther)
{
    useZone("UTC0");
    EXPECT_EQ(inactiveTime(99998), static_cast<unsigned long>(8639827200ULL));
    EXPECT_EQ(inactiveTime(100000), static_cast<unsigned long>(8640000000ULL));
}

TEST(UserLastChange, IsCountedFromTheLocalMidnightOf1January1970)
{
    useZone("UTC0");
    EXPECT_EQ(lastChange(0), 0U);
    EXPECT_EQ(lastChange(13879), 1199145600U);
    useZone(east);
    EXPECT_EQ(lastChange(13879), 1199145600U - 3600);
    useZone(west);
    EXPECT_EQ(lastChange(13879), 1199145600U + 5 * 3600);
}

TEST(UserLastChange, CountsAnEmptyFieldAsDaysLikeAnyOther)
{
    useZone("UTC0");
    for (unsigned long const empty : {never, allBitsSet})
        EXPECT_EQ(lastChange(empty), static_cast<unsigned long>(371085174288000ULL));
    EXPECT_EQ(lastChange(99999), static_cast<unsigned long>(8639913600ULL));
}

struct Access {
    char const* name;
    std::function<void(userInfo& user)> call;
};

TEST(UserRecord, LogsEntryAndExitOfEverySetterAndGetter)
{
    Access const accesses[] = {
        {"getUserName", [](userInfo& user) { user.getUserName(); }},
        {"getUserFullName", [](userInfo& user) { user.getUserFullName(); }},
        {"setUserFullName", [](userInfo& user) { user.setUserFullName("x"); }},
        {"getUserHomeDir", [](userInfo& user) { user.getUserHomeDir(); }},
        {"setUserHomeDir", [](userInfo& user) { user.setUserHomeDir("x"); }},
        {"getUserScriptPath", [](userInfo& user) { user.getUserScriptPath(); }},
        {"setUserScriptPath", [](userInfo& user) { user.setUserScriptPath("x"); }},
        {"getUserPassword", [](userInfo& user) { user.getUserPassword(); }},
        {"setUserPassword", [](userInfo& user) { user.setUserPassword("x"); }},
        {"getUserId", [](userInfo& user) { user.getUserId(); }},
        {"setUserId", [](userInfo& user) { user.setUserId("x"); }},
        {"getGroupId", [](userInfo& user) { user.getGroupId(); }},
        {"setGroupId", [](userInfo& user) { user.setGroupId("x"); }},
        {"IsUserAcctDisabled", [](userInfo& user) { user.IsUserAcctDisabled(); }},
        {"setUserAcctDisabled", [](userInfo& user) { user.setUserAcctDisabled(true); }},
        {"IsDelete", [](userInfo& user) { user.IsDelete(); }},
        {"getPwdMinDays", [](userInfo& user) { user.getPwdMinDays(); }},
        {"setPwdMinDays", [](userInfo& user) { user.setPwdMinDays(never); }},
        {"getPwdMaxDays", [](userInfo& user) { user.getPwdMaxDays(); }},
        {"setPwdMaxDays", [](userInfo& user) { user.setPwdMaxDays(never); }},
        {"getPwdWarnDays", [](userInfo& user) { user.getPwdWarnDays(); }},
        {"setPwdWarnDays", [](userInfo& user) { user.setPwdWarnDays(never); }},
        {"getPwdExpDays", [](userInfo& user) { user.getPwdExpDays(); }},
        {"setPwdExpDays", [](userInfo& user) { user.setPwdExpDays(never); }},
        {"getPwdInactDays", [](userInfo& user) { user.getPwdInactDays(); }},
        {"getLstPwdChg", [](userInfo& user) { user.getLstPwdChg(); }},
        {"getPasswordHistoryDepth", [](userInfo& user) { user.getPasswordHistoryDepth(); }},
        {"setPasswordHistoryDepth", [](userInfo& user) { user.setPasswordHistoryDepth(1); }},
        {"getMaxLoginFailures", [](userInfo& user) { user.getMaxLoginFailures(); }},
        {"setMaxLoginFailures", [](userInfo& user) { user.setMaxLoginFailures(1); }},
    };
    Recording log;
    userInfo user("jdoe");
    for (Access const& access : accesses) {
        log.clear();
        access.call(user);
        std::string const name = access.name;
        EXPECT_EQ(log.texts(), (std::vector<std::string>{name + ": entry", name + ": exit"}));
        for (LogRecord const& record : log.records()) {
            EXPECT_EQ(record.function, name);
            EXPECT_EQ(record.file, "userInfo_linux");
            EXPECT_EQ(record.category, "Veltrix.IC.MI.OsSwMI.UserInfo");
            EXPECT_EQ(record.level, 3000);
        }
    }
}

TEST(UserRecord, ConvertsItsDatesByMonthNameAndByMonthNumber)
{
    useZone("UTC0");
    Recording log;
    userInfo user("jdoe");
    user.setPwdInactDays(1);
    EXPECT_EQ(log.texts(), (std::vector<std::string>{"setPwdInactDays: entry", "to_time_t: entry",
                                                     "to_time_t: exit", "setPwdInactDays: exit"}));
    log.clear();
    user.setPwdInactDays(99999);
    EXPECT_EQ(log.texts(), (std::vector<std::string>{"setPwdInactDays: entry", "to_time_t: entry",
                                                     "to_time_t: exit", "setPwdInactDays: exit"}));
    log.clear();
    user.setLstPwdChg(1);
    EXPECT_EQ(log.texts(), (std::vector<std::string>{"setLstPwdChg: entry", "ito_time_t: entry",
                                                     "to_time_t: entry", "to_time_t: exit",
                                                     "ito_time_t: exit", "setLstPwdChg: exit"}));
}

TEST(UserRecord, LogsNoConstructionCopyOrDestruction)
{
    Recording const log;
    {
        userInfo const user("jdoe");
        userInfo const empty;
        std::vector<userInfo> const copies(2, user);
    }
    EXPECT_TRUE(log.records().empty());
}

} // namespace user_record_test
