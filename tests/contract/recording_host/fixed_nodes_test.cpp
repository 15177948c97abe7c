// The three nodes at the top of the tree, and what is common to all nodes.

#include "host/Properties.h"
#include "tests/contract/recording_host/Loaded.h"

#include <algorithm>
#include <set>
#include <sys/utsname.h>
#include <typeinfo>

namespace
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

    void TearDown() override
    {
        libc::hooks().uname = nullptr;
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
        Ids const& list = *Insides::nodeIds(mi());
        return {list.begin(), list.begin() + count};
    }
};

TEST_F(FixedNodes, TheInterfacesNodeIsMadeOfTheInterfacesOwnId)
{
    plugin.initialize(5);
    EXPECT_EQ(eventsOf("createOsSwNodes"), (Lines{"MutableNode(5, 0, [5], 39, 0)", "setStatus(1)",
                                                  "setDescription(OsSw Management Interface)"}));
}

TEST_F(FixedNodes, TheRootIsMadeOfTheFirstCountedId)
{
    plugin.initialize(5);
    EXPECT_EQ(eventsOf("createRootNode"), (Lines{"MutableNode(6, 5, [5], 59, 0)", "setStatus(1)",
                                                 "setDescription(ROOT Node)"}));
}

TEST_F(FixedNodes, TheComputerIsMadeBelowTheRootAndNamed)
{
    plugin.initialize(5);
    EXPECT_EQ(eventsOf("createComputerNodes"),
              (Lines{"MutableNode(7, 6, [5], 40, 0)", "setStatus(1)", "setDescription(Computer)",
                     "log: getComputerName: entry", "log: getComputerName: exit",
                     "setProperty(108, text harbour true)"}));
}

TEST_F(FixedNodes, TheComputerStaysWithoutANameWhereUnameFails)
{
    libc::hooks().uname = [](utsname*) { return -1; };
    plugin.initialize(5);
    EXPECT_EQ(eventsOf("createComputerNodes"),
              (Lines{"MutableNode(7, 6, [5], 40, 0)", "setStatus(1)", "setDescription(Computer)",
                     "log: getComputerName: entry", "log: getComputerName: exit"}));
    IC::MutableNode const& computer = plugin.node(IC::nodeType::computer);
    EXPECT_EQ(computer.getStatus(), 1U);
    EXPECT_EQ(computer.getDescription(), "Computer");
    EXPECT_FALSE(property(computer, IC::property::name));
}

TEST_F(FixedNodes, TheComputersNameIsReadOnceOnly)
{
    plugin.initialize();
    libc::hooks().uname = [](utsname* system) {
        std::string("renamed").copy(system->nodename, sizeof system->nodename - 1);
        return 0;
    };
    EXPECT_EQ(text(plugin.node(IC::nodeType::computer), IC::property::name), "harbour");
}

TEST_F(FixedNodes, NeitherTheInterfacesNodeNorTheRootHasProperties)
{
    plugin.initialize();
    EXPECT_TRUE(plugin.node(IC::nodeType::osSw).getProperties().empty());
    EXPECT_TRUE(plugin.node(IC::nodeType::root).getProperties().empty());
}

TEST_F(FixedNodes, ThreeArePlainNodesAndTheFourthIsOfAClassOfItsOwn)
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

TEST_F(FixedNodes, TheIdListHoldsTheInterfacesOwnIdTwice)
{
    plugin.initialize(5);
    EXPECT_EQ(firstIds(4), (Ids{5, 6, 5, 7}));
}

TEST_F(FixedNodes, TheIdListGoesOnWithTheOperatingSystemAndAllThatFollows)
{
    commands.answers = {{"lsmod", "exnet 24576 0\nexfs 114688 2\n"},
                        {"modinfo exnet", ""},
                        {"modinfo exfs", ""},
                        {"wc -l /var/log/messages", "3 /var/log/messages\n"}};
    plugin.initialize(5);
    Ids expected = {5, 6, 5, 7};
    for (IC::MutableNode const* node : plugin.nodes())
        if (node->getNodeId() > 7)
            expected.push_back(node->getNodeId());
    EXPECT_EQ(*Insides::nodeIds(mi()), expected);
}

