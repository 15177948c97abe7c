#include "mihost/cli/doctor/FileChecks.h"

#include <gtest/gtest.h>

namespace file_checks_test
{

using namespace mihost;

TEST(ProblemOfRanges, IsAKeyWithoutALineOrANumber)
{
    EXPECT_EQ(problemOfRanges("UID_MIN 1000\nUID_MAX\t60000\nGID_MIN  1000\nGID_MAX 60000\n"),
              std::nullopt);
    EXPECT_EQ(problemOfRanges("# UID_MIN 1000\n UID_MAX 60000\nGID_MIN none\nGID_MAX 60000\n"),
              "no line begins with UID_MIN, UID_MAX, GID_MIN and a number");
    EXPECT_EQ(problemOfRanges("UID_MIN 1000\nUID_MAX 60000\nGID_MIN 1000\nGID_MAX"),
              "no line begins with GID_MAX and a number");
}

TEST(ProblemOfAccounts, IsALineThatLibcDoesNotAccept)
{
    std::string const good = "root:x:0:0:root:/root:/bin/sh\n\n# comment\n  \n+::::::\n";
    EXPECT_EQ(problemOfAccounts(good), std::nullopt);
    EXPECT_EQ(problemOfAccounts(""), std::nullopt);
    EXPECT_EQ(problemOfAccounts(good + "no colons\n"), "line 6 is malformed");
    EXPECT_EQ(problemOfAccounts(good + "a:x:b:0:::\n"), "line 6 is malformed");
}

TEST(ProblemOfAccounts, IsALineThatFillsThePluginsBuffer)
{
    std::string const start = "a:x:1:1:";
    std::string const end = ":/:/bin/sh";
    auto const ofLength = [&](std::size_t length) {
        return start + std::string(length - start.size() - end.size(), 'x') + end + "\n";
    };
    EXPECT_EQ(problemOfAccounts(ofLength(4093)), std::nullopt);
    EXPECT_EQ(problemOfAccounts(ofLength(4094)), "line 1 is too long");
}

TEST(ProblemOfGroups, IsALineThatLibcDoesNotAcceptNotItsLength)
{
    std::string many = "many:x:100:";
    for (int member = 0; member < 2000; ++member)
        many += "m" + std::to_string(member) + ",";
    EXPECT_EQ(problemOfGroups("root:x:0:\n" + many + "last\n"), std::nullopt);
    EXPECT_EQ(problemOfGroups("root:x:0:\nstaff:x:fifty:\n"), "line 2 is malformed");
}

TEST(ProblemOfShadow, IsTheFirstAccountMissingAtItsPlace)
{
    std::string const shadow = "root:*:1:0:99999:7:::\nbin:*:1:0:99999:7:::\nanna:!:1::::::\n"
                               "ben:!:1::::::\n";
    EXPECT_EQ(problemOfShadow({"root", "anna", "ben"}, shadow), std::nullopt);
    EXPECT_EQ(problemOfShadow({"root", "ben", "anna"}, shadow),
              "no entry for 'anna' at its place in the order of /etc/passwd");
    EXPECT_EQ(problemOfShadow({"root", "carl"}, shadow),
              "no entry for 'carl' at its place in the order of /etc/passwd");
}

TEST(ProblemOfShadow, IsAnEntryThatLibcDoesNotAccept)
{
    EXPECT_EQ(problemOfShadow({"root", "ben"}, "root:*:never:0:99999:7:::\nben:!:1::::::\n"),
              "no entry for 'root' at its place in the order of /etc/passwd");
    EXPECT_EQ(problemOfShadow({"ben"}, "x:" + std::string(5000, 'x') + ":1::::::\nben:!:1::::::\n"),
              "no entry for 'ben' at its place in the order of /etc/passwd");
}

TEST(ProblemOfRelease, IsThatTheTwoLinesAfterTheFirstAreMissing)
{
    EXPECT_EQ(problemOfRelease("Name\nVERSION = 4\nPATCHLEVEL = 0\n"), std::nullopt);
    char const* const problem = "no lines like 'VERSION = 1' and 'PATCHLEVEL = 0' after the first";
    EXPECT_EQ(problemOfRelease(""), problem);
    EXPECT_EQ(problemOfRelease("Name 1.2\n"), problem);
    EXPECT_EQ(problemOfRelease("Name\nVERSION=4\nPATCHLEVEL = 0\n"), problem); // 9 characters
    EXPECT_EQ(problemOfRelease("Name\nVERSION = 4\nPATCHLEVEL=0\n"), problem); // 12
}

TEST(ProblemOfStamps, IsTheNewestLineWithoutOne)
{
    EXPECT_EQ(problemOfStamps({}), std::nullopt);
    EXPECT_EQ(problemOfStamps({"Jan  2 03:04:05 host x: y", "Dec 31 23:59:59 "}), std::nullopt);
    EXPECT_EQ(
        problemOfStamps(
            {"2026-01-02T03:04:05.6+00:00 host", "2025-01-02T03:04:05 x", "Jan  2 03:04:05 host"}),
        "a line begins with '2025-01-02T03:04' instead of a time stamp like 'Jan  2 03:04:05 '");
    for (char const* line :
         {"", "Jan", "jan  2 03:04:05 x", "Jan 2 03:04:05 x", "Jan  2 3:04:05 x",
          "Jan  2 03:04:05x", "Jan  2 03:04:0", "Jan 2  03:04:05 x", "Jan    03:04:05 x"})
        EXPECT_NE(problemOfStamps({line}), std::nullopt) << line;
}

} // namespace file_checks_test
