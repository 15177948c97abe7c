// Dates converted in several threads.

#include "util/MyProcess.h"

#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <atomic>
#include <string>
#include <thread>

namespace date_threads_test
{

TEST(DateThreads, ConvertTwoMonthsAtOnce)
{
    useZone("UTC0");
    std::atomic<int> wrong{0};
    auto const convert = [&wrong](std::string month, time_t expected) {
        for (int i = 0; i < 5000; ++i)
            if (NQ::to_time_t(2009, month.data(), 1, 0, 0, 0, 0, -1) != expected)
                ++wrong;
    };
    std::thread one(convert, "Jan", 1230768000);
    std::thread other(convert, "Dec", 1259625600);
    one.join();
    other.join();
    EXPECT_EQ(wrong, 0);
}

} // namespace date_threads_test