TEST_F(FixedNodes, IdsAreCountedInTheOrderInWhichTheKindsAreBuilt)
{
    commands.answers = {{"lsmod", "exnet 24576 0\n"},
                        {"modinfo exnet", ""},
                        {"wc -l /var/log/messages", "2 /var/log/messages\n"}};
    plugin.initialize(5);
    Ids types;
    unsigned int next = 6;
    for (IC::MutableNode const* node : plugin.nodes()) {
        if (types.empty() || types.back() != node->getNodeType())
            types.push_back(node->getNodeType());
        if (node->getNodeType() != IC::nodeType::osSw) {
            EXPECT_EQ(node->getNodeId(), next++);
        }
    }
    EXPECT_EQ(types, (Ids{39, 59, 40, 17, 44, 46, 51, 35, 47}));
    EXPECT_EQ(Insides::nextNodeId(mi()), next);
}

TEST_F(FixedNodes, TheInterfacesNodeLeavesTheCounterAlone)
{
    unsigned int counter = 0;
    host.onSetStatus = [this, &counter](IC::MutableNode& node) {
        if (node.getNodeType() == IC::nodeType::osSw)
            counter = Insides::nextNodeId(mi());
    };
    plugin.initialize(5);
    EXPECT_EQ(counter, 6U);
}

TEST_F(FixedNodes, StandInTheMembersOfTheirKindAndInTheListFromTheStart)
{
    plugin.initialize();
    IC::OsSwMI& interface = mi();
    auto const nodes = plugin.nodes();
    ASSERT_GE(nodes.size(), 4U);
    EXPECT_EQ(Insides::osSwNode(interface), nodes[0]);
    EXPECT_EQ(Insides::rootNode(interface), nodes[1]);
    EXPECT_EQ(Insides::computerNode(interface), nodes[2]);
    EXPECT_EQ(Insides::osNode(interface), nodes[3]);
}

TEST_F(FixedNodes, LikeAllNodesAreCurrentAndListedBeforeTheirStatusIsSet)
{
    commands.answers = {{"lsmod", "exnet 24576 0\n"},
                        {"modinfo exnet", ""},
                        {"wc -l /var/log/messages", "2 /var/log/messages\n"}};
    std::set<unsigned int> types;
    host.onSetStatus = [this, &types](IC::MutableNode& node) {
        types.insert(node.getNodeType());
        EXPECT_EQ(Insides::currentNode(mi()), &node);
        EXPECT_EQ(Insides::nodes(mi()).back(), &node);
        switch (node.getNodeType()) {
        case IC::nodeType::user:
            EXPECT_EQ(Insides::userNodes(mi()).back(), &node);
            break;
        case IC::nodeType::group:
            EXPECT_EQ(Insides::groupNodes(mi()).back(), &node);
            break;
        case IC::nodeType::logEntry:
            EXPECT_EQ(Insides::logEntryNodes(mi()).back(), &node);
            break;
        default:
            break;
        }
    };
    plugin.initialize();
    EXPECT_EQ(types, (std::set<unsigned int>{17, 35, 39, 40, 44, 46, 47, 51, 59}));
}

TEST_F(FixedNodes, AreParentsByTheIdThatTheyAnswerWith)
{
    plugin.initialize(5);
    EXPECT_EQ(plugin.node(IC::nodeType::osSw).getLinkedId(), 0U);
    EXPECT_EQ(plugin.node(IC::nodeType::root).getLinkedId(), 5U);
    EXPECT_EQ(plugin.node(IC::nodeType::computer).getLinkedId(), 6U);
    EXPECT_EQ(plugin.node(IC::nodeType::operatingSystem).getLinkedId(), 7U);
}

TEST_F(FixedNodes, CarryTheInterfaceIdsOfTheMomentAtWhichTheyWereMade)
{
    host.miIds = {5, 9};
    commands.answers = {{"lsmod", "exnet 24576 0\n"},
                        {"modinfo exnet", ""},
                        {"wc -l /var/log/messages", "2 /var/log/messages\n"}};
    plugin.initialize(5);
    ASSERT_EQ(plugin.nodes(IC::nodeType::logEntry).size(), 2U);
    Insides::miIds(mi()).push_back(10);
    for (IC::MutableNode const* node : plugin.nodes())
        EXPECT_EQ(node->getMIIds(), (Ids{5, 9})) << node->getDescription();
}

