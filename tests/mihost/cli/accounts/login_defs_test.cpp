#include "mihost/cli/accounts/LoginDefs.h"

#include "sysdata/minMaxId.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/Lines.h"

#include <gtest/gtest.h>

namespace login_defs_test
{

using mihost::LoginDefs;

constexpr char usual[] = "UID_MIN 1000\nUID_MAX\t60000\nGID_MIN   500\nGID_MAX 40000\n";

TEST(LoginDefs, HasBothRanges)
{
    LoginDefs const defs(usual);
    EXPECT_EQ(defs.users().lowest, 1000U);
    EXPECT_EQ(defs.users().highest, 60000U);
    EXPECT_EQ(defs.groups().lowest, 500U);
    EXPECT_EQ(defs.groups().highest, 40000U);
    EXPECT_EQ(defs.missingKeys(), Lines());
}

TEST(LoginDefs, TakesTheLastNumberOfEachKeyAndNamesMissingOnes)
{
    EXPECT_EQ(LoginDefs("").missingKeys(), (Lines{"UID_MIN", "UID_MAX", "GID_MIN", "GID_MAX"}));
    EXPECT_EQ(LoginDefs("UID_MIN\n#UID_MAX 1\n UID_MAX 1\nGID_MIN x\nGID_MAX 5\n").missingKeys(),
              (Lines{"UID_MIN", "UID_MAX", "GID_MIN"}));
    LoginDefs const defs("UID_MIN 1\nUID_MIN 2\nUID_MIN none\nUID_MAX 9\nGID_MIN 3\n"
                         "GID_MAX 4\nGID_MAX 5\n");
    EXPECT_EQ(defs.users().lowest, 2U);
    EXPECT_EQ(defs.groups().highest, 4U);
}

TEST(LoginDefs, ReadsTheNumbersThatThePluginReads)
{
    for (std::string const text :
         {"", usual, "UID_MIN  -1\nUID_MAX 0x10\n", "UID_MINX7\nUID_MAX=9\n", "UID_MIN 1",
          "GID_MAX 4294967295\nGID_MIN 1\nUID_MIN 2\nUID_MAX 3\nUID_MAX 5\n"}) {
        FakeFiles const files;
        files.write("/etc/login.defs", text);
        NQ::minMaxId plugin;
        LoginDefs const defs(text);
        EXPECT_EQ(defs.users().lowest.value_or(0), plugin.getMinUserId()) << text;
        EXPECT_EQ(defs.users().highest.value_or(0), plugin.getMaxUserId()) << text;
        EXPECT_EQ(defs.groups().lowest.value_or(0), plugin.getMinGroupId()) << text;
        EXPECT_EQ(defs.groups().highest.value_or(0), plugin.getMaxGroupId()) << text;
    }
}

TEST(LoginDefs, FindsTheEncryptMethodAnywhereInItsLine)
{
    EXPECT_EQ(LoginDefs(usual).encryptMethod(), "");
    EXPECT_EQ(LoginDefs("#ENCRYPT_METHOD MD5\n").encryptMethod(), "");
    EXPECT_EQ(LoginDefs("ENCRYPT_METHOD SHA256\n  ENCRYPT_METHOD\tYESCRYPT # best\n"
                        "ENCRYPT_METHODS X\n")
                  .encryptMethod(),
              "YESCRYPT");
}

TEST(IdRange, HoldsItsBoundsAndZeroAndSaysWhichIsExceeded)
{
    auto const range = LoginDefs(usual).users();
    for (unsigned int const id : {0U, 1000U, 60000U}) {
        EXPECT_TRUE(range.holds(id)) << id;
        EXPECT_EQ(range.objectionTo("uid", id), "") << id;
    }
    EXPECT_FALSE(range.holds(999));
    EXPECT_FALSE(range.holds(60001));
    LoginDefs const defs(usual);
    EXPECT_EQ(defs.users().objectionTo("uid", 65534), "uid 65534 is above UID_MAX 60000");
    EXPECT_EQ(defs.groups().objectionTo("gid", 2), "gid 2 is below GID_MIN 500");
    EXPECT_EQ(LoginDefs("UID_MIN 1000\n").users().objectionTo("uid", 1000),
              "UID_MAX is not set in /etc/login.defs");
}

} // namespace login_defs_test
