// The reference runtime's management interface.

#include "host/ManagementInterface.h"
#include "host/MutableNode.h"

#include "mihost/runtime/Runtime.h"
#include "tests/support/Insides.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <random>
#include <string>
#include <utility>
#include <vector>

namespace interface_test
{

using IC::Error;
using IC::ManagementInterface;
using IC::MutableNode;
using IC::Node;
using IC::Number;

using Events = std::vector<std::string>;
using Nodes = std::vector<Node*>;

using Interface = OpenFramework;

/** A node that records when it is deleted. */
class ObservedNode : public MutableNode
{
public:
    ObservedNode(unsigned int id, Events& events) : MutableNode(id, 0, {1}, 46, 0), events_(events)
    {
    }

    ~ObservedNode() override
    {
        events_.push_back("gone " + std::to_string(getNodeId()));
    }

private:
    Events& events_;
};

/** Records the host's notifications, and whether the node is listed at that time. */
class Host : public mihost::NodeObserver
{
public:
    Host(ManagementInterface& managementInterface, Events& events)
        : interface_(managementInterface), events_(events)
    {
        mihost::setNodeObserver(this);
    }

    ~Host() override
    {
        mihost::setNodeObserver(nullptr);
    }

    void nodeAdded(Node const& node) override
    {
        note("added", node);
    }

    void nodeDeleted(Node const& node) override
    {
        note("deleted", node);
    }

private:
    void note(char const* what, Node const& node)
    {
        Nodes nodes;
        interface_.getMap(nodes);
        bool const listed = std::find(nodes.begin(), nodes.end(), &node) != nodes.end();
        events_.push_back(std::string(what) + (listed ? " listed " : " unlisted ") +
                          std::to_string(dynamic_cast<MutableNode const&>(node).getNodeId()));
    }

    ManagementInterface& interface_;
    Events& events_;
};

class RuntimeInterface : public testing::Test
{
protected:
    void TearDown() override
    {
        interface_.unload();
    }

    Node* add(unsigned int id)
    {
        Node* node = new ObservedNode(id, events_);
        EXPECT_EQ(interface_.addNewNode(node).getStatus(), 0U);
        return node;
    }

    std::vector<unsigned int> listed()
    {
        Nodes nodes;
        EXPECT_EQ(interface_.getMap(nodes).getStatus(), 0U);
        std::vector<unsigned int> ids;
        for (Node* node : nodes)
            ids.push_back(dynamic_cast<MutableNode&>(*node).getNodeId());
        return ids;
    }

