// The base of a plug-in's interface: node ids, the node list, publication and deletion.

#include "host/ManagementInterface.h"
#include "host/MutableNode.h"
#include "mihost/hostcheck/Check.h"

#include <memory>
#include <string>

namespace hostcheck
{

namespace
{

using IC::Error;
using IC::Node;

using NodeList = std::vector<Node*>;

int nodesAlive = 0;

class CountedNode : public IC::MutableNode
{
public:
    explicit CountedNode(unsigned int id) : MutableNode(id, 0, {1}, 2, 0)
    {
        ++nodesAlive;
    }

    ~CountedNode() override
    {
        --nodesAlive;
    }
};

/** What the load callback was called with, and what it answers. */
struct Loads {
    unsigned char answer = 0;
    mutable NodeList nodes;
};

Error noteLoad(Node* const& node, void const* context)
{
    auto const* const loads = static_cast<Loads const*>(context);
    loads->nodes.push_back(node);
    return {loads->answer, IC::Number(0U), loads->answer == 0 ? "" : "refused"};
}

/** A separate interface for each check. */
class TestInterface : public IC::ManagementInterface
{
public:
    explicit TestInterface(unsigned int id = 1)
        : started(initialize(id, IC::Number(0U), IC::Number(IC::Number::EmptyKind)))
    {
    }

    ~TestInterface() override
    {
        IC::ManagementInterface::unload();
    }

    /** Makes a node and appends it to the list, as a plug-in does at start-up. */
    Node* append()
    {
        Node* const node = new CountedNode(nextNodeId_++);
        nodes_.push_back(node);
        return node;
    }

    NodeList map()
    {
        NodeList nodes;
        getMap(nodes);
        return nodes;
    }

    long long size()
    {
        return static_cast<long long>(map().size());
    }

    using IC::ManagementInterface::miId_;
    using IC::ManagementInterface::nextNodeId_;

