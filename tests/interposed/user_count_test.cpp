#include "tests/interpose/Libc.h"
#include "tests/interposed/StandIns.h"
#include "tests/support/FakeFiles.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace
{

using Calls = std::vector<std::string>;

/** The calls made for an account file, its opening included. */
Calls callsFor(char const* passwd)
{
    FakeFiles const files;
    files.write("/etc/passwd", passwd);
    libc::hooks().lckpwdf = [] {
        standIns().calls.emplace_back("lock");
        return 0;
    };
    libc::hooks().setpwent = [] { standIns().calls.emplace_back("setpwent"); };
    libc::hooks().fopen.watch(
        [](char const* path, char const*) { standIns().calls.emplace_back(path); });
    standIns() = {};
    unsigned int count = 0;
    EXPECT_TRUE(realGetUserCount(count));
    libc::hooks().fopen.watch(nullptr);
    return standIns().calls;
}

TEST(UserCount, GetsTheRangesFirstAndBothBoundsForEveryAccount)
{
    callsFor(""); // makes the instance read its file
    Calls const bounds{"Instance", "getMinUserId", "Instance", "getMaxUserId"};
    Calls expected{"lock", "setpwent", "Instance", "/etc/passwd"};
    for (int account = 0; account < 3; ++account)
        expected.insert(expected.end(), bounds.begin(), bounds.end());
    EXPECT_EQ(callsFor("root:x:0:0::/root:/bin/sh\n"
                       "daemon:x:2:2::/:/bin/sh\n"
                       "jdoe:x:1000:1000::/home/jdoe:/bin/sh\n"),
              expected);
}

} // namespace
