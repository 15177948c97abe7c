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

} // namespace range_test