    Events events_;
    Interface interface_;
};

using Ids = std::vector<unsigned int>;

TEST_F(RuntimeInterface, CountsNodeIdsFromItsOwnIdOn)
{
    interface_.miIds_ = {3, 4};
    EXPECT_EQ(interface_.initialize(7, Number(1U), Number(true)).getStatus(), 0U);
    EXPECT_EQ(interface_.miId_, 7U);
    EXPECT_EQ(interface_.miIds_, Ids{7});
    EXPECT_EQ(interface_.nextNodeId_, 8U);
    EXPECT_TRUE(interface_.nodes_.empty());
    EXPECT_EQ(static_cast<std::string>(interface_), "management interface 7");
}

TEST_F(RuntimeInterface, CopiesTheNodeListInPlaceOfWhatTheCallerHad)
{
    Node* const node = add(2);
    Nodes nodes(3, nullptr);
    EXPECT_EQ(interface_.getMap(nodes).getStatus(), 0U);
    EXPECT_EQ(nodes, Nodes{node});
    nodes.clear();
    interface_.nodes_.push_back(new ObservedNode(3, events_)); // as an interface may do itself
    EXPECT_EQ(listed(), (Ids{2, 3}));
}

TEST_F(RuntimeInterface, ListsANewNodeOnceAndInformsTheHostEachTime)
{
    Host const host(interface_, events_);
    Node* node = add(2);
    EXPECT_EQ(events_, Events{"added listed 2"});
    add(3);
    EXPECT_EQ(interface_.addNewNode(node).getStatus(), 0U);
    EXPECT_EQ(listed(), (Ids{2, 3}));
    EXPECT_EQ(events_, (Events{"added listed 2", "added listed 3", "added listed 2"}));
}

TEST_F(RuntimeInterface, RefusesANullPointer)
{
    Host const host(interface_, events_);
    Node* none = nullptr;
    EXPECT_EQ(interface_.addNewNode(none).getStatus(), 1U);
    EXPECT_TRUE(listed().empty());
    EXPECT_TRUE(events_.empty());
}

struct Load {
    std::vector<Node*> nodes;
    unsigned char answer = 0;
};

Error load(Node* const& node, void const* context)
{
    auto& seen = *static_cast<Load*>(const_cast<void*>(context));
    seen.nodes.push_back(node);
    return {seen.answer, Number(0U), "from the host"};
}

Error lookUp(std::string const&, Node**)
{
    return {0, Number(0U), ""};
}

TEST_F(RuntimeInterface, PassesANewNodeToTheLoadCallBack)
{
    Load seen;
    interface_.setLoadCallBack(load, &seen, lookUp);
    EXPECT_EQ(interface_.loadCallBack_, &load);
    EXPECT_EQ(interface_.loadCallBackContext_, &seen);
    EXPECT_EQ(interface_.lookupCallBack_, &lookUp);
    EXPECT_TRUE(seen.nodes.empty());
    Node* const node = add(2);
    EXPECT_EQ(seen.nodes, Nodes{node});
    Node* again = node;
    interface_.addNewNode(again);
    EXPECT_EQ(seen.nodes, (Nodes{node, node}));
}

TEST_F(RuntimeInterface, ReturnsTheHostsAnswerAndKeepsARefusedNode)
{
    Load seen;
    seen.answer = 5;
    interface_.setLoadCallBack(load, &seen, nullptr);
    Node* node = new ObservedNode(2, events_);
    Error const error = interface_.addNewNode(node);
    EXPECT_EQ(error.getStatus(), 5U);
    EXPECT_EQ(static_cast<std::string>(error), "status 5: from the host");
    EXPECT_EQ(listed(), Ids{2});
    EXPECT_TRUE(events_.empty());
}

TEST_F(RuntimeInterface, RemovesANodeInformsTheHostAndDeletesIt)
{
    Node* const node = add(2);
    add(3);
    Host const host(interface_, events_);
    EXPECT_EQ(interface_.deleteNode(node).getStatus(), 0U);
    EXPECT_EQ(events_, (Events{"deleted unlisted 2", "gone 2"}));
    EXPECT_EQ(listed(), Ids{3});
}

TEST_F(RuntimeInterface, AnswersStatus1ForANodeThatItDoesNotList)
{
    ObservedNode stranger(9, events_);
    EXPECT_EQ(interface_.deleteNode(&stranger).getStatus(), 1U);
    add(2);
    Host const host(interface_, events_);
    EXPECT_EQ(interface_.deleteNode(&stranger).getStatus(), 1U);
    EXPECT_EQ(interface_.deleteNode(nullptr).getStatus(), 1U);
    EXPECT_TRUE(events_.empty());
    EXPECT_EQ(listed(), Ids{2});
}

TEST_F(RuntimeInterface, KeepsTheOrderThroughAdditionsAndDeletions)
{
    std::mt19937 random(19);
    std::vector<std::pair<unsigned int, Node*>> left;
    for (unsigned int id = 0; id < 500; ++id) {
        Node* appended = new ObservedNode(id, events_);
        if (id % 2 == 0)
            interface_.nodes_.push_back(appended);
        EXPECT_EQ(interface_.addNewNode(appended).getStatus(), 0U);
        left.emplace_back(id, appended);
        if (id % 3 == 0)
            continue;
        auto const gone = left.begin() + static_cast<long>(random() % left.size());
        EXPECT_EQ(interface_.deleteNode(gone->second).getStatus(), 0U);
        left.erase(gone);
        EXPECT_LE(interface_.nodes_.size(), 2 * left.size() + 1);
    }
    Ids expected;
    for (auto const& [id, node] : left)
        expected.push_back(id);
    EXPECT_EQ(listed(), expected);
    for (auto const& [id, node] : left) {
        Node* found = nullptr;
        EXPECT_EQ(interface_.getNode(std::to_string(id), found).getStatus(), 0U);
        EXPECT_EQ(found, node);
    }
}

TEST_F(RuntimeInterface, ListsNewNodesAfterItWasUnloaded)
{
    add(1);
    interface_.deleteNode(add(2));
    interface_.unload();
    Node* const node = add(3);
    add(4);
    EXPECT_EQ(interface_.deleteNode(node).getStatus(), 0U);
    EXPECT_EQ(listed(), Ids{4});
}

TEST_F(RuntimeInterface, FindsAndUnloadsNodesAfterDeletedOnes)
{
    Node* const first = add(1);
    Node* const wanted = add(2);
    interface_.deleteNode(first);
    events_.clear();
    Node* found = nullptr;
    EXPECT_EQ(interface_.getNode("2", found).getStatus(), 0U);
    EXPECT_EQ(found, wanted);
    EXPECT_EQ(interface_.getNode("1", found).getStatus(), 1U);
    interface_.unload();
    EXPECT_EQ(events_, Events{"gone 2"});
}

TEST_F(RuntimeInterface, DeletesEveryNodeWhenItIsUnloaded)
{
    add(2);
    interface_.nodes_.push_back(new ObservedNode(3, events_));
    interface_.unload();
    EXPECT_EQ(events_, (Events{"gone 2", "gone 3"}));
    EXPECT_TRUE(listed().empty());
    interface_.unload();
    EXPECT_EQ(events_.size(), 2U);
}

TEST_F(RuntimeInterface, FindsANodeByTheTextOfItsId)
{
    add(12);
    Node* const node = add(1);
    Node* wanted = nullptr;
    EXPECT_EQ(interface_.getNode("1", wanted).getStatus(), 0U);
    EXPECT_EQ(wanted, node);
    for (char const* id : {"2", "", "01", "1 ", "one"}) {
        Node* found = node;
        Error const error = interface_.getNode(id, found);
        EXPECT_EQ(error.getStatus(), 1U) << id;
        EXPECT_EQ(static_cast<std::string>(error),
                  std::string("status 1: no node has the id ") + id);
        EXPECT_EQ(found, node);
    }
}

TEST_F(RuntimeInterface, AddsAndRemovesAListenerForAlerts)
{
    auto const listener = [](std::vector<IC::Alert> const&, void const*) -> Error {
        return {0, Number(0U), ""};
    };
    EXPECT_EQ(interface_.registerForAlerts(listener, nullptr).getStatus(), 0U);
    EXPECT_EQ(interface_.deRegisterForAlerts().getStatus(), 0U);
}

TEST_F(RuntimeInterface, FailsToInitializeOnRequestButIsPrepared)
{
    IC::Error const failure(9, IC::Number(0U), "on request");
    mihost::setInitializeAnswer(&failure);
    IC::Error const error = interface_.initialize(30, IC::Number(0U), IC::Number(0U));
    mihost::setInitializeAnswer(nullptr);
    EXPECT_EQ(error.getStatus(), 9U);
    EXPECT_EQ(error.getText(), "on request");
    EXPECT_EQ(interface_.miId_, 30U);
    EXPECT_EQ(interface_.nextNodeId_, 31U);
    EXPECT_EQ(interface_.initialize(30, IC::Number(0U), IC::Number(0U)).getStatus(), 0U);
}

} // namespace interface_test
