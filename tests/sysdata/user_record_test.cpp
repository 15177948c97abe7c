#include "sysdata/userInfo_linux.h"

#include "tests/support/Lines.h"
#include "tests/support/Recording.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

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

/** All texts but the name. */
Lines textsOf(userInfo& user)
{
    return {user.getUserFullName(), user.getUserHomeDir(), user.getUserScriptPath(),
            user.getUserPassword(), user.getUserId(),      user.getGroupId()};
}

/** All numbers; those of days as they are stored. */
std::vector<long> numbersOf(userInfo& user)
{
    std::vector<long> numbers{user.getPasswordHistoryDepth(), user.getMaxLoginFailures()};
    for (unsigned long const days :
         {user.getPwdMinDays(), user.getPwdMaxDays(), user.getPwdWarnDays(), user.getPwdExpDays(),
          user.getPwdInactDays(), user.getLstPwdChg()})
        numbers.push_back(static_cast<long>(days));
    return numbers;
}

TEST(UserRecord, StartsWithItsNameAndNothingElse)
{
    userInfo user("jdoe");
    EXPECT_EQ(user.getUserName(), "jdoe");
    EXPECT_EQ(textsOf(user), Lines(6));
    EXPECT_EQ(numbersOf(user), std::vector<long>(8, 0));
    EXPECT_FALSE(user.IsUserAcctDisabled());
    EXPECT_FALSE(user.IsDelete());
    userInfo unnamed;
    EXPECT_EQ(unnamed.getUserName(), "");
    EXPECT_EQ(textsOf(unnamed), Lines(6));
}

TEST(UserRecord, KeepsEachFactApart)
{
    useZone("UTC0");
    userInfo user("jdoe");
    user.setUserFullName("full");
    user.setUserHomeDir("home");
    user.setUserScriptPath("shell");
    user.setUserPassword("password");
    user.setUserId("1000");
    user.setGroupId("100");
    user.setPwdMinDays(1);
    user.setPwdMaxDays(2);
    user.setPwdWarnDays(3);
    user.setPwdExpDays(4);
    user.setPwdInactDays(5);
    user.setLstPwdChg(6);
    user.setPasswordHistoryDepth(7);
    user.setMaxLoginFailures(-8);
    user.setUserAcctDisabled(true);
    userInfo copy(user);
    user.setUserId("1001");
    user.setPwdMaxDays(30);
    EXPECT_EQ(copy.getUserName(), "jdoe");
    EXPECT_EQ(textsOf(copy), (Lines{"full", "home", "shell", "password", "1000", "100"}));
    EXPECT_EQ(numbersOf(copy), (std::vector<long>{7, -8, 1, 2, 3, 4, 5L * 86400, 6L * 86400}));
    EXPECT_TRUE(copy.IsUserAcctDisabled());
    EXPECT_FALSE(copy.IsDelete());
}

TEST(UserRecord, ReplacesEmptyAgeingFieldsByDefaults)
{
    EXPECT_EQ(never, 0xFFFFFFFFUL);
    using Days = std::vector<unsigned long>; // minimum, maximum, warning, expiry
    auto const stored = [](unsigned long days) {
        userInfo user("jdoe");
        user.setPwdMinDays(days);
        user.setPwdMaxDays(days);
        user.setPwdWarnDays(days);
        user.setPwdExpDays(days);
        return Days{user.getPwdMinDays(), user.getPwdMaxDays(), user.getPwdWarnDays(),
                    user.getPwdExpDays()};
    };
    for (unsigned long const empty : {never, allBitsSet})
        EXPECT_EQ(stored(empty), (Days{0, 99999, 7, 99999}));
    for (unsigned long const days : {0UL, 1UL, 7UL, 99998UL, 99999UL, 100000UL, never - 1})
        EXPECT_EQ(stored(days), Days(4, days));
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

TEST(UserInactiveTime, IsLocalMidnightOfThatDay)
{
    constexpr unsigned long january2038 = 2147472000;
    struct {
        unsigned long days;
        unsigned long inUtc;
    } const cases[] = {{0, 0},
                       {14000, 1209600000},
                       {99999, january2038},
                       {never, january2038},
                       {allBitsSet, january2038},
                       {99998, static_cast<unsigned long>(8639827200ULL)},
                       {100000, static_cast<unsigned long>(8640000000ULL)}};
    for (auto const& [days, inUtc] : cases) {
        useZone("UTC0");
        EXPECT_EQ(inactiveTime(days), inUtc) << days;
        if (days == 0 || days == 99998 || days == 100000)
            continue;
        useZone(east);
        EXPECT_EQ(inactiveTime(days), inUtc - 3600) << days;
        useZone(south);
        EXPECT_EQ(inactiveTime(days), inUtc - 11 * 3600) << days;
        useZone(west);
        // A time of 32 bits ends before that midnight, and an unknown time is 0.
        bool const isUnknown = sizeof(time_t) == 4 && inUtc == january2038;
        EXPECT_EQ(inactiveTime(days), isUnknown ? 0U : inUtc + 5 * 3600) << days;
    }
}

TEST(UserLastChange, IsCountedFromTheLocalMidnightOf1January1970)
{
    struct {
        unsigned long days;
        char const* zone;
        unsigned long time;
    } const cases[] = {{0, "UTC0", 0},
                       {13879, "UTC0", 1199145600},
                       {13879, east, 1199145600 - 3600},
                       {13879, west, 1199145600 + 5 * 3600},
                       {13879, south, 1199145600 - 11 * 3600},
                       {99999, "UTC0", static_cast<unsigned long>(8639913600ULL)},
                       {never, "UTC0", static_cast<unsigned long>(371085174288000ULL)},
                       {allBitsSet, "UTC0", static_cast<unsigned long>(371085174288000ULL)}};
    for (auto const& [days, zone, time] : cases) {
        useZone(zone);
        EXPECT_EQ(lastChange(days), time) << days << zone;
    }
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
        EXPECT_EQ(log.texts(3000), (Lines{name + ": entry", name + ": exit"}));
        EXPECT_EQ(log.sources(), Lines{name + " userInfo_linux Veltrix.IC.MI.OsSwMI.UserInfo"});
    }
}

TEST(UserRecord, ConvertsItsDatesByMonthNameAndByMonthNumber)
{
    useZone("UTC0");
    Recording log;
    userInfo user("jdoe");
    for (unsigned long const days : {1UL, 99999UL}) {
        log.clear();
        user.setPwdInactDays(days);
        EXPECT_EQ(log.texts(), (Lines{"setPwdInactDays: entry", "to_time_t: entry",
                                      "to_time_t: exit", "setPwdInactDays: exit"}));
    }
    log.clear();
    user.setLstPwdChg(1);
    EXPECT_EQ(log.texts(), (Lines{"setLstPwdChg: entry", "ito_time_t: entry", "to_time_t: entry",
                                  "to_time_t: exit", "ito_time_t: exit", "setLstPwdChg: exit"}));
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