TEST_F(FixedNodes, ALaterInterfaceIdShowsInTheNodesMadeAfterIt)
{
    host.onSetStatus = [this](IC::MutableNode& node) {
        if (node.getNodeType() == IC::nodeType::root)
            Insides::miIds(mi()).push_back(9);
    };
    plugin.initialize(5);
    EXPECT_EQ(plugin.node(IC::nodeType::root).getMIIds(), Ids{5});
    EXPECT_EQ(plugin.node(IC::nodeType::computer).getMIIds(), (Ids{5, 9}));
}

TEST_F(FixedNodes, StandInTheMemberOfTheirKindBeforeTheirStatusIsSet)
{
    Ids seen;
    host.onSetStatus = [this, &seen](IC::MutableNode& node) {
        for (IC::MutableNode* member :
             {Insides::osSwNode(mi()), Insides::rootNode(mi()), Insides::computerNode(mi()),
              Insides::osNode(mi()), Insides::logNode(mi())})
            if (member == &node)
                seen.push_back(node.getNodeType());
    };
    plugin.initialize(5);
    EXPECT_EQ(seen, (Ids{39, 59, 40, 17, 35}));
}

TEST_F(FixedNodes, NoteTheInterfacesOwnIdOnceTheyAreMade)
{
    Ids noted;
    host.onNode = [this, &noted] {
        noted.push_back(static_cast<unsigned int>(Insides::nodeIds(mi())->size()));
    };
    plugin.initialize(5);
    ASSERT_GE(noted.size(), 3U);
    EXPECT_EQ(Ids(noted.begin(), noted.begin() + 3), (Ids{0, 2, 4}));
}

TEST_F(FixedNodes, TakeTheCountersValueOfTheMoment)
{
    host.onSetStatus = [this](IC::MutableNode& node) {
        if (node.getNodeType() == IC::nodeType::osSw)
            Insides::nextNodeId(mi()) = 40;
    };
    plugin.initialize(5);
    EXPECT_EQ(plugin.node(IC::nodeType::root).getNodeId(), 40U);
    EXPECT_EQ(plugin.node(IC::nodeType::root).getLinkedId(), 5U);
    EXPECT_EQ(plugin.node(IC::nodeType::computer).getNodeId(), 41U);
    EXPECT_EQ(plugin.node(IC::nodeType::computer).getLinkedId(), 40U);
    EXPECT_EQ(firstIds(4), (Ids{5, 40, 5, 41}));
}

TEST_F(FixedNodes, TheOperatingSystemIsSetUpBeforeItsPropertiesAreSet)
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

/** A node that answers with another id than it was made with. */
class Renumbered : public IC::MutableNode
{
public:
    Renumbered() : MutableNode(1, 0, {1}, 0, 0) {}
    unsigned int getNodeId() const override
    {
        return 77;
    }
};

TEST_F(FixedNodes, LikeAllParentsAreAskedForTheirIds)
{
    commands.answers = {{"lsmod", "exnet 24576 0\n"},
                        {"modinfo exnet", ""},
                        {"wc -l /var/log/messages", "1 /var/log/messages\n"}};
    plugin.initialize(5);
    Renumbered parent;
    auto const parentOf = [this, &parent](IC::MutableNode*& member, std::string const& builder) {
        member = &parent;
        std::string const symbol = "_ZN2IC6OsSwMI" + builder;
        void* const code = plugin.symbol(symbol.c_str());
        if (builder.back() == 'b')
            reinterpret_cast<void (*)(IC::OsSwMI*, bool)>(code)(&mi(), false);
        else
            reinterpret_cast<void (*)(IC::OsSwMI*)>(code)(&mi());
        return plugin.nodes().back()->getLinkedId();
    };
    IC::OsSwMI& all = mi();
    EXPECT_EQ(parentOf(Insides::rootNode(all), "19createComputerNodesEv"), 77U);
    EXPECT_EQ(parentOf(Insides::computerNode(all), "13createOsNodesEv"), 77U);
    for (char const* builder : {"17createDriverNodesEv", "15createUserNodesEb",
                                "16createGroupNodesEb", "14createLogNodesEv"})
        EXPECT_EQ(parentOf(Insides::osNode(all), builder), 77U) << builder;
    EXPECT_EQ(parentOf(Insides::logNode(all), "19createLogEntryNodesEb"), 77U);
}

} // namespace
