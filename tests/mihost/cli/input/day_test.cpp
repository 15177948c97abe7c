#include "mihost/cli/input/Day.h"

#include <gtest/gtest.h>

namespace day_test
{

using mihost::Day;
using mihost::dayNumber;
using mihost::dayOfNumber;
using mihost::dayText;

TEST(DayNumber, CountsFrom1970)
{
    EXPECT_EQ(dayNumber({1970, 1, 1}), 0);
    EXPECT_EQ(dayNumber({1969, 12, 31}), -1);
    EXPECT_EQ(dayNumber({2000, 2, 29}), 11016);
    EXPECT_EQ(dayNumber({2030, 1, 5}), 21919);
    EXPECT_EQ(dayNumber({2038, 1, 19}), 24855);
}

TEST(DayNumber, BecomesTheSameDayAgain)
{
    for (long number = dayNumber({1901, 1, 1}); number <= dayNumber({2110, 12, 31}); ++number) {
        auto const day = dayOfNumber(number);
        ASSERT_TRUE(day) << number;
        ASSERT_EQ(dayNumber(*day), number) << dayText(*day);
        ASSERT_TRUE(mihost::parseDay(dayText(*day))) << dayText(*day);
    }
}

TEST(DayNumber, HasNoDayOutsideTheYearsThatCanBeWritten)
{
    EXPECT_EQ(dayText(*dayOfNumber(dayNumber({9999, 12, 31}))), "9999-12-31");
    EXPECT_FALSE(dayOfNumber(dayNumber({9999, 12, 31}) + 1));
    EXPECT_FALSE(dayOfNumber(dayNumber({1901, 1, 1}) - 1));
}

} // namespace day_test