    Error const started;
};

std::string initializes()
{
    TestInterface const interface(41);
    return firstOf({equal("the status", interface.started.getStatus(), 0),
                    equal("miId_ after the id 41", interface.miId_, 41),
                    equal("nextNodeId_ after the id 41", interface.nextNodeId_, 42)});
}

std::string lists()
{
    TestInterface interface;
    NodeList nodes;
    Error const error = interface.getMap(nodes);
    NodeList const appended = {interface.append(), interface.append(), interface.append()};
    return firstOf({equal("the status", error.getStatus(), 0),
                    holds(nodes.empty(), "an interface without nodes lists some"),
                    holds(interface.map() == appended,
                          "the nodes are not those that were appended to nodes_, in order")});
}

std::string callsNobody()
{
    TestInterface interface;
    Loads loads;
    interface.append();
    interface.setLoadCallBack(noteLoad, &loads, nullptr);
    interface.append();
    interface.map();
    return equal("calls of the load callback", static_cast<long long>(loads.nodes.size()), 0);
}

std::string informs()
{
    TestInterface interface;
    Loads loads;
    interface.setLoadCallBack(noteLoad, &loads, nullptr);
    Node* node = interface.append();
    Node* const published = node;
    Error const error = interface.addNewNode(node);
    return firstOf(
        {equal("the status", error.getStatus(), 0),
         equal("calls of the load callback", static_cast<long long>(loads.nodes.size()), 1),
         holds(loads.nodes == NodeList{published}, "the callback has another node")});
}

std::string addsWithoutCallBack()
{
    TestInterface interface;
    Node* node = interface.append();
    return firstOf({equal("the status", interface.addNewNode(node).getStatus(), 0),
                    equal("the length of the list", interface.size(), 1)});
}

std::string listsOnce()
{
    auto interface = std::make_unique<TestInterface>();
    Loads loads;
    interface->setLoadCallBack(noteLoad, &loads, nullptr);
    Node* listed = interface->append();
    Node* unlisted = new CountedNode(99);
    interface->addNewNode(listed);
    interface->addNewNode(unlisted);
    if (interface->map() == NodeList{listed, unlisted})
        return "";
    static_cast<void>(interface.release()); // it would delete a node twice
    return "the list is not the appended node and the added one, once each";
}

std::string passesTheAnswerOn()
{
    TestInterface interface;
    Loads loads;
    loads.answer = 7;
    interface.setLoadCallBack(noteLoad, &loads, nullptr);
    Node* node = interface.append();
    return firstOf({equal("the status after the callback's status 7",
                          interface.addNewNode(node).getStatus(), 7),
                    holds(interface.map() == NodeList{node}, "a refused node leaves the list")});
}

std::string deletes()
{
    TestInterface interface;
    NodeList const kept = {interface.append()};
    Node* const deleted = interface.append();
    int const before = nodesAlive;
    Error const error = interface.deleteNode(deleted);
    return firstOf({equal("the status", error.getStatus(), 0),
                    holds(interface.map() == kept, "the list is not the other node alone"),
                    equal("destructors that ran", before - nodesAlive, 1)});
}

std::string keepsUnlisted()
{
    TestInterface interface;
    interface.append();
    CountedNode unlisted(99);
    int const before = nodesAlive;
    Error const error = interface.deleteNode(&unlisted);
    return firstOf({equal("the status", error.getStatus(), 1),
                    equal("destructors that ran", before - nodesAlive, 0),
                    equal("the length of the list", interface.size(), 1)});
}

std::string rebuilds()
{
    TestInterface interface;
    NodeList expected = {interface.append()};
    NodeList const old = {interface.append(), interface.append()};
    expected.push_back(interface.append());
    for (Node* node : old)
        interface.deleteNode(node);
    for (int count = 0; count < 3; ++count) {
        Node* node = interface.append();
        expected.push_back(node);
        interface.addNewNode(node);
    }
    return holds(interface.map() == expected,
                 "the list is not the old nodes that stayed and then the new ones");
}

std::string finds()
{
    TestInterface interface;
    interface.append();
    Node* const second = interface.append();
    auto const id = static_cast<CountedNode*>(second)->getNodeId();
    Node* found = nullptr;
    Node* unknown = nullptr;
    return firstOf(
        {equal("the status", interface.getNode(std::to_string(id), found).getStatus(), 0),
         holds(found == second, "another node is found"),
         equal("the status for an unknown id", interface.getNode("4711", unknown).getStatus(), 1),
         equal("the status for no id", interface.getNode("", unknown).getStatus(), 1)});
}

std::string unloads()
{
    int const before = nodesAlive;
    TestInterface interface;
    interface.append();
    Node* published = interface.append();
    interface.addNewNode(published);
    interface.unload();
    interface.unload(); // nothing left
    return firstOf({equal("nodes that are still there", nodesAlive - before, 0),
                    equal("the length of the list", interface.size(), 0)});
}

std::string unloadsUninitialized()
{
    IC::ManagementInterface interface;
    interface.unload();
    NodeList nodes;
    interface.getMap(nodes);
    return equal("the length of the list", static_cast<long long>(nodes.size()), 0);
}

Error noteAlerts(std::vector<IC::Alert> const&, void const*)
{
    return {0, IC::Number(0U), ""};
}

std::string takesAlerts()
{
    TestInterface interface;
    interface.registerForAlerts(noteAlerts, &interface);
    interface.deRegisterForAlerts();
    interface.deRegisterForAlerts();
    return "";
}

std::string interfaceForm()
{
    TestInterface const interface;
    static_cast<void>(static_cast<std::string>(interface)); // any text will do
    return "";
}

std::string manyNodes()
{
    constexpr std::size_t many = 100000;
    constexpr std::size_t some = 100; // replaced by new ones, as in a rebuild
    int const before = nodesAlive;
    TestInterface interface;
    Loads loads;
    interface.setLoadCallBack(noteLoad, &loads, nullptr);
    NodeList expected;
    while (expected.size() < many)
        expected.push_back(interface.append());
    if (interface.map() != expected)
        return "the list is not the nodes that were appended, in order";
    for (std::size_t count = 0; count < some; ++count) {
        interface.deleteNode(expected.back());
        expected.pop_back();
    }
    while (expected.size() < many) {
        Node* node = interface.append();
        expected.push_back(node);
        interface.addNewNode(node);
    }
    std::string const problem = firstOf(
        {equal("calls of the load callback", static_cast<long long>(loads.nodes.size()), some),
         holds(interface.map() == expected,
               "after a rebuild the list is not the old nodes and then the new ones")});
    interface.unload();
    return firstOf({problem, equal("nodes that are still there", nodesAlive - before, 0)});
}

} // namespace

Checks interfaceChecks()
{
    constexpr char const* add = "IC::ManagementInterface::addNewNode";
    constexpr char const* remove = "IC::ManagementInterface::deleteNode";
    constexpr char const* unload = "IC::ManagementInterface::unload";
    return {
        {"IC::ManagementInterface::initialize", "counts node ids from the id after its own",
         initializes},
        {"IC::ManagementInterface::getMap", "lists the nodes in order", lists},
        {"IC::ManagementInterface::setLoadCallBack", "causes no call for listed nodes",
         callsNobody},
        {add, "lists a node once", listsOnce},
        {add, "calls the load callback once", informs},
        {add, "needs no load callback", addsWithoutCallBack},
        {add, "returns the callback's answer and keeps the node", passesTheAnswerOn},
        {remove, "unlists and deletes the node", deletes},
        {remove, "fails for a node that is not listed", keepsUnlisted},
        {remove, "leaves a list that can be appended to", rebuilds},
        {"IC::ManagementInterface::getNode", "finds a node by the text of its id", finds},
        {unload, "deletes every node", unloads},
        {unload, "needs no initialize", unloadsUninitialized},
        {"IC::ManagementInterface::registerForAlerts", "can be called and taken back", takesAlerts},
        {"IC::ManagementInterface::operator std::string", "returns a form for log messages",
         interfaceForm},
        {"IC::ManagementInterface", "holds 100,000 nodes", manyNodes},
    };
}

} // namespace hostcheck
