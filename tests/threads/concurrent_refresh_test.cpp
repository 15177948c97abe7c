// Users and groups refreshed from several threads while others read. Most useful when built with
// the thread sanitizer.

#include "TestPaths.h"
#include "host/Properties.h"
#include "tests/support/ErrorCount.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/FileRoot.h"
#include "tests/support/LiveNodes.h"
#include "tests/support/Plugin.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <atomic>
#include <set>
#include <thread>
#include <vector>

namespace concurrent_refresh_test
{

constexpr unsigned int userCount = 4; // on the fixture machine
constexpr unsigned int groupCount = 4;
constexpr unsigned int refreshesEach = 25;

/** A plug-in on a machine with users and groups; its commands cannot be started. */
class ConcurrentRefresh : public testing::Test
{
protected:
    ConcurrentRefresh()
    {
        // Without a zone, libc looks it up each time, under a lock that the sanitizer cannot see.
        useZone("UTC0");
        plugin.initialize();
    }

    FileRoot const root{MACHINES_DIR "/users-and-groups"};
    FakeCommands const commands;
    Plugin plugin;
};

TEST_F(ConcurrentRefresh, LeavesOneCompleteSetOfNodes)
{
    IC::MutableNode& os = plugin.node(IC::nodeType::operatingSystem);
    unsigned int const lastId = plugin.nodes().back()->getNodeId();
    ErrorCount const log;
    LiveNodes live(plugin.nodes());
    std::atomic<unsigned int> refreshing{2};
    std::atomic<unsigned int> wrong{0};
    std::atomic<unsigned int> reads{0};

    auto const refresh = [&] {
        IC::PropertyValue const now(IC::Number(0U), true);
        for (unsigned int i = 0; i < refreshesEach; ++i)
            wrong += os.setProperty(IC::property::refresh, now).getStatus();
        --refreshing;
    };
    auto const readCount = [&](unsigned int type, char const* expected) {
        live.use(type, [&](IC::MutableNode const& node) {
            wrong += text(node, IC::property::elementCount) == expected ? 0 : 1;
            wrong += text(node, IC::property::name).empty() ? 1 : 0;
            ++reads;
        });
    };
    auto const read = [&] {
        while (refreshing > 0 || reads < 100) {
            readCount(IC::nodeType::user, "4");
            readCount(IC::nodeType::group, "4");
        }
    };
    std::vector<std::thread> threads;
    for (int i = 0; i < 2; ++i) {
        threads.emplace_back(refresh);
        threads.emplace_back(read);
    }
    for (std::thread& thread : threads)
        thread.join();

    EXPECT_EQ(wrong, 0U);
    EXPECT_EQ(log.errors, 0U);
    EXPECT_GE(reads, 100U);
    std::set<unsigned int> ids;
    for (unsigned int const type : {IC::nodeType::user, IC::nodeType::group}) {
        std::vector<IC::MutableNode*> const nodes = plugin.nodes(type);
        EXPECT_EQ(nodes.size(), type == IC::nodeType::user ? userCount : groupCount);
        std::vector<IC::MutableNode const*> alive = live.ofType(type);
        EXPECT_TRUE(std::is_permutation(nodes.begin(), nodes.end(), alive.begin(), alive.end()));
        unsigned int index = 0;
        for (IC::MutableNode const* node : nodes) {
            EXPECT_EQ(node->getIndex(), ++index);
            EXPECT_TRUE(ids.insert(node->getNodeId()).second);
        }
    }
    // Every refresh took an id for each node, and the last set of each kind has the last ones.
    EXPECT_EQ(*ids.rbegin(), lastId + 2 * refreshesEach * (userCount + groupCount));
}

} // namespace concurrent_refresh_test
