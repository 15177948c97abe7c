#include "mihost/cli/input/Range.h"

#include <gtest/gtest.h>

namespace range_test
{

TEST(Between, AcceptsTheNumbersFromTheLeastToTheMost)
{
    auto const check = mihost::between(0, 86400);
    for (char const* number : {"0", "0.5", "86400"})
        EXPECT_EQ(check(number), "") << number;
}

TEST(Between, RefusesOtherNumbersAndWhatIsNotANumber)
{
    auto const check = mihost::between(1, 86400);
    for (char const* text : {"0", "-1", "86401", "nan", "inf", "", " ", "x", "1x", "1 2"})
        EXPECT_EQ(check(text), "'" + std::string(text) + "' is not a number from 1 to 86400");
}

TEST(WholeBetween, AcceptsTheWholeNumbersFromTheLeastToTheMost)
{
    auto const check = mihost::wholeBetween(0, 1000);
    for (char const* number : {"0", "7", "1000"})
        EXPECT_EQ(check(number), "") << number;
}

TEST(WholeBetween, RefusesOtherNumbersAndOtherForms)
{
    auto const check = mihost::wholeBetween(1, 1000);
    for (char const* text : {"0", "1001", "-1", "+1", "1.5", "1e2", "010", "0x1f", "", " 1"})
        EXPECT_EQ(check(text), "'" + std::string(text) + "' is not a whole number from 1 to 1000");
}

} // namespace range_test
