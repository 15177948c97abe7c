#include "sysdata/logInfo_parse.h"

#include <gtest/gtest.h>

#include <climits>
#include <string>
#include <tuple>

namespace log_lines_test
{

using namespace NQ::logLines;

TEST(LogCount, IsTheNumberThatTheOutputBeginsWith)
{
    unsigned int count = 0;
    EXPECT_TRUE(findCount("120 /var/log/messages\n", count));
    EXPECT_EQ(count, 120U);
    EXPECT_TRUE(findCount("0", count));
    EXPECT_EQ(count, 0U);
    EXPECT_TRUE(findCount("      7 /var/log/messages\n", count));
    EXPECT_EQ(count, 7U);
    for (char const* output : {"", "\n", "wc: /var/log/messages: No such file or directory\n"})
        EXPECT_FALSE(findCount(output, count)) << output;
    EXPECT_EQ(count, 7U);
}

TEST(LogStamp, IsTakenApart)
{
    Stamp stamp;
    ASSERT_TRUE(findStamp("Nov 21 03:04:05", stamp));
    EXPECT_STREQ(stamp.month, "Nov");
    EXPECT_EQ(std::tie(stamp.day, stamp.hour, stamp.minute, stamp.second), std::tuple(21, 3, 4, 5));
    ASSERT_TRUE(findStamp("Jan  2 23:59:58", stamp));
    EXPECT_STREQ(stamp.month, "Jan");
    EXPECT_EQ(std::tie(stamp.day, stamp.hour, stamp.minute, stamp.second),
              std::tuple(2, 23, 59, 58));
}

TEST(LogStamp, IsNotFoundWithoutAllFiveOfItsPieces)
{
    Stamp stamp;
    for (char const* text : {"", "Jan", "Jan  2", "Jan  2 03:04",
                             "Jan  2 03:04:", "2026-01-02T03:0", "no stamp at all"})
        EXPECT_FALSE(findStamp(text, stamp)) << text;
}

TEST(LogStamp, NeverOverflowsItsMonth)
{
    Stamp stamp;
    EXPECT_FALSE(findStamp(std::string(5000, 'M').c_str(), stamp));
    EXPECT_EQ(std::string(stamp.month), std::string(15, 'M'));
}

TEST(LogToday, IsTheSecondWordAndTheLastNumber)
{
    struct {
        std::string output;
        std::string month;
        int year;
    } const cases[] = {{"Sat Nov 21 03:15:30 UTC 2026\n", "Nov", 2026},
                       {"Fri Jan  2 03:15:30 AM CET 2026\n", "Jan", 2026},
                       {"Sat Nov 21 03:15:30 UTC 12026\n", "Nov", 12026},
                       {" Jan Feb 2026\n", "Jan", 2026}, // the word after the first space
                       {"Sat " + std::string(5000, 'M') + " 2026", std::string(511, 'M'), 2026}};
    for (auto const& [output, month, year] : cases) {
        Today today;
        ASSERT_TRUE(findToday(output.c_str(), today)) << output;
        EXPECT_EQ(today.month, month);
        EXPECT_EQ(today.year, year);
    }
}

TEST(LogToday, IsNotFoundWithoutSpacesOrAYearAtTheEnd)
{
    Today today;
    for (char const* output :
         {"", "\n", "2026\n", "Sat Nov 21 03:15:30 UTC\n", "Sat Nov 21 2026 \n"})
        EXPECT_FALSE(findToday(output, today)) << output;
}

TEST(LogYear, IsTheOneBeforeForDecemberReadInJanuaryOnly)
{
    struct {
        std::string stamp;
        std::string month;
        int year;
        int found;
    } const cases[] = {{"Nov", "Nov", 2026, 2026},
                       {"Jan", "Jan", 2026, 2026},
                       {"Dec", "Dec", 2026, 2026},
                       {"Dec", "Jan", 2026, 2025},
                       {"Jan", "Dec", 2026, 2026},
                       {"Nov", "Jan", 2026, 2026},
                       {"Dec", "Feb", 2026, 2026},
                       {"dec", "Jan", 2026, 2026},
                       {"December", "Jan", 2026, 2026},
                       {"Dec", "January", 2026, 2026},
                       {"Dec", "Jan", 0, 0},
                       {"Dec", "Jan", INT_MIN, INT_MIN},
                       {"Dec", "Jan", 1, 0}};
    for (auto const& [stampMonth, month, year, found] : cases) {
        Stamp stamp;
        stampMonth.copy(stamp.month, sizeof stamp.month - 1);
        Today today;
        month.copy(today.month, sizeof today.month - 1);
        today.year = year;
        EXPECT_EQ(yearOf(stamp, today), found) << stampMonth << " read in " << month << year;
    }
}

} // namespace log_lines_test
