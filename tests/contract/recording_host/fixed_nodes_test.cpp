// The three nodes at the top of the tree, and what is common to all nodes.

#include "host/Properties.h"
#include "tests/contract/recording_host/Loaded.h"

#include <algorithm>
#include <map>
#include <set>
#include <sys/utsname.h>
#include <typeinfo>
#include <utility>

namespace fixed_nodes_test
{

class FixedNodes : public Loaded
{
protected:
    void SetUp() override
    {
        libc::hooks().uname = [](utsname* system) {
            *system = {};
            std::string("harbour").copy(system->nodename, sizeof system->nodename - 1);
            return 0;
        };
    }

    /** The events between a builder's entry and exit message. */
    Lines eventsOf(std::string const& builder) const
    {
        auto const& all = host.events;
        auto const begin = std::find(all.begin(), all.end(), "log: " + builder + ": entry");
        auto const end = std::find(begin, all.end(), "log: " + builder + ": exit");
        return begin == all.end() ? Lines{"not built"} : Lines(begin + 1, end);
    }

    /** The first ids in the node-id list. */
    Ids firstIds(std::ptrdiff_t count)
    {
        Ids const& list = *inside(&OpenInterface::nodeIds_);
        return {list.begin(), list.begin() + count};
    }
};

TEST_F(FixedNodes, AreMadeOneBelowTheOther)
{
    for (bool const unameFails : {false, true}) {
        if (unameFails)
            libc::hooks().uname = [](utsname*) { return -1; };
        host.events.clear();
        plugin.initialize(5);
        EXPECT_EQ(eventsOf("createOsSwNodes"),
                  (Lines{"MutableNode(5, 0, [5], 39, 0)", "setStatus(1)",
                         "setDescription(OsSw Management Interface)"}));
        EXPECT_EQ(eventsOf("createRootNode"), (Lines{"MutableNode(6, 5, [5], 59, 0)",
                                                     "setStatus(1)", "setDescription(ROOT Node)"}));
        Lines computer{"MutableNode(7, 6, [5], 40, 0)", "setStatus(1)", "setDescription(Computer)",
                       "log: getComputerName: entry", "log: getComputerName: exit"};
        if (!unameFails)
            computer.emplace_back("setProperty(108, text harbour true)");
        EXPECT_EQ(eventsOf("createComputerNodes"), computer);
        EXPECT_EQ(firstIds(4), (Ids{5, 6, 5, 7}));
        plugin.unload();
    }
}

TEST_F(FixedNodes, OnlyTheComputerHasAPropertyWhichIsReadOnce)
{
    plugin.initialize();
    EXPECT_TRUE(plugin.node(IC::nodeType::osSw).getProperties().empty());
    EXPECT_TRUE(plugin.node(IC::nodeType::root).getProperties().empty());
    libc::hooks().uname = [](utsname* system) {
        std::string("renamed").copy(system->nodename, sizeof system->nodename - 1);
        return 0;
    };
    EXPECT_EQ(text(plugin.node(IC::nodeType::computer), IC::property::name), "harbour");
}

TEST_F(FixedNodes, OnlyTheOperatingSystemHasItsOwnClass)
{
    plugin.initialize();
    for (unsigned int const type :
         {IC::nodeType::osSw, IC::nodeType::root, IC::nodeType::computer}) {
        IC::MutableNode const& node = plugin.node(type);
        EXPECT_EQ(typeid(node), typeid(IC::MutableNode));
    }
    IC::MutableNode const& os = plugin.node(IC::nodeType::operatingSystem);
    EXPECT_STREQ(typeid(os).name(), "N2IC6OsNodeE");
}

TEST_F(FixedNodes, IdsAreCountedAndListedInTheOrderOfBuilding)
{
    commands.answers = {{"lsmod", "exnet 24576 0\nexfs 114688 2\n"},
                        {"modinfo exnet", ""},
                        {"modinfo exfs", ""},
                        {"wc -l /var/log/messages", "2 /var/log/messages\n"}};
    plugin.initialize(5);
    Ids types;
    Ids listed = {5, 6, 5, 7};
    unsigned int next = 6;
    for (IC::MutableNode const* node : plugin.nodes()) {
        if (types.empty() || types.back() != node->getNodeType())
            types.push_back(node->getNodeType());
        if (node->getNodeType() != IC::nodeType::osSw) {
            EXPECT_EQ(node->getNodeId(), next++);
        }
        if (node->getNodeId() > 7)
            listed.push_back(node->getNodeId());
    }
    EXPECT_EQ(types, (Ids{39, 59, 40, 17, 44, 46, 51, 35, 47}));
    EXPECT_EQ(inside(&OpenInterface::nextNodeId_), next);
    EXPECT_EQ(*inside(&OpenInterface::nodeIds_), listed);
}

TEST_F(FixedNodes, AreListedAndInTheirMemberBeforeTheirStatusIsSet)
{
    commands.answers = {{"lsmod", "exnet 24576 0\n"},
                        {"modinfo exnet", ""},
                        {"wc -l /var/log/messages", "2 /var/log/messages\n"}};
    std::set<unsigned int> types;
    host.onSetStatus = [this, &types](IC::MutableNode& node) {
        types.insert(node.getNodeType());
        std::map<unsigned int, IC::Node*> members = {
            {IC::nodeType::osSw, inside(&OpenInterface::osSwNode_)},
            {IC::nodeType::root, inside(&OpenInterface::rootNode_)},
            {IC::nodeType::computer, inside(&OpenInterface::computerNode_)},
            {IC::nodeType::operatingSystem, inside(&OpenInterface::osNode_)},
            {IC::nodeType::driver, &node}, // in no member
            {IC::nodeType::log, inside(&OpenInterface::logNode_)}};
        auto const lastOf = [](auto const& nodes) {
            return nodes.empty() ? nullptr : nodes.back();
        };
        members[IC::nodeType::user] = lastOf(inside(&OpenInterface::userNodes_));
        members[IC::nodeType::group] = lastOf(inside(&OpenInterface::groupNodes_));
        members[IC::nodeType::logEntry] = lastOf(inside(&OpenInterface::logEntryNodes_));
        EXPECT_EQ(members.at(node.getNodeType()), &node) << node.getNodeType();
        EXPECT_EQ(inside(&OpenInterface::currentNode_), &node);
        EXPECT_EQ(inside(&OpenInterface::nodes_).back(), &node);
    };
    plugin.initialize();
    EXPECT_EQ(types, (std::set<unsigned int>{17, 35, 39, 40, 44, 46, 47, 51, 59}));
}

TEST_F(FixedNodes, KeepTheInterfaceIdsTheyWereMadeWith)
{
    host.miIds = {5, 9};
    commands.answers = {{"lsmod", "exnet 24576 0\n"},
                        {"modinfo exnet", ""},
                        {"wc -l /var/log/messages", "2 /var/log/messages\n"}};
    plugin.initialize(5);
    ASSERT_EQ(plugin.nodes(IC::nodeType::logEntry).size(), 2U);
    inside(&OpenInterface::miIds_).push_back(10);
    for (IC::MutableNode const* node : plugin.nodes())
        EXPECT_EQ(node->getMIIds(), (Ids{5, 9})) << node->getDescription();
}

TEST_F(FixedNodes, ALaterInterfaceIdShowsInTheNodesMadeAfterIt)
{
    host.onSetStatus = [this](IC::MutableNode& node) {
        if (node.getNodeType() == IC::nodeType::root)
            inside(&OpenInterface::miIds_).push_back(9);
    };
    plugin.initialize(5);
    EXPECT_EQ(plugin.node(IC::nodeType::root).getMIIds(), Ids{5});
    EXPECT_EQ(plugin.node(IC::nodeType::computer).getMIIds(), (Ids{5, 9}));
}

TEST_F(FixedNodes, TakeTheCountersValueAndNoteTheirIdAfterwards)
{
    Ids noted;
    host.onNode = [this, &noted] {
        noted.push_back(static_cast<unsigned int>(inside(&OpenInterface::nodeIds_)->size()));
    };
    unsigned int counter = 0;
    host.onSetStatus = [this, &counter](IC::MutableNode& node) {
        if (node.getNodeType() == IC::nodeType::osSw)
            counter = std::exchange(inside(&OpenInterface::nextNodeId_), 40);
    };
    plugin.initialize(5);
    EXPECT_EQ(counter, 6U); // which the interface's own node does not advance
    ASSERT_GE(noted.size(), 3U);
    EXPECT_EQ(Ids(noted.begin(), noted.begin() + 3), (Ids{0, 2, 4}));
    EXPECT_EQ(plugin.node(IC::nodeType::root).getNodeId(), 40U);
    EXPECT_EQ(plugin.node(IC::nodeType::root).getLinkedId(), 5U);
    EXPECT_EQ(plugin.node(IC::nodeType::computer).getNodeId(), 41U);
    EXPECT_EQ(plugin.node(IC::nodeType::computer).getLinkedId(), 40U);
    EXPECT_EQ(firstIds(4), (Ids{5, 40, 5, 41}));
}

TEST_F(FixedNodes, AreSetUpBeforeTheirPropertiesAreSet)
{
    plugin.initialize(5);
    Lines const events = eventsOf("createOsNodes");
    ASSERT_GE(events.size(), 13U);
    EXPECT_EQ(Lines(events.begin(), events.begin() + 13),
              (Lines{"MutableNode(8, 7, [5], 17, 0)", "log: OsNode::OsNode: entry", "setStatus(1)",
                     "setDescription(Operating System)", "log: OsNode::setProperty: entry",
                     "setProperty(128, enumeration 35 true)", "log: OsNode::setProperty: exit",
                     "log: OsNode::setProperty: entry", "setProperty(123, enumeration 1 false)",
                     "log: OsNode::setProperty: exit", "log: OsNode::setProperty: entry",
                     "setProperty(125, numbers 0,1,24 true)", "log: OsNode::setProperty: exit"}));
}

/** A node that reports an id other than the one it was made with. */
class Renumbered : public IC::MutableNode
{
public:
    Renumbered() : MutableNode(1, 0, {1}, 0, 0) {}
    unsigned int getNodeId() const override
    {
        return 77;
    }
};

TEST_F(FixedNodes, ParentsAreQueriedForTheirIds)
{
    commands.answers = {{"lsmod", "exnet 24576 0\n"},
                        {"modinfo exnet", ""},
                        {"wc -l /var/log/messages", "1 /var/log/messages\n"}};
    plugin.initialize(5);
    Renumbered parent;
    auto const parentOf = [this, &parent](IC::MutableNode*& member, std::string const& builder) {
        member = &parent;
        void* const code = plugin.symbol("IC::OsSwMI::" + builder);
        if (builder.find("bool") != std::string::npos)
            reinterpret_cast<void (*)(IC::OsSwMI*, bool)>(code)(&mi(), false);
        else
            reinterpret_cast<void (*)(IC::OsSwMI*)>(code)(&mi());
        return plugin.nodes().back()->getLinkedId();
    };
    EXPECT_EQ(parentOf(inside(&OpenInterface::rootNode_), "createComputerNodes()"), 77U);
    EXPECT_EQ(parentOf(inside(&OpenInterface::computerNode_), "createOsNodes()"), 77U);
    for (char const* builder : {"createDriverNodes()", "createUserNodes(bool)",
                                "createGroupNodes(bool)", "createLogNodes()"})
        EXPECT_EQ(parentOf(inside(&OpenInterface::osNode_), builder), 77U) << builder;
    EXPECT_EQ(parentOf(inside(&OpenInterface::logNode_), "createLogEntryNodes(bool)"), 77U);
}

} // namespace fixed_nodes_test
