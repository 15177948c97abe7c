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

#include <algorithm>
#include <grp.h>
#include <new>
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

TEST(GroupMachine, WithTwoSourcesJoinsThemInDatabaseOrder)
{
    EXPECT_EQ(groupsOn("groups-two-sources"),
              (Lines{"root 0 root", "team 1500 anna ben carl", "carl 1002 carl", "empty 1003",
                     "last 60000 anna"}));
}

TEST(GroupMachine, WithoutAnAccountFileHasTheGroupsOwnMembers)
{
    EXPECT_EQ(groupsOn("groups-without-passwd"), (Lines{"root 0", "team 1500 ben carl"}));
}

TEST(GroupMachine, WithoutLoginDefsListsOnlyTheGroupWithIdZero)
{
    EXPECT_EQ(groupsOn("groups-without-login-defs"), Lines{"root 0 root anna"});
}

TEST(GroupMachine, WithNamesThatEndInOthersLosesTheShorterOnes)
{
    EXPECT_EQ(groupsOn("groups-name-endings"), Lines{"team 1500 xbob bobx bo carl"});
}

/** A machine with its own groups; calls of the group database are recorded. */
class GroupListing : public testing::Test
{
protected:
    GroupListing()
    {
        files_.write("/etc/login.defs", "GID_MIN 500\nGID_MAX 60000\n");
        NQ::minMaxId::Instance();
        auto const rewind = libc::hooks().setgrent.answer();
        auto const next = libc::hooks().getgrent.answer();
        auto const close = libc::hooks().endgrent.answer();
        auto const open = libc::hooks().fopen.answer();
        libc::hooks().setgrent = [this, rewind] {
            steps_.emplace_back("setgrent");
            rewind();
        };
        libc::hooks().getgrent = [this, next] {
            steps_.emplace_back("getgrent");
            return next();
        };
        libc::hooks().endgrent = [this, close] {
            steps_.emplace_back("endgrent");
            close();
        };
        libc::hooks().fopen = [this, open](char const* path, char const* mode) {
            if (noting_)
                opened_.push_back(std::string(path) + ' ' + mode);
            return open(path, mode);
        };
    }

    FakeFiles const files_;
    libc::HookGuard const guard_;
    bool noting_ = false;
    Lines steps_;
    Lines opened_;
};

TEST_F(GroupListing, KeepsGidZeroAndOmitsSystemGroups)
{
    files_.write("/etc/group", "root:x:0:\ntty:x:5:\nteam:x:500:\n");
    EXPECT_EQ(listed(), (Lines{"root 0", "team 500"}));
}

TEST_F(GroupListing, KeepsAGidAtEitherEndOfTheRangeAndNoneBeyond)
{
    files_.write("/etc/group", "a:x:499:\nb:x:500:\nc:x:60000:\nd:x:60001:\n");
    EXPECT_EQ(listed(), (Lines{"b 500", "c 60000"}));
}

TEST_F(GroupListing, KeepsEveryGroupWithGidZero)
{
    files_.write("/etc/group", "root:x:0:\nwheel:x:0:anna\n");
    files_.write("/etc/passwd", "root:x:0:0:::\n");
    EXPECT_EQ(listed(), (Lines{"root 0 root", "wheel 0 root anna"}));
}

TEST_F(GroupListing, ReplacesWhatTheListHeldBefore)
{
    files_.write("/etc/group", "team:x:500:\n");
    std::vector<groupInfo> groups(3, groupInfo("old"));
    NQ::getGroupInfo(groups);
    ASSERT_EQ(groups.size(), 1U);
    EXPECT_EQ(groups.front().getGroupName(), "team");
}

TEST_F(GroupListing, RewindsTheDatabaseReadsItToItsEndAndClosesIt)
{
    files_.write("/etc/group", "root:x:0:\ntty:x:5:\n");
    listed();
    EXPECT_EQ(steps_, (Lines{"setgrent", "getgrent", "getgrent", "getgrent", "endgrent"}));
}

TEST_F(GroupListing, ReadsTheAccountFileOnceForAllGroups)
{
    files_.write("/etc/group", "root:x:0:\nteam:x:500:\nothers:x:501:\n");
    noting_ = true;
    listed();
    EXPECT_EQ(opened_, Lines{"/etc/passwd ro"});
}

TEST_F(GroupListing, GivesEachGroupItsOwnMembers)
{
    files_.write("/etc/passwd", "root:x:0:0:::\nanna:x:1000:500:::\nben:x:1001:501:::\n"
                                "carl:x:1002:500:::\n");
    files_.write("/etc/group", "root:x:0:\nteam:x:500:ben,dora\nothers:x:501:anna,ben\n");
    std::vector<groupInfo> groups;
    NQ::getGroupInfo(groups);
    char ben[] = "ben";
    char dora[] = "dora";
    char anna[] = "anna";
    char* none[] = {nullptr};
    char* team[] = {ben, dora, nullptr};
    char* others[] = {anna, ben, nullptr};
    char** const own[] = {none, team, others};
    ASSERT_EQ(groups.size(), 3U);
    for (std::size_t i = 0; i < groups.size(); ++i) {
        groupInfo alone(groups[i].getGroupName());
        alone.setGroupId(groups[i].getGroupId());
        alone.setGroupMembers(own[i]);
        EXPECT_EQ(shown(groups[i]), shown(alone));
    }
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

TEST_F(GroupListing, ReturnsWhatUnlockingReturned)
{
    MutexCalls mutexes;
    mutexes.onUnlock = [](NQ::Mutex const&) { return 7; };
    std::vector<groupInfo> groups;
    EXPECT_EQ(NQ::getGroupInfo(groups), 7);
}

TEST_F(GroupListing, UsesTheSameMutexEachTime)
{
    MutexCalls mutexes;
    std::vector<NQ::Mutex const*> locked;
    mutexes.onLock = [&locked](NQ::Mutex const& mutex, unsigned long) { locked.push_back(&mutex); };
    listed();
    listed();
    ASSERT_EQ(locked.size(), 2U);
    EXPECT_EQ(locked[0], locked[1]);
}

TEST_F(GroupListing, ClosesAndUnlocksWhenAnExceptionPasses)
{
    auto const next = libc::hooks().getgrent.answer();
    libc::hooks().getgrent = []() -> group* { throw std::bad_alloc(); };
    std::vector<groupInfo> groups;
    EXPECT_THROW(NQ::getGroupInfo(groups), std::bad_alloc);
    EXPECT_EQ(steps_, (Lines{"setgrent", "endgrent"}));
    libc::hooks().getgrent = next;
    files_.write("/etc/group", "root:x:0:\n");
    EXPECT_EQ(listed(), Lines{"root 0"}); // would hang if the mutex were still locked
}

TEST_F(GroupListing, IsEmptyOnAnEmptyDatabase)
{
    files_.write("/etc/group", "");
    EXPECT_EQ(listed(), Lines{});
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
    for (LogRecord const& record : log.records()) {
        EXPECT_EQ(record.file, "groupInfo_linux");
        EXPECT_EQ(record.category, "Veltrix.IC.MI.OsSwMI.GroupInfo");
    }
}

TEST_F(GroupListing, EmptiesTheListBeforeItWaitsForItsMutex)
{
    std::vector<groupInfo> groups(3, groupInfo("old"));
    std::size_t atLock = 4711;
    MutexCalls mutexes;
    mutexes.onLock = [&](NQ::Mutex const&, unsigned long) { atLock = groups.size(); };
    NQ::getGroupInfo(groups);
    EXPECT_EQ(atLock, 0U);
}

} // namespace group_list_test
