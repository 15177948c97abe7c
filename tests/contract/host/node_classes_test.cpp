// What the four node classes add to a plain node: a few messages, no data.

#include "tests/contract/host/Loaded.h"

#include <memory>

namespace
{

class NodeClasses : public Loaded, public testing::WithParamInterface<char const*>
{
protected:
    NodeClasses()
    {
        host.events.clear();
    }
};

TEST_P(NodeClasses, PassTheirArgumentsOnAndThenSayOneLine)
{
    std::unique_ptr<IC::MutableNode> const node(construct(GetParam()));
    std::string const name = GetParam();
    EXPECT_EQ(host.events, (Lines{"MutableNode(11, 12, [13 14], 15, 16)",
                                  "log: " + name + "::" + name + ": entry"}));
}

TEST_P(NodeClasses, SayOneLineBeforeTheyAreDestroyed)
{
    std::unique_ptr<IC::MutableNode> node(construct(GetParam()));
    host.events.clear();
    node.reset();
    std::string const name = GetParam();
    EXPECT_EQ(host.events, (Lines{"log: " + name + "::~" + name + ": entry", "~MutableNode()"}));
}

TEST_P(NodeClasses, SpeakUnderTheFramesCategoryAndFile)
{
    host.logCalls.clear();
    construct(GetParam())->~MutableNode();
    ASSERT_EQ(host.logCalls.size(), 4U);
    for (LogCall const& call : host.logCalls) {
        EXPECT_EQ(call.file, "OsSwMI");
        EXPECT_EQ(call.category, "Veltrix.IC.MI.OsSwMI");
        EXPECT_EQ(call.level, 3000);
    }
}

INSTANTIATE_TEST_SUITE_P(All, NodeClasses,
                         testing::Values("OsNode", "UserNode", "GroupNode", "LogEntryNode"),
                         [](auto const& name) { return std::string(name.param); });

struct Operation {
    char const* className;
    char const* says; // what its two messages begin with
};

void PrintTo(Operation const& operation, std::ostream* out)
{
    *out << operation.says;
}

// Of no meaning to any class: stored and read back like every other number.
constexpr unsigned int plainProperty = 4711;

class Reads : public Loaded, public testing::WithParamInterface<Operation>
{
};

TEST_P(Reads, SayTwoLinesAroundTheFrameworksOwn)
{
    std::unique_ptr<IC::MutableNode> const node(construct(GetParam().className));
    host.events.clear();
    IC::PropertyValue value(IC::PropertyValue::EmptyKind, true);
    EXPECT_EQ(node->getProperty(plainProperty, value).getStatus(), 1);
    std::string const says = GetParam().says;
    EXPECT_EQ(host.events, (Lines{"log: " + says + ": entry", "log: " + says + ": exit"}));
}

// Kept: a user node's read speaks as its constructor.
INSTANTIATE_TEST_SUITE_P(All, Reads,
                         testing::Values(Operation{"OsNode", "OsNode::getProperty"},
                                         Operation{"UserNode", "UserNode::UserNode"},
                                         Operation{"GroupNode", "GroupNode::getProperty"},
                                         Operation{"LogEntryNode", "LogEntryNode::getProperty"}),
                         [](auto const& operation) {
                             return std::string(operation.param.className);
                         });

class Writes : public Loaded, public testing::WithParamInterface<Operation>
{
};

TEST_P(Writes, SayTwoLinesAroundTheFrameworksStore)
{
    std::unique_ptr<IC::MutableNode> const node(construct(GetParam().className));
    host.events.clear();
    IC::PropertyValue const value("x", true);
    EXPECT_EQ(node->setProperty(plainProperty, value).getStatus(), 0);
    std::string const says = GetParam().says;
    std::string const stores = "setProperty(4711, text x true)";
    EXPECT_EQ(host.events, (Lines{"log: " + says + ": entry", stores, "log: " + says + ": exit"}));
    EXPECT_EQ(text(*node, plainProperty), "x");
}

INSTANTIATE_TEST_SUITE_P(All, Writes,
                         testing::Values(Operation{"OsNode", "OsNode::setProperty"},
                                         Operation{"UserNode", "UserNode::setProperty"},
                                         Operation{"LogEntryNode", "LogEntryNode::setProperty"}),
                         [](auto const& operation) {
                             return std::string(operation.param.className);
                         });

class GroupNodeWrites : public Loaded
{
};

TEST_F(GroupNodeWrites, AreTheFrameworksOwnAndSayNothing)
{
    std::unique_ptr<IC::MutableNode> const node(construct("GroupNode"));
    host.events.clear();
    node->setProperty(plainProperty, IC::PropertyValue("x", true));
    EXPECT_EQ(host.events, Lines{"setProperty(4711, text x true)"});
}

} // namespace
