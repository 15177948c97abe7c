// A node: identity, status, description and the store of its properties.

#include "host/MutableNode.h"
#include "mihost/hostcheck/Check.h"

#include <algorithm>
#include <climits>
#include <thread>
#include <utility>

namespace hostcheck
{

namespace
{

using IC::MutableNode;
using IC::Number;
using IC::PropertyValue;

using Ids = std::vector<unsigned int>;

class TestNode : public MutableNode
{
public:
    TestNode() : MutableNode(11, 12, {13, 14}, 15, 16) {}
};

PropertyValue text(std::string const& content)
{
    return {content, true};
}

/** The text form of a property; "unset" if there is none. */
std::string read(IC::Node const& node, unsigned int id)
{
    PropertyValue value("untouched", true);
    return node.getProperty(id, value).getStatus() == 0 ? static_cast<std::string>(value) : "unset";
}

std::string nodeId()
{
    return equal("getNodeId of the first argument 11", TestNode().getNodeId(), 11);
}

std::string linkedId()
{
    return equal("getLinkedId of the second argument 12", TestNode().getLinkedId(), 12);
}

std::string miIds()
{
    return holds(TestNode().getMIIds() == Ids{13, 14}, "the ids are not those of the constructor");
}

std::string nodeType()
{
    return equal("getNodeType of the fourth argument 15", TestNode().getNodeType(), 15);
}

std::string nodeIndex()
{
    return equal("getIndex of the fifth argument 16", TestNode().getIndex(), 16);
}

long long occurrences(MutableNode const& node, unsigned int miId)
{
    Ids const ids = node.getMIIds();
    return std::count(ids.begin(), ids.end(), miId);
}

std::string addsMi()
{
    TestNode node;
    node.addMI(99);
    return firstOf({equal("the number of ids 99", occurrences(node, 99), 1),
                    equal("the number of ids 13", occurrences(node, 13), 1)});
}

std::string deletesMi()
{
    TestNode node;
    node.delMI(13);
    node.delMI(98); // not there
    return firstOf({equal("the number of ids 13", occurrences(node, 13), 0),
                    equal("the number of ids 14", occurrences(node, 14), 1)});
}

std::string status()
{
    TestNode node;
    for (unsigned int const value : {1U, 0U, UINT_MAX}) {
        std::string problem =
            firstOf({equal("the result", node.setStatus(value).getStatus(), 0),
                     equal("getStatus", node.getStatus(), value),
                     equal("IC::Node::getStatus", node.IC::Node::getStatus(), value)});
        if (!problem.empty())
            return problem;
    }
    return "";
}

std::string description()
{
    TestNode node;
    for (std::string const& value : oddTexts()) {
        std::string problem =
            firstOf({equal("the result", node.setDescription(value).getStatus(), 0),
                     equal("getDescription", node.getDescription(), value),
                     equal("IC::Node::getDescription", node.IC::Node::getDescription(), value)});
        if (!problem.empty())
            return problem;
    }
    return "";
}

template <IC::Error (MutableNode::*Set)(std::string const&)> std::string takesTexts()
{
    TestNode node;
    for (std::string const& value : oddTexts())
        if (std::string problem = equal("the result", (node.*Set)(value).getStatus(), 0);
            !problem.empty())
            return problem;
    return "";
}

std::string nodeForm()
{
    TestNode node;
    node.setDescription("text");
    static_cast<void>(static_cast<std::string>(node)); // any text will do
    return "";
}

std::string stores()
{
    TestNode node;
    for (unsigned int const id : {108U, 0U, UINT_MAX}) {
        std::string problem =
            firstOf({equal("the result", node.setProperty(id, text("value")).getStatus(), 0),
                     equal("getProperty afterwards", read(node, id), "value")});
        if (!problem.empty())
            return problem;
    }
    return "";
}

std::string replaces()
{
    TestNode node;
    node.setProperty(5, text("earlier"));
    node.setProperty(6, text("other"));
    node.setProperty(5, PropertyValue(Number(7U), false));
    PropertyValue value = text("untouched");
    node.getProperty(5, value);
    return firstOf(
        {equal("the text form of the later value", static_cast<std::string>(value), "7"),
         equal("the kind of the later value", value.getKind(), PropertyValue::NumberKind),
         equal("the flag of the later value", value.getFlag(), 0),
         equal("another property", read(node, 6), "other")});
}

std::string storesCopies()
{
    TestNode node;
    PropertyValue value = text("stored");
    node.setProperty(5, value);
    value = text("changed");
    return equal("what is stored", read(node, 5), "stored");
}

std::string failsForUnset()
{
    TestNode node;
    node.setProperty(5, text("other"));
    PropertyValue value("untouched", false);
    IC::Error const error = node.getProperty(6, value);
    return firstOf(
        {holds(error.getStatus() != 0, "the status for an unset property is 0"),
         equal("the value after a failure", static_cast<std::string>(value), "untouched"),
         equal("the kind after a failure", value.getKind(), PropertyValue::TextKind),
         equal("the flag after a failure", value.getFlag(), 0)});
}

std::string listsAll()
{
    constexpr unsigned int count = 1000;
    TestNode node;
    for (unsigned int id = count; id > 0; --id)
        node.setProperty(id, PropertyValue(Number(id), true));
    auto properties = node.getProperties();
    if (properties.size() != count)
        return equal("the number of properties", static_cast<long long>(properties.size()), count);
    for (auto const& [id, value] : properties)
        if (value.getNumber() != id)
            return "property " + std::to_string(id) + " has the value of another one";
    properties.clear();
    return equal("a property after the copy was changed", read(node, 1), "1");
}

/** Answers one property itself and leaves the rest to its base, as a plug-in's nodes do. */
class Overriding : public TestNode
{
public:
    static constexpr unsigned int own = 1;

