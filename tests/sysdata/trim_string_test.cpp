#include "sysdata/osInfo_linux.h"

#include <gtest/gtest.h>

namespace trim_string_test
{

std::string trimmed(std::string text)
{
    NQ::OsInfo().trimString(text);
    return text;
}

TEST(TrimString, StripsBlanksFromBothEnds)
{
    EXPECT_EQ(trimmed("  x  "), "x");
    EXPECT_EQ(trimmed(" 10"), "10");
    EXPECT_EQ(trimmed("10 "), "10");
    EXPECT_EQ(trimmed("10"), "10");
}

TEST(TrimString, KeepsInnerBlanks)
{
    EXPECT_EQ(trimmed(" a  b "), "a  b");
}

TEST(TrimString, RemovesOneBlankFromATextOfBlanks)
{
    EXPECT_EQ(trimmed("   "), "  ");
    EXPECT_EQ(trimmed(" "), "");
}

TEST(TrimString, KeepsAnEmptyText)
{
    EXPECT_EQ(trimmed(""), "");
}

TEST(TrimString, StripsNeitherTabsNorNewlines)
{
    EXPECT_EQ(trimmed(" \tx\n "), "\tx\n");
    EXPECT_EQ(trimmed("\n"), "\n");
}

} // namespace trim_string_test
