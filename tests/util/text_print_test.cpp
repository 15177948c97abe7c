#include "util/textTools.h"

#include <gtest/gtest.h>
#include <string>

namespace text_print_test
{

TEST(PrintIntoABuffer, FillsItToTheLastByteButOne)
{
    char buffer[6];
    EXPECT_TRUE(NQ::text::print(buffer, sizeof buffer, "%s-%d", "abc", 7));
    EXPECT_EQ(std::string(buffer), "abc-7");
}

TEST(PrintIntoABuffer, RefusesATextOneByteTooLong)
{
    char buffer[6];
    EXPECT_FALSE(NQ::text::print(buffer, sizeof buffer, "%s-%d", "abcd", 7));
    EXPECT_EQ(std::string(buffer), "abcd-");
}

TEST(PrintIntoABuffer, AcceptsAnEmptyText)
{
    char buffer[] = "abc";
    EXPECT_TRUE(NQ::text::print(buffer, sizeof buffer, "%s", ""));
    EXPECT_STREQ(buffer, "");
}

} // namespace text_print_test
