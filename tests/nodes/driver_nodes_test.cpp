#include "tests/support/FakeCommands.h"
#include "tests/support/Frame.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <string>
#include <typeinfo>
#include <utility>
#include <vector>

namespace driver_nodes_test
{

using Ids = std::vector<unsigned int>;

class DriverNodes : public testing::Test
{
protected:
    std::vector<IC::MutableNode*> drivers() const
    {
        return frame.ofType(44);
    }

    FakeCommands commands;
    Frame frame;
};

TEST_F(DriverNodes, AreBelowTheOperatingSystemInTheOrderOfLsmod)
{
    commands.answers = {{"lsmod", "Module Size Used by\nxfs 1 0\next4 2 0\nloop 3 0\n"},
                        {"modinfo xfs", "description: SGI XFS\nversion: 1.2\n"},
                        {"modinfo ext4", "description: Fourth Extended Filesystem\n"},
                        {"modinfo loop", "version: 9\n"}};
    struct {
        std::string name;
        std::string version;
        char const* description;
    } const expected[] = {{"xfs", "1.2", "SGI XFS"},
                          {"ext4", "", "Fourth Extended Filesystem"},
                          {"loop", "9", "Driver"}};
    frame.nextNodeId_ = 30;
    frame.createDriverNodes();
    ASSERT_EQ(drivers().size(), 3U);
    for (unsigned int i = 0; i < 3; ++i) {
        IC::MutableNode const& node = *drivers()[i];
        EXPECT_EQ(node.getNodeId(), 30 + i);
        EXPECT_EQ(node.getIndex(), i + 1);
        EXPECT_EQ(node.getLinkedId(), frame.osNode_->getNodeId());
        EXPECT_EQ(node.getMIIds(), Ids{7});
        EXPECT_EQ(node.getStatus(), 1U);
        EXPECT_TRUE(typeid(node) == typeid(IC::MutableNode));
        EXPECT_EQ(node.getDescription(), expected[i].description);
        EXPECT_EQ(node.getProperties().size(), 4U);
        EXPECT_EQ(storedValue(node, 134), "text " + expected[i].version + " true");
        EXPECT_EQ(storedValue(node, 108), "text " + expected[i].name + " true");
        EXPECT_EQ(storedValue(node, 70), "text  true");
        EXPECT_EQ(storedValue(node, 36), "text  true");
    }
    EXPECT_EQ(frame.nextNodeId_, 33U);
    EXPECT_EQ(*frame.nodeIds_, (Ids{30, 31, 32}));
    EXPECT_EQ(frame.currentNode_, drivers().back());
    EXPECT_TRUE(frame.published.empty());
}

TEST_F(DriverNodes, AreSetUpInTheOrderThatHostsSee)
{
    commands.answers = {{"lsmod", "loop 1 0\n"}, {"modinfo loop", "description: Disk\n"}};
    NodeCalls const calls;
    frame.createDriverNodes();
    EXPECT_EQ(calls.calls, (Lines{"setStatus(1)", "setDescription(Disk)", "setProperty(134)",
                                  "setProperty(108)", "setProperty(70)", "setProperty(36)"}));
}

TEST_F(DriverNodes, ReadTheirParentsIdOnceEachAfterTakingTheirOwn)
{
    commands.answers = {{"lsmod", "xfs 1 0\nloop 1 0\n"}};
    commands.otherwise = "";
    CountingParent parent(frame);
    IC::MutableNode* const real = std::exchange(frame.osNode_, &parent);
    frame.createDriverNodes();
    frame.osNode_ = real;
    EXPECT_EQ(drivers().size(), 2U);
    EXPECT_TRUE(CountingParent::wasReadInOrder(drivers()));
}

TEST_F(DriverNodes, AreNotBuiltWhenLsmodCannotBeStarted)
{
    Recording const recording;
    frame.createDriverNodes();
    EXPECT_TRUE(drivers().empty());
    EXPECT_TRUE(frame.nodeIds_->empty());
    EXPECT_EQ(recording.texts(), (Lines{"createDriverNodes: entry", "getDriverInfo: entry",
                                        "Cannot open process: lsmod", "getDriverInfo: exit",
                                        "createDriverNodes: exit"}));
    LogRecord const first = recording.records().front();
    EXPECT_EQ(first.category, "Veltrix.IC.MI.OsSwMI");
    EXPECT_EQ(first.file, "OsSwMI");
    EXPECT_EQ(first.level, 3000);
}

} // namespace driver_nodes_test
