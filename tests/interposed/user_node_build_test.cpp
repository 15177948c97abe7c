#include "tests/interposed/StandIns.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/Frame.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <set>

namespace
{

TEST(UserNodeBuild, GivesItsTimesNoSubSeconds)
{
    useZone("UTC0");
    FakeFiles const files;
    files.write("/etc/passwd", "anna:x:1000:100::/home/anna:/bin/sh\n");
    files.write("/etc/shadow", "anna:x:14000:1:90:14:30:15000:\n");
    Frame frame;
    standIns() = {};
    frame.createUserNodes(false);
    std::set<long> seconds;
    for (auto const& [second, beside] : standIns().dates) {
        EXPECT_EQ(beside, 0);
        seconds.insert(second);
    }
    EXPECT_EQ(seconds, (std::set<long>{1209600000, 1296000000}));
}

} // namespace
