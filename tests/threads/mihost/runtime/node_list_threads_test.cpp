// The reference runtime's node list changed in several threads.

#include "host/ManagementInterface.h"
#include "host/MutableNode.h"

#include <gtest/gtest.h>

#include <atomic>
#include <string>
#include <thread>
#include <vector>

namespace node_list_threads_test
{

using Nodes = std::vector<IC::Node*>;

/** A node that counts itself when it is deleted. */
class CountedNode : public IC::MutableNode
{
public:
    CountedNode(unsigned int id, std::atomic<unsigned int>& deleted)
        : MutableNode(id, 0, {1}, 46, 0), deleted_(deleted)
    {
    }

    ~CountedNode() override
    {
        ++deleted_;
    }

private:
    std::atomic<unsigned int>& deleted_;
};

TEST(NodeListThreads, RebuildNodesOfDifferentKindsAtOnce)
{
    constexpr unsigned int rounds = 20;
    constexpr unsigned int nodesEach = 50;
    IC::ManagementInterface managementInterface;
    managementInterface.initialize(1, IC::Number(0U), IC::Number(0U));
    std::atomic<unsigned int> deleted{0};
    auto const rebuild = [&](unsigned int first) {
        for (unsigned int round = 0; round < rounds; ++round) {
            Nodes nodes;
            for (unsigned int id = first; id < first + nodesEach; ++id) {
                nodes.push_back(new CountedNode(id, deleted));
                managementInterface.addNewNode(nodes.back());
            }
            Nodes seen;
            managementInterface.getMap(seen);
            IC::Node* found = nullptr;
            EXPECT_EQ(managementInterface.getNode(std::to_string(first), found).getStatus(), 0U);
            EXPECT_EQ(found, nodes.front());
            for (IC::Node* node : nodes)
                EXPECT_EQ(managementInterface.deleteNode(node).getStatus(), 0U);
        }
    };
    std::thread other(rebuild, 1000);
    rebuild(2000);
    other.join();
    EXPECT_EQ(deleted, 2 * rounds * nodesEach);
    Nodes left;
    managementInterface.getMap(left);
    EXPECT_TRUE(left.empty());
}

} // namespace node_list_threads_test
