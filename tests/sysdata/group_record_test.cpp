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

Names tokens(std::string const& text, std::string const& delimiters)
{
    Names found;
    groupInfo().Tokenize(text, found, delimiters);
    return found;
}

TEST(GroupRecord, StartsWithItsNameAndNoMembers)
{
    groupInfo group("team");
    EXPECT_EQ(group.getGroupName(), "team");
    EXPECT_EQ(group.getGroupMembers(), Names{});
    EXPECT_EQ(groupInfo().getGroupName(), "");
    EXPECT_EQ(groupInfo().getGroupMembers(), Names{});
}

TEST(GroupRecord, KeepsItsId)
{
    groupInfo group("team");
    group.setGroupId(4294967295U);
    EXPECT_EQ(group.getGroupId(), 4294967295U);
}

TEST(GroupRecord, IsCopiedMemberByMember)
{
    groupInfo group("team");
    group.setGroupId(5);
    groupInfo copy(group);
    group.setGroupId(6);
    EXPECT_EQ(copy.getGroupName(), "team");
    EXPECT_EQ(copy.getGroupId(), 5U);
}

TEST(GroupRecord, JoinsPrimaryMembersAndThenItsOwn)
{
    FakeFiles const files;
    files.write("/etc/passwd", account("root", 1000, 0) + account("anna", 1000, 500) +
                                   account("zoe", 1000, 501) + account("ben", 1000, 500));
    EXPECT_EQ(members(500, {"ben", "Xaver"}), (Names{"anna", "ben", "Xaver"}));
}

TEST(GroupRecord, TakesAccountsOfAnyUidAsPrimaryMembers)
{
    FakeFiles const files;
    files.write("/etc/passwd", "daemon:x:2:500::/:/bin/false\n");
    EXPECT_EQ(members(500, {}), Names{"daemon"});
}

TEST(GroupRecord, HasOnlyItsOwnMembersWithoutAnAccountFile)
{
    FakeFiles const files;
    EXPECT_EQ(members(500, {"ben", "carl"}), (Names{"ben", "carl"}));
    EXPECT_EQ(members(500, {}), Names{});
}

TEST(GroupRecord, LosesAMemberWhenAListedNameEndsInIt)
{
    FakeFiles const files;
    files.write("/etc/passwd", account("xbob", 1000, 500));
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

TEST(GroupRecord, OpensTheAccountFileInModeRo)
{
    FakeFiles const files;
    files.write("/etc/passwd", account("anna", 1000, 500));
    Names opened;
    auto const below = libc::hooks().fopen.answer();
    libc::hooks().fopen = [&opened, below](char const* path, char const* mode) {
        opened.push_back(std::string(path) + ' ' + mode);
        return below(path, mode);
    };
    char* none[] = {nullptr};
    groupInfo().setGroupMembers(none);
    EXPECT_EQ(opened, Names{"/etc/passwd ro"});
}

TEST(GroupTokenize, YieldsTheNonEmptyPieces)
{
    EXPECT_EQ(tokens(",a,,b,", ","), (Names{"a", "b"}));
    EXPECT_EQ(tokens("abc", ","), Names{"abc"});
    EXPECT_EQ(tokens("", ","), Names{});
    EXPECT_EQ(tokens(",,,", ","), Names{});
}

TEST(GroupTokenize, SplitsAtEveryDelimiterCharacter)
{
    EXPECT_EQ(tokens("a:b,c;d", ",:"), (Names{"a", "b", "c;d"}));
}

TEST(GroupTokenize, AppendsToTheList)
{
    Names found{"old"};
    groupInfo().Tokenize("a,b", found, ",");
    EXPECT_EQ(found, (Names{"old", "a", "b"}));
}

TEST(GroupTokenize, LogsEachPiece)
{
    Recording const log;
    tokens("anna,ben", ",");
    EXPECT_EQ(log.texts(3000),
              (Names{"Tokenize: entry", "str.substr(lastPos, pos - lastPos) = anna",
                     "str.substr(lastPos, pos - lastPos) = ben", "Tokenize: exit"}));
    for (LogRecord const& record : log.records()) {
        EXPECT_EQ(record.function, "Tokenize");
        EXPECT_EQ(record.file, "groupInfo_linux");
        EXPECT_EQ(record.category, "Veltrix.IC.MI.OsSwMI.GroupInfo");
    }
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
    for (LogRecord const& record : log.records()) {
        EXPECT_EQ(record.file, "groupInfo_linux");
        EXPECT_EQ(record.category, "Veltrix.IC.MI.OsSwMI.GroupInfo");
    }
}

TEST(GroupRecord, TakesPrimaryMembersFromLinesOfAnyLength)
{
    FakeFiles const files;
    files.write("/etc/passwd", "anna:x:1000:500:" + std::string(20000, 'x') + ":/:/bin/sh\n" +
                                   account("ben", 1000, 500));
    EXPECT_EQ(members(500, {}), (Names{"anna", "ben"}));
}

TEST(GroupRecord, ReadsTheAccountsBetweenItsEntryAndItsExit)
{
    FakeFiles const files;
    files.write("/etc/passwd", account("ben", 1000, 500));
    Recording const log;
    std::vector<std::string> before;
    auto const below = libc::hooks().fopen.answer();
    libc::hooks().fopen = [&](char const* path, char const* mode) {
        before = log.texts();
        return below(path, mode);
    };
    char* none[] = {nullptr};
    NQ::groupInfo group("staff");
    group.setGroupId(500);
    group.setGroupMembers(none);
    ASSERT_FALSE(before.empty());
    EXPECT_EQ(before.back(), "setGroupMembers: entry");
    EXPECT_EQ(log.texts().back(), "setGroupMembers: exit");
}

} // namespace group_record_test
