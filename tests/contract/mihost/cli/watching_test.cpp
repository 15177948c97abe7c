// What a watch does when the plug-in builds the watched node again.

#include "TestPaths.h"
#include "tests/support/Lines.h"
#include "tests/support/Program.h"

#include <cstdlib>
#include <gtest/gtest.h>

namespace watching_test
{

constexpr std::size_t stampLength = sizeof "YYYY-MM-DD HH:MM:SS" - 1;

Outcome watchCrew()
{
    return mihostRun({"--plugin", PLUGIN_THAT_IS_ODD, "watch", "group:crew", "group-id", "--count",
                      "3", "--interval", "0"});
}

TEST(Watching, ContinuesWithARebuiltNode)
{
    setenv("ODD", "rebuild", 1);
    Outcome const outcome = watchCrew();
    EXPECT_EQ(outcome.code, 0);
    EXPECT_EQ(outcome.err, "");
    auto const lines = linesOf(outcome.out);
    ASSERT_EQ(lines.size(), 3U) << outcome.out;
    for (std::size_t at = 0; at < lines.size(); ++at)
        EXPECT_EQ(lines[at].substr(stampLength),
                  "   89 group-id  " + std::to_string(at + 2)); // the first was for the address
}

TEST(Watching, WaitsForANodeThatIsGone)
{
    setenv("ODD", "vanish", 1);
    Outcome const outcome = watchCrew();
    EXPECT_EQ(outcome.code, 0);
    EXPECT_EQ(outcome.err, "mihost: watch: node 'group:crew' is gone (waiting for it)\n"
                           "mihost: watch: node 'group:crew' is gone (waiting for it)\n");
    auto const lines = linesOf(outcome.out);
    ASSERT_EQ(lines.size(), 1U) << outcome.out;
    EXPECT_EQ(lines[0].substr(stampLength), "   89 group-id  3");
}

} // namespace watching_test
