#include "sysdata/logInfo_parse.h"

#include <gtest/gtest.h>

#include <climits>
#include <string>

namespace log_lines_test
{

using namespace NQ::logLines;

Today todayOf(int year, char const* month)
{
    Today today;
    today.year = year;
    std::string(month).copy(today.month, sizeof today.month - 1);
    return today;
}

Stamp stampOf(char const* month)
{
    Stamp stamp;
    std::string(month).copy(stamp.month, sizeof stamp.month - 1);
    return stamp;
}

TEST(LogCount, IsReadBeforeTheFileName)
{
    unsigned int count = 0;
    EXPECT_TRUE(findCount("120 /var/log/messages\n", count));
    EXPECT_EQ(count, 120U);
}

TEST(LogCount, MayBeAloneOrAfterBlanks)
{
    unsigned int count = 0;
    EXPECT_TRUE(findCount("0", count));
    EXPECT_EQ(count, 0U);
    EXPECT_TRUE(findCount("      7 /var/log/messages\n", count));
    EXPECT_EQ(count, 7U);
}

TEST(LogCount, IsNotFoundInAnythingElse)
{
    unsigned int count = 5;
    EXPECT_FALSE(findCount("", count));
    EXPECT_FALSE(findCount("\n", count));
    EXPECT_FALSE(findCount("wc: /var/log/messages: No such file or directory\n", count));
    EXPECT_EQ(count, 5U);
}

TEST(LogStamp, IsTakenApart)
{
    Stamp stamp;
    ASSERT_TRUE(findStamp("Nov 21 03:04:05", stamp));
    EXPECT_STREQ(stamp.month, "Nov");
    EXPECT_EQ(stamp.day, 21);
    EXPECT_EQ(stamp.hour, 3);
    EXPECT_EQ(stamp.minute, 4);
    EXPECT_EQ(stamp.second, 5);
}

TEST(LogStamp, MayHaveADayOfOneDigit)
{
    Stamp stamp;
    ASSERT_TRUE(findStamp("Jan  2 23:59:58", stamp));
    EXPECT_STREQ(stamp.month, "Jan");
    EXPECT_EQ(stamp.day, 2);
    EXPECT_EQ(stamp.hour, 23);
    EXPECT_EQ(stamp.minute, 59);
    EXPECT_EQ(stamp.second, 58);
}

TEST(LogStamp, IsNotFoundWithoutAllFiveOfItsPieces)
{
    Stamp stamp;
    EXPECT_FALSE(findStamp("", stamp));
    EXPECT_FALSE(findStamp("Jan", stamp));
    EXPECT_FALSE(findStamp("Jan  2", stamp));
    EXPECT_FALSE(findStamp("Jan  2 03:04", stamp));
    EXPECT_FALSE(findStamp("Jan  2 03:04:", stamp));
    EXPECT_FALSE(findStamp("2026-01-02T03:0", stamp));
    EXPECT_FALSE(findStamp("no stamp at all", stamp));
}

TEST(LogStamp, NeverOverflowsItsMonth)
{
    Stamp stamp;
    EXPECT_FALSE(findStamp(std::string(5000, 'M').c_str(), stamp));
    EXPECT_EQ(std::string(stamp.month), std::string(15, 'M'));
}

TEST(LogToday, IsTheSecondWordAndTheLastNumber)
{
    Today today;
    ASSERT_TRUE(findToday("Sat Nov 21 03:15:30 UTC 2026\n", today));
    EXPECT_STREQ(today.month, "Nov");
    EXPECT_EQ(today.year, 2026);
}

TEST(LogToday, AcceptsADayOfOneDigitAndMoreWords)
{
    Today today;
    ASSERT_TRUE(findToday("Fri Jan  2 03:15:30 AM CET 2026\n", today));
    EXPECT_STREQ(today.month, "Jan");
    EXPECT_EQ(today.year, 2026);
}

TEST(LogToday, MayHaveAYearOfAnyLength)
{
    Today today;
    ASSERT_TRUE(findToday("Sat Nov 21 03:15:30 UTC 12026\n", today));
    EXPECT_EQ(today.year, 12026);
}

TEST(LogToday, IsNotFoundWithoutSpaces)
{
    Today today;
    EXPECT_FALSE(findToday("", today));
    EXPECT_FALSE(findToday("\n", today));
    EXPECT_FALSE(findToday("2026\n", today));
}

TEST(LogToday, IsNotFoundWithoutAYearAtTheEnd)
{
    Today today;
    EXPECT_FALSE(findToday("Sat Nov 21 03:15:30 UTC\n", today));
    EXPECT_FALSE(findToday("Sat Nov 21 2026 \n", today));
}

TEST(LogToday, NeverOverflowsItsMonth)
{
    Today today;
    EXPECT_TRUE(findToday(("Sat " + std::string(5000, 'M') + " 2026").c_str(), today));
    EXPECT_EQ(std::string(today.month), std::string(511, 'M'));
}

TEST(LogYear, IsTheCurrentOne)
{
    EXPECT_EQ(yearOf(stampOf("Nov"), todayOf(2026, "Nov")), 2026);
    EXPECT_EQ(yearOf(stampOf("Jan"), todayOf(2026, "Jan")), 2026);
    EXPECT_EQ(yearOf(stampOf("Dec"), todayOf(2026, "Dec")), 2026);
}

TEST(LogYear, IsTheOneBeforeForDecemberReadInJanuary)
{
    EXPECT_EQ(yearOf(stampOf("Dec"), todayOf(2026, "Jan")), 2025);
}

TEST(LogYear, IsNeverCorrectedForward)
{
    EXPECT_EQ(yearOf(stampOf("Jan"), todayOf(2026, "Dec")), 2026);
}

TEST(LogYear, IsNotCorrectedForOtherMonthsOrSpellings)
{
    EXPECT_EQ(yearOf(stampOf("Nov"), todayOf(2026, "Jan")), 2026);
    EXPECT_EQ(yearOf(stampOf("Dec"), todayOf(2026, "Feb")), 2026);
    EXPECT_EQ(yearOf(stampOf("dec"), todayOf(2026, "Jan")), 2026);
    EXPECT_EQ(yearOf(stampOf("December"), todayOf(2026, "Jan")), 2026);
    EXPECT_EQ(yearOf(stampOf("Dec"), todayOf(2026, "January")), 2026);
}

TEST(LogYear, IsKeptIfThereIsNoYearBefore)
{
    EXPECT_EQ(yearOf(stampOf("Dec"), todayOf(0, "Jan")), 0);
    EXPECT_EQ(yearOf(stampOf("Dec"), todayOf(INT_MIN, "Jan")), INT_MIN);
    EXPECT_EQ(yearOf(stampOf("Dec"), todayOf(1, "Jan")), 0);
}

} // namespace log_lines_test