    IC::Error getProperty(unsigned int id, PropertyValue& value) const override
    {
        if (++reads > 1)
            return {1, Number(Number::EmptyKind), "called again by its base"};
        if (id != own)
            return MutableNode::getProperty(id, value);
        value = text("live");
        return {0, Number(Number::EmptyKind), ""};
    }

    IC::Error setProperty(unsigned int const& id, PropertyValue const& value) override
    {
        if (++writes > 1)
            return {1, Number(Number::EmptyKind), "called again by its base"};
        return MutableNode::setProperty(id, value);
    }

    mutable int reads = 0;
    int writes = 0;
};

std::string baseRead()
{
    Overriding node;
    node.setProperty(5, text("stored"));
    std::string const stored = read(node, 5);
    int const reads = std::exchange(node.reads, 0);
    return firstOf(
        {equal("calls of a derived getProperty", reads, 1),
         equal("a property that the base answers", stored, "stored"),
         equal("a property that the derived node answers", read(node, Overriding::own), "live")});
}

std::string baseWrite()
{
    Overriding node;
    node.setProperty(5, text("stored"));
    return firstOf({equal("calls of a derived setProperty", node.writes, 1),
                    equal("what the base stored", read(node, 5), "stored")});
}

class PlainNode : public IC::Node
{
};

std::string plainNode()
{
    PlainNode node;
    node.setProperty(5, text("stored"));
    return firstOf({equal("a property", read(node, 5), "stored"),
                    equal("the number of properties",
                          static_cast<long long>(node.getProperties().size()), 1)});
}

std::string nodesInTwoThreads()
{
    auto const work = [](std::string& problem) {
        TestNode node;
        for (unsigned int id = 0; id < 1000; ++id) {
            node.setProperty(id, PropertyValue(Number(id), true));
            if (read(node, id) != std::to_string(id))
                problem = "a property is lost while another node is written";
        }
    };
    std::string here;
    std::string there;
    std::thread other(work, std::ref(there));
    work(here);
    other.join();
    return firstOf({here, there});
}

} // namespace

Checks nodeChecks()
{
    return {
        {"IC::MutableNode::getNodeId", "returns the constructor's first argument", nodeId},
        {"IC::MutableNode::getLinkedId", "returns the constructor's second argument", linkedId},
        {"IC::MutableNode::getMIIds", "returns the constructor's third argument", miIds},
        {"IC::MutableNode::getNodeType", "returns the constructor's fourth argument", nodeType},
        {"IC::MutableNode::getIndex", "returns the constructor's fifth argument", nodeIndex},
        {"IC::MutableNode::addMI", "adds the id", addsMi},
        {"IC::MutableNode::delMI", "takes the id away", deletesMi},
        {"IC::MutableNode::setStatus", "stores what getStatus returns", status},
        {"IC::MutableNode::setDescription", "stores what getDescription returns", description},
        {"IC::MutableNode::setPath", "takes any text", takesTexts<&MutableNode::setPath>},
        {"IC::MutableNode::setParent", "takes any text", takesTexts<&MutableNode::setParent>},
        {"IC::Node::operator std::string", "returns a form for log messages", nodeForm},
        {"IC::MutableNode::setProperty", "stores what getProperty returns", stores},
        {"IC::MutableNode::setProperty", "replaces an earlier value", replaces},
        {"IC::MutableNode::setProperty", "keeps a copy", storesCopies},
        {"IC::MutableNode::getProperty", "fails for an unset property, the value untouched",
         failsForUnset},
        {"IC::MutableNode::getProperties", "returns a copy of all stored values", listsAll},
        {"IC::MutableNode::setProperty", "does not call the derived one again", baseWrite},
        {"IC::MutableNode::getProperty", "does not call the derived one again", baseRead},
        {"IC::Node", "stores properties itself", plainNode},
        {"IC::MutableNode", "can be used beside another node in another thread", nodesInTwoThreads},
    };
}

} // namespace hostcheck
