#include "TestPaths.h"
#include "sysdata/groupInfo_linux.h"

#include "sysdata/minMaxId.h"
#include "tests/interpose/Libc.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/FileRoot.h"
#include "tests/support/Lines.h"
#include "tests/support/MutexCalls.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <grp.h>
#include <new>
#include <set>
#include <string>
#include <vector>

namespace group_list_test
{

using NQ::groupInfo;

/** Name, id and members. */
std::string shown(groupInfo& group)
{
    std::string text = group.getGroupName() + ' ' + std::to_string(group.getGroupId());
    for (std::string const& member : group.getGroupMembers())
        text += ' ' + member;
    return text;
}

Lines listed()
{
    std::vector<groupInfo> groups;
    EXPECT_EQ(NQ::getGroupInfo(groups), 0);
    Lines lines;
    for (groupInfo& group : groups)
        lines.push_back(shown(group));
    return lines;
}

Lines groupsOn(std::string const& machine)
{
    FileRoot const root(MACHINES_DIR "/" + machine);
    return listed();
}

TEST(GroupMachine, HasTheMembersOfBothFiles)
{
    EXPECT_EQ(groupsOn("groups-two-sources"),
              (Lines{"root 0 root", "team 1500 anna ben carl", "carl 1002 carl", "empty 1003",
                     "last 60000 anna"}));
    EXPECT_EQ(groupsOn("groups-without-passwd"), (Lines{"root 0", "team 1500 ben carl"}));
    EXPECT_EQ(groupsOn("groups-name-endings"), Lines{"team 1500 xbob bobx bo carl"});
}

TEST(GroupMachine, WithoutLoginDefsListsOnlyTheGroupWithIdZero)
{
    EXPECT_EQ(groupsOn("groups-without-login-defs"), Lines{"root 0 root anna"});
}

/** A machine with its own groups; calls of the group database are recorded. */
class GroupListing : public testing::Test
{
protected:
    GroupListing()
    {
        files_.write("/etc/login.defs", "GID_MIN 500\nGID_MAX 60000\n");
        NQ::minMaxId::Instance();
        libc::hooks().setgrent.watch([this] { steps_.emplace_back("setgrent"); });
        libc::hooks().getgrent.watch([this] { steps_.emplace_back("getgrent"); });
        libc::hooks().endgrent.watch([this] { steps_.emplace_back("endgrent"); });
        libc::hooks().fopen.watch([this](std::string const& path, std::string const& mode) {
            opened_.push_back(path + ' ' + mode);
        });
    }

    FakeFiles const files_;
    Lines steps_;
    Lines opened_;
};

TEST_F(GroupListing, KeepsGidZeroAndTheRangeAndNoneBeyond)
{
    files_.write("/etc/group", "root:x:0:\nwheel:x:0:anna\ntty:x:5:\na:x:499:\nb:x:500:\n"
                               "c:x:60000:\nd:x:60001:\n");
    files_.write("/etc/passwd", "root:x:0:0:::\n");
    EXPECT_EQ(listed(), (Lines{"root 0 root", "wheel 0 root anna", "b 500", "c 60000"}));
}

TEST_F(GroupListing, EmptiesTheListBeforeItWaitsForItsMutex)
{
    files_.write("/etc/group", "team:x:500:\n");
    std::vector<groupInfo> groups(3, groupInfo("old"));
    std::size_t atLock = 4711;
    MutexCalls mutexes;
    mutexes.onLock = [&](NQ::Mutex const&, unsigned long) { atLock = groups.size(); };
    NQ::getGroupInfo(groups);
    EXPECT_EQ(atLock, 0U);
    ASSERT_EQ(groups.size(), 1U);
    EXPECT_EQ(groups.front().getGroupName(), "team");
}

TEST_F(GroupListing, ReadsTheDatabaseToItsEndAndTheAccountsOnce)
{
    files_.write("/etc/group", "root:x:0:\nteam:x:500:\n");
    opened_.clear();
    listed();
    EXPECT_EQ(steps_, (Lines{"setgrent", "getgrent", "getgrent", "getgrent", "endgrent"}));
    EXPECT_EQ(opened_, Lines{"/etc/passwd ro"});
}

TEST_F(GroupListing, GivesEachGroupItsOwnMembers)
{
    files_.write("/etc/passwd", "root:x:0:0:::\nanna:x:1000:500:::\nben:x:1001:501:::\n"
                                "carl:x:1002:500:::\n");
    files_.write("/etc/group", "root:x:0:\nteam:x:500:ben,dora\nothers:x:501:anna,ben\n");
    EXPECT_EQ(listed(),
              (Lines{"root 0 root", "team 500 anna carl ben dora", "others 501 ben anna"}));
}

TEST_F(GroupListing, HoldsItsOwnMutexWhileItUsesTheDatabase)
{
    files_.write("/etc/group", "");
    MutexCalls mutexes;
    NQ::Mutex const* locked = nullptr;
    mutexes.onLock = [this, &locked](NQ::Mutex const& mutex, unsigned long timeout) {
        steps_.push_back("lock " + std::to_string(timeout));
        locked = &mutex;
    };
    mutexes.onUnlock = [this, &locked](NQ::Mutex const& mutex) {
        steps_.emplace_back(&mutex == locked ? "unlock" : "unlock another");
        return 0;
    };
    listed();
    EXPECT_EQ(steps_, (Lines{"lock 4294967295", "setgrent", "getgrent", "endgrent", "unlock"}));
}

TEST_F(GroupListing, ReturnsWhatUnlockingItsOneMutexReturned)
{
    MutexCalls mutexes;
    std::set<NQ::Mutex const*> locked;
    mutexes.onLock = [&locked](NQ::Mutex const& mutex, unsigned long) { locked.insert(&mutex); };
    mutexes.onUnlock = [](NQ::Mutex const&) { return 7; };
    std::vector<groupInfo> groups;
    EXPECT_EQ(NQ::getGroupInfo(groups), 7);
    EXPECT_EQ(NQ::getGroupInfo(groups), 7);
    EXPECT_EQ(locked.size(), 1U);
}

TEST_F(GroupListing, ClosesAndUnlocksWhenAnExceptionPasses)
{
    auto const next = libc::hooks().getgrent.answer();
    libc::hooks().getgrent = []() -> group* { throw std::bad_alloc(); };
    std::vector<groupInfo> groups;
    EXPECT_THROW(NQ::getGroupInfo(groups), std::bad_alloc);
    EXPECT_EQ(steps_, (Lines{"setgrent", "getgrent", "endgrent"}));
    libc::hooks().getgrent = next;
    files_.write("/etc/group", "root:x:0:\n");
    EXPECT_EQ(listed(), Lines{"root 0"}); // would hang if the mutex were still locked
}

TEST_F(GroupListing, LogsWhatItDoesForEachGroup)
{
    files_.write("/etc/group", "team:x:500:anna\ntty:x:5:\n");
    Recording const log;
    std::vector<groupInfo> groups;
    NQ::getGroupInfo(groups);
    EXPECT_EQ(log.texts(3000),
              (Lines{"getGroupInfo: entry", "setGroupId: entry", "setGroupId: exit",
                     "setGroupMembers: entry", "setGroupMembers: exit", "getGroupInfo: exit"}));
    std::string const unit = " groupInfo_linux Veltrix.IC.MI.OsSwMI.GroupInfo";
    EXPECT_EQ(log.sources(),
              (Lines{"getGroupInfo" + unit, "setGroupId" + unit, "setGroupMembers" + unit}));
}

} // namespace group_list_test
