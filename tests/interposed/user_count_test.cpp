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
    if (passwd)
        files.write("/etc/passwd", passwd);
    libc::hooks().lckpwdf = [] {
        standIns().calls.emplace_back("lock");
        return 0;
    };
    libc::hooks().setpwent = [] { standIns().calls.emplace_back("setpwent"); };
    libc::hooks().fopen = [below = libc::hooks().fopen.answer()](char const* path,
                                                                 char const* mode) {
        standIns().calls.emplace_back(path);
        return below(path, mode);
    };
    standIns() = {};
    unsigned int count = 0;
    EXPECT_TRUE(realGetUserCount(count));
    libc::hooks().setpwent = nullptr;
    return standIns().calls;
}

TEST(UserCount, GetsTheRangesBeforeOpeningTheAccountFile)
{
    callsFor(nullptr); // makes the instance read its file
    EXPECT_EQ(callsFor(nullptr), (Calls{"lock", "setpwent", "Instance", "/etc/passwd"}));
}

TEST(UserCount, ReadsBothBoundsForEveryAccount)
{
    callsFor(nullptr);
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
