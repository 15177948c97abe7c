#include "tests/support/FakeCommands.h"
#include "tests/support/Frame.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <string>
#include <typeinfo>
#include <vector>

namespace driver_nodes_test
{

using Ids = std::vector<unsigned int>;

class DriverNodes : public testing::Test
{
protected:
    void haveThreeModules()
    {
        commands.answers = {{"lsmod", "Module Size Used by\nxfs 1 0\next4 2 0\nloop 3 0\n"},
                            {"modinfo xfs", "description: SGI XFS\nversion: 1.2\n"},
                            {"modinfo ext4", "description: Fourth Extended Filesystem\n"},
                            {"modinfo loop", "version: 9\n"}};
    }

    std::vector<IC::MutableNode*> drivers() const
    {
        return frame.ofType(44);
    }

    FakeCommands commands;
    Frame frame;
};

TEST_F(DriverNodes, AreBelowTheOperatingSystemInTheOrderOfLsmod)
{
    haveThreeModules();
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
    }
    EXPECT_EQ(frame.nextNodeId_, 33U);
    EXPECT_EQ(*frame.nodeIds_, (Ids{30, 31, 32}));
    EXPECT_EQ(frame.currentNode_, drivers().back());
}

TEST_F(DriverNodes, AreDescribedByTheModulesDescription)
{
    haveThreeModules();
    frame.createDriverNodes();
    ASSERT_EQ(drivers().size(), 3U);
    EXPECT_EQ(drivers()[0]->getDescription(), "SGI XFS");
    EXPECT_EQ(drivers()[1]->getDescription(), "Fourth Extended Filesystem");
    EXPECT_EQ(drivers()[2]->getDescription(), "Driver");
}

TEST_F(DriverNodes, HoldFourTexts)
{
    haveThreeModules();
    frame.createDriverNodes();
    ASSERT_EQ(drivers().size(), 3U);
    IC::MutableNode const& xfs = *drivers()[0];
    EXPECT_EQ(xfs.getProperties().size(), 4U);
    EXPECT_EQ(storedValue(xfs, 134), "text 1.2 true");
    EXPECT_EQ(storedValue(xfs, 108), "text xfs true");
    EXPECT_EQ(storedValue(xfs, 70), "text  true");
    EXPECT_EQ(storedValue(xfs, 36), "text  true");
    EXPECT_EQ(storedValue(*drivers()[1], 134), "text  true");
}

TEST_F(DriverNodes, AreSetUpInTheOrderThatHostsSee)
{
    commands.answers = {{"lsmod", "loop 1 0\n"}, {"modinfo loop", "description: Disk\n"}};
    NodeCalls const calls;
    frame.createDriverNodes();
    EXPECT_EQ(calls.calls, (Lines{"setStatus(1)", "setDescription(Disk)", "setProperty(134)",
                                  "setProperty(108)", "setProperty(70)", "setProperty(36)"}));
}

TEST_F(DriverNodes, KeepTheInterfaceIdsTheyWereMadeWith)
{
    haveThreeModules();
    frame.miIds_ = {7, 9};
    frame.createDriverNodes();
    frame.miIds_.push_back(11);
    for (IC::MutableNode const* node : drivers())
        EXPECT_EQ(node->getMIIds(), (Ids{7, 9}));
}

TEST_F(DriverNodes, AreNotPublished)
{
    haveThreeModules();
    frame.createDriverNodes();
    EXPECT_TRUE(frame.published.empty());
}

TEST_F(DriverNodes, AreNoneWithoutModules)
{
    commands.answers = {{"lsmod", "Module Size Used by\n"}};
    frame.createDriverNodes();
    EXPECT_TRUE(drivers().empty());
    EXPECT_TRUE(frame.nodeIds_->empty());
}

TEST_F(DriverNodes, AreNotBuiltWhenLsmodCannotBeStarted)
{
    Recording const recording;
    frame.createDriverNodes();
    EXPECT_TRUE(drivers().empty());
    EXPECT_EQ(recording.texts(), (Lines{"createDriverNodes: entry", "getDriverInfo: entry",
                                        "Cannot open process: lsmod", "getDriverInfo: exit",
                                        "createDriverNodes: exit"}));
    LogRecord const first = recording.records().front();
    EXPECT_EQ(first.category, "Veltrix.IC.MI.OsSwMI");
    EXPECT_EQ(first.file, "OsSwMI");
    EXPECT_EQ(first.level, 3000);
}

} // namespace driver_nodes_test
