#include "sysdata/groupInfo_linux.h"

#include "tests/interpose/Libc.h"
#include "tests/support/Account.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace group_record_test
{

using NQ::groupInfo;
using Names = std::vector<std::string>;

/** The members of a group with the given id, as the group's own list names them. */
Names members(unsigned int gid, Names own)
{
    std::vector<char*> pointers;
    for (std::string& name : own)
        pointers.push_back(name.data());
    pointers.push_back(nullptr);
    groupInfo group("team");
    group.setGroupId(gid);
    group.setGroupMembers(pointers.data());
    return group.getGroupMembers();
}

TEST(GroupRecord, StartsWithItsNameAndIsCopiedMemberByMember)
{
    groupInfo group("team");
    EXPECT_EQ(group.getGroupName(), "team");
    EXPECT_EQ(group.getGroupMembers(), Names{});
    EXPECT_EQ(groupInfo().getGroupName(), "");
    EXPECT_EQ(groupInfo().getGroupMembers(), Names{});
    group.setGroupId(4294967295U);
    groupInfo copy(group);
    group.setGroupId(6);
    EXPECT_EQ(copy.getGroupName(), "team");
    EXPECT_EQ(copy.getGroupId(), 4294967295U);
}

TEST(GroupRecord, JoinsPrimaryMembersAndThenItsOwn)
{
    FakeFiles const files;
    EXPECT_EQ(members(500, {"ben", "carl"}), (Names{"ben", "carl"})); // no account file
    EXPECT_EQ(members(500, {}), Names{});
    EXPECT_EQ(members(500, {"van dam"}), Names{"van dam"});
    files.write("/etc/passwd", account("root", 1000, 0) + account("anna", 2, 500) +
                                   account("zoe", 1000, 501) + account("ben", 1000, 500));
    EXPECT_EQ(members(500, {"ben", "Xaver"}), (Names{"anna", "ben", "Xaver"}));
    files.write("/etc/passwd", "anna:x:1000:500:" + std::string(20000, 'x') + ":/:/bin/sh\n" +
                                   account("ben", 1000, 500));
    EXPECT_EQ(members(500, {}), (Names{"anna", "ben"}));
    files.write("/etc/passwd", account("xbob", 1000, 500)); // which ends in another name
    EXPECT_EQ(members(500, {"bob", "bobx"}), (Names{"xbob", "bobx"}));
}

TEST(GroupRecord, ReplacesItsMembers)
{
    FakeFiles const files;
    files.write("/etc/passwd", account("anna", 1000, 500));
    char* none[] = {nullptr};
    groupInfo group("team");
    group.setGroupId(500);
    group.setGroupMembers(none);
    group.setGroupMembers(none);
    EXPECT_EQ(group.getGroupMembers(), Names{"anna"});
    files.write("/etc/passwd", account("ben", 1000, 500));
    group.setGroupMembers(none);
    EXPECT_EQ(group.getGroupMembers(), Names{"ben"});
}

TEST(GroupRecord, LogsEntryAndExitOfEveryOperation)
{
    FakeFiles const files;
    Recording log;
    groupInfo group("team");
    EXPECT_TRUE(log.records().empty());
    group.getGroupName();
    group.getGroupId();
    group.setGroupId(1);
    char* none[] = {nullptr};
    group.setGroupMembers(none);
    group.getGroupMembers();
    EXPECT_EQ(log.texts(3000),
              (Names{"getGroupName: entry", "getGroupName: exit", "getGroupId: entry",
                     "getGroupId: exit", "setGroupId: entry", "setGroupId: exit",
                     "setGroupMembers: entry", "setGroupMembers: exit", "getGroupMembers: entry",
                     "Tokenize: entry", "Tokenize: exit", "getGroupMembers: exit"}));
    for (std::string const& source : log.sources())
        EXPECT_NE(source.find(" groupInfo_linux Veltrix.IC.MI.OsSwMI.GroupInfo"), source.npos);
}

TEST(GroupRecord, OpensTheAccountsBetweenItsEntryAndItsExit)
{
    FakeFiles const files;
    Recording const log;
    Names opened;
    libc::hooks().fopen.watch([&](std::string const& path, std::string const& mode) {
        opened = {path, mode, log.texts().back()};
    });
    char* none[] = {nullptr};
    groupInfo().setGroupMembers(none);
    EXPECT_EQ(opened, (Names{"/etc/passwd", "ro", "setGroupMembers: entry"}));
    EXPECT_EQ(log.texts().back(), "setGroupMembers: exit");
}

} // namespace group_record_test
