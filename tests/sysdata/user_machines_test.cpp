// What is listed on the fixture machines in tests/machines/users-*.

#include "TestPaths.h"
#include "sysdata/userInfo_linux.h"

#include "tests/support/FileRoot.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace user_machines_test
{

using NQ::userInfo;

std::vector<userInfo> usersOf(std::string const& machine)
{
    FileRoot const root(MACHINES_DIR "/" + machine);
    std::vector<userInfo> users;
    NQ::getUserInfo(users);
    return users;
}

Lines namesOn(std::string const& machine)
{
    Lines names;
    for (userInfo& user : usersOf(machine))
        names.push_back(user.getUserName());
    return names;
}

/** Name, password, last change, minimum, maximum, warning, expiry days, inactive time. */
std::string ageing(userInfo& user)
{
    std::string text = user.getUserName() + ' ' + user.getUserPassword();
    for (unsigned long const value :
         {user.getLstPwdChg(), user.getPwdMinDays(), user.getPwdMaxDays(), user.getPwdWarnDays(),
          user.getPwdExpDays(), user.getPwdInactDays()})
        text += ' ' + std::to_string(value);
    return text;
}

Lines ageingOn(std::string const& machine)
{
    useZone("UTC0");
    Lines lines;
    for (userInfo& user : usersOf(machine))
        lines.push_back(ageing(user));
    return lines;
}

TEST(UserMachine, WithShadowInStepGivesEveryUserItsShadowFacts)
{
    EXPECT_EQ(ageingOn("users-shadow-in-step"),
              (Lines{"root $6$root$hash 1199145600 0 99999 7 99999 2147472000",
                     "anna $6$anna$hash 1209600000 1 90 14 30 1296000000",
                     "ben $6$ben$hash 1209600000 1 90 14 30 1296000000",
                     "carl $6$carl$hash 1209600000 1 90 14 30 1296000000"}));
}

TEST(UserMachine, WithShadowInStepGivesTheAccountFacts)
{
    std::vector<userInfo> users = usersOf("users-shadow-in-step");
    ASSERT_EQ(users.size(), 4U);
    userInfo& carl = users.at(3);
    EXPECT_EQ(carl.getUserName(), "carl");
    EXPECT_EQ(carl.getUserId(), "1002");
    EXPECT_EQ(carl.getGroupId(), "100");
    EXPECT_EQ(carl.getUserFullName(), "Carl Example");
    EXPECT_EQ(carl.getUserHomeDir(), "/home/carl");
    EXPECT_EQ(carl.getUserScriptPath(), "/bin/sh");
    EXPECT_EQ(carl.getPasswordHistoryDepth(), 0);
    EXPECT_EQ(carl.getMaxLoginFailures(), 0);
    for (userInfo& user : users) {
        EXPECT_FALSE(user.IsUserAcctDisabled());
        EXPECT_FALSE(user.IsDelete());
    }
}

TEST(UserMachine, LosesShadowFactsAfterAnEntryOutOfOrder)
{
    EXPECT_EQ(ageingOn("users-shadow-order"),
              (Lines{"root $6$root$hash 1199145600 0 99999 7 99999 2147472000",
                     "anna $6$anna$hash 1209600000 1 90 14 30 1296000000", "ben  0 0 0 0 0 0",
                     "carl  0 0 0 0 0 0"}));
}

TEST(UserMachine, ListsUsersWithoutAReadableShadowFile)
{
    EXPECT_EQ(ageingOn("users-without-shadow"), (Lines{"root  0 0 0 0 0 0", "anna  0 0 0 0 0 0"}));
}

TEST(UserMachine, WithEmptyAgeingFieldsHasTheSystemsDefaults)
{
    std::string const lastChange = std::to_string(static_cast<unsigned long>(371085174288000ULL));
    EXPECT_EQ(ageingOn("users-empty-ageing"),
              (Lines{"root * " + lastChange + " 0 99999 7 99999 2147472000",
                     "anna ! " + lastChange + " 0 99999 7 99999 2147472000"}));
}

TEST(UserMachine, ListsUsersUpToTheFirstLineThatDoesNotFit)
{
    EXPECT_EQ(namesOn("users-range-ends"), (Lines{"root", "first", "last"}));
    EXPECT_EQ(namesOn("users-long-line"), Lines{"root"});
    EXPECT_EQ(namesOn("users-malformed-line"), (Lines{"root", "ben"}));
}

TEST(UserMachine, WithoutLoginDefsListsOnlyRoot)
{
    EXPECT_EQ(namesOn("users-without-login-defs"), Lines{"root"});
}

TEST(UserMachine, ListsEveryAccountWithUidZero)
{
    EXPECT_EQ(ageingOn("users-two-roots"),
              (Lines{"root $6$root$hash 1199145600 0 99999 7 99999 2147472000",
                     "toor $6$toor$hash 1199232000 0 99999 7 99999 2147472000"}));
}

TEST(UserMachine, WithoutAnAccountFileHasNoUsersAndNoErrors)
{
    Recording const log;
    EXPECT_EQ(namesOn("users-without-passwd"), Lines{});
    EXPECT_EQ(log.texts(), (Lines{"getUserInfo: entry", "getUserInfo: exit"}));
}

std::vector<long> loginFailuresOn(std::string const& machine)
{
    std::vector<long> failures;
    for (userInfo& user : usersOf(machine))
        failures.push_back(user.getMaxLoginFailures());
    return failures;
}

TEST(UserMachine, GivesTheLastDenyToEveryUser)
{
    EXPECT_EQ(loginFailuresOn("users-deny-once"), (std::vector<long>{3, 3}));
    EXPECT_EQ(loginFailuresOn("users-deny-several"), (std::vector<long>{5, 5}));
    EXPECT_EQ(loginFailuresOn("users-deny-commented"), (std::vector<long>{8, 8}));
}

TEST(UserMachine, KeepsTheLastDenyThatIsANumber)
{
    Recording const log;
    EXPECT_EQ(loginFailuresOn("users-deny-unparsable"), (std::vector<long>{4, 4}));
    std::string const complaint = "Invalid format: line = auth required pam_tally2.so onerr=fail "
                                  "deny=many unlock_time=600";
    EXPECT_EQ(log.texts(6000), (Lines{complaint, complaint}));
}

} // namespace user_machines_test
