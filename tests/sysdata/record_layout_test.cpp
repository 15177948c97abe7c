// The layout of the records that exported operations take and return: only these fields, in order.

#include "sysdata/ParamInfo.h"
#include "sysdata/driverInfo_linux.h"
#include "sysdata/groupInfo_linux.h"
#include "sysdata/userInfo_linux.h"
#include "tests/support/FakeFiles.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstddef>
#include <cstring>
#include <functional>
#include <string>
#include <type_traits>
#include <vector>

namespace record_layout_test
{

using NQ::driverInfo;
using NQ::groupInfo;
using NQ::ParamInfo;
using NQ::userInfo;

template <class Record> using Changes = std::vector<std::function<void(Record& record)>>;

/** The offset of the first byte that each change modifies in an empty record. */
template <class Record> std::vector<std::ptrdiff_t> places(Changes<Record> const& changes)
{
    std::vector<std::ptrdiff_t> found;
    for (auto const& change : changes) {
        Record record;
        unsigned char before[sizeof record];
        unsigned char after[sizeof record];
        std::memcpy(before, static_cast<void const*>(&record), sizeof before);
        change(record);
        std::memcpy(after, static_cast<void const*>(&record), sizeof after);
        found.push_back(std::mismatch(before, before + sizeof before, after).first - before);
    }
    return found;
}

template <class Record> bool areInOrder(Changes<Record> const& changes)
{
    static_assert(!std::is_polymorphic_v<Record>);
    std::vector<std::ptrdiff_t> const found = places(changes);
    return found.back() < static_cast<std::ptrdiff_t>(sizeof(Record)) &&
           std::adjacent_find(found.begin(), found.end(), std::greater_equal<>()) == found.end();
}

TEST(RecordLayout, OfAParameterIsNameTypeAndValue)
{
    EXPECT_EQ(offsetof(ParamInfo, name), 0U);
    EXPECT_EQ(offsetof(ParamInfo, type), sizeof(std::string));
    EXPECT_EQ(offsetof(ParamInfo, value), 2 * sizeof(std::string));
    EXPECT_EQ(sizeof(ParamInfo), 3 * sizeof(std::string));
}

TEST(RecordLayout, OfAUserIsSevenTextsTwoFlagsAndEightNumbers)
{
    // The flag that nothing sets is between its neighbours, which leave room only for it.
    EXPECT_TRUE(areInOrder<userInfo>({
        [](userInfo& user) { user = userInfo("x"); },
        [](userInfo& user) { user.setUserFullName("x"); },
        [](userInfo& user) { user.setUserHomeDir("x"); },
        [](userInfo& user) { user.setUserScriptPath("x"); },
        [](userInfo& user) { user.setUserPassword("x"); },
        [](userInfo& user) { user.setUserId("x"); },
        [](userInfo& user) { user.setGroupId("x"); },
        [](userInfo& user) { user.setUserAcctDisabled(true); },
        [](userInfo& user) { user.setPwdMinDays(1); },
        [](userInfo& user) { user.setPwdMaxDays(1); },
        [](userInfo& user) { user.setPwdWarnDays(1); },
        [](userInfo& user) { user.setPasswordHistoryDepth(1); },
        [](userInfo& user) { user.setMaxLoginFailures(1); },
        [](userInfo& user) { user.setPwdInactDays(14000); },
        [](userInfo& user) { user.setLstPwdChg(14000); },
        [](userInfo& user) { user.setPwdExpDays(1); },
    }));
    EXPECT_EQ(sizeof(userInfo), 7 * sizeof(std::string) + (1 + 8) * sizeof(long));
}

TEST(RecordLayout, OfAGroupIsItsNameItsMembersAndItsId)
{
    FakeFiles const noAccounts;
    EXPECT_TRUE(areInOrder<groupInfo>({
        [](groupInfo& group) { group = groupInfo("x"); },
        [](groupInfo& group) {
            char member[] = "x";
            char* members[] = {member, nullptr};
            group.setGroupMembers(members);
        },
        [](groupInfo& group) { group.setGroupId(1); },
    }));
    EXPECT_EQ(sizeof(groupInfo), 2 * sizeof(std::string) + sizeof(long));
}

TEST(RecordLayout, OfADriverIsFiveTexts)
{
    EXPECT_TRUE(areInOrder<driverInfo>({
        [](driverInfo& driver) { driver.setName("x"); },
        [](driverInfo& driver) { driver.setVersion("x"); },
        [](driverInfo& driver) { driver.setDescription("x"); },
        [](driverInfo& driver) { driver.setBuildNumber("x"); },
        [](driverInfo& driver) { driver.setManufacturer("x"); },
    }));
    EXPECT_EQ(sizeof(driverInfo), 5 * sizeof(std::string));
}

} // namespace record_layout_test
