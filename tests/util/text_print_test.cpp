#include "util/textTools.h"

#include <gtest/gtest.h>

namespace text_print_test
{

TEST(PrintIntoABuffer, FillsItToTheLastByteButOneAndRefusesMore)
{
    char buffer[6];
    EXPECT_TRUE(NQ::text::print(buffer, sizeof buffer, "%s-%d", "abc", 7));
    EXPECT_STREQ(buffer, "abc-7");
    EXPECT_FALSE(NQ::text::print(buffer, sizeof buffer, "%s-%d", "abcd", 7));
    EXPECT_STREQ(buffer, "abcd-");
    EXPECT_TRUE(NQ::text::print(buffer, sizeof buffer, "%s", ""));
    EXPECT_STREQ(buffer, "");
}

} // namespace text_print_test
