// What the nodes of users and those of groups have in common: how they are built, replaced and
// read.

#include "nodes/GroupNode.h"
#include "nodes/UserNode.h"
#include "nodes/nodeValues.h"
#include "tests/support/Account.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/Frame.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <ostream>
#include <string>
#include <typeinfo>
#include <utility>
#include <vector>

namespace account_nodes_test
{

using Ids = std::vector<unsigned int>;

struct Kind {
    std::string name;
    std::type_info const& nodeClass;
    unsigned int type;
    void (IC::OsSwMI::*build)(bool refresh);
    std::vector<IC::Node*> IC::OsSwMI::*listed;
    char const* description;
    std::size_t properties;
    char const* database;
    std::string oneMore; // line of the database
    Lines names;         // in the order of the database
    std::string deletion;
};

void PrintTo(Kind const& kind, std::ostream* out)
{
    *out << kind.name;
}

/** A machine with three users and three groups to report, and a group that is not reported. */
class AccountNodes : public testing::TestWithParam<Kind>
{
protected:
    AccountNodes()
    {
        files.write("/etc/login.defs", "UID_MIN 500\nUID_MAX 60000\nGID_MIN 500\nGID_MAX 60000\n");
        files.write("/etc/passwd",
                    account("root", 0) + account("anna", 1000) + account("ben", 1001));
        files.write("/etc/group", "root:x:0:\ntty:x:5:anna\nteam:x:500:ben,carl\ncrew:x:501:\n");
    }

    void build(bool refresh)
    {
        (frame.*kind.build)(refresh);
    }

    std::vector<IC::MutableNode*> nodes() const
    {
        return frame.ofType(kind.type);
    }

    std::vector<IC::Node*> const& listed() const
    {
        return frame.*kind.listed;
    }

    Kind const& kind = GetParam();
    FakeFiles const files;
    Frame frame;
};

TEST_P(AccountNodes, HaveTheOrderOfTheDatabase)
{
    frame.nextNodeId_ = 30;
    build(false);
    ASSERT_EQ(nodes().size(), 3U);
    for (unsigned int i = 0; i < 3; ++i) {
        IC::MutableNode const& node = *nodes()[i];
        EXPECT_EQ(node.getNodeId(), 30 + i);
        EXPECT_EQ(node.getIndex(), i + 1);
        EXPECT_EQ(node.getLinkedId(), frame.osNode_->getNodeId());
        EXPECT_EQ(node.getMIIds(), Ids{7});
        EXPECT_EQ(node.getStatus(), 1U);
        EXPECT_EQ(node.getDescription(), kind.description);
        EXPECT_EQ(storedValue(node, 108), "text " + kind.names[i] + " true");
        EXPECT_TRUE(typeid(node) == kind.nodeClass);
        EXPECT_EQ(listed().at(i), &node);
    }
    EXPECT_EQ(listed().size(), 3U);
    EXPECT_EQ(frame.nextNodeId_, 33U);
    EXPECT_EQ(*frame.nodeIds_, (Ids{30, 31, 32}));
    EXPECT_TRUE(frame.published.empty());
    EXPECT_EQ(frame.currentNode_, nodes().back());
}

TEST_P(AccountNodes, ReadTheirParentsIdOnceEachAfterTakingTheirOwn)
{
    CountingParent parent(frame);
    IC::MutableNode* const real = std::exchange(frame.osNode_, &parent);
    build(false);
    frame.osNode_ = real;
    EXPECT_EQ(nodes().size(), 3U);
    EXPECT_TRUE(CountingParent::wasReadInOrder(nodes()));
}

TEST_P(AccountNodes, ArePublishedOnARefreshAndTheirIdsNotNoted)
{
    build(false);
    Ids const noted = *frame.nodeIds_;
    unsigned int const next = frame.nextNodeId_;
    build(true);
    EXPECT_EQ(*frame.nodeIds_, noted);
    ASSERT_EQ(nodes().size(), 3U);
    EXPECT_EQ(frame.published, listed());
    for (unsigned int i = 0; i < 3; ++i) {
        EXPECT_EQ(nodes()[i]->getNodeId(), next + i);
        EXPECT_EQ(nodes()[i]->getIndex(), i + 1);
    }
    EXPECT_EQ(frame.nextNodeId_, next + 3);
}

TEST_P(AccountNodes, ArePublishedAsSoonAsEachIsComplete)
{
    using Counts = std::vector<std::pair<std::size_t, std::size_t>>;
    struct Publications {
        Frame const& frame;
        Counts nodesAndProperties;
    } seen{frame, {}};
    frame.setLoadCallBack(
        [](IC::Node* const& node, void const* context) {
            auto& to = *static_cast<Publications*>(const_cast<void*>(context));
            to.nodesAndProperties.emplace_back(
                to.frame.ofType(dynamic_cast<IC::MutableNode&>(*node).getNodeType()).size(),
                node->getProperties().size());
            return IC::values::success();
        },
        &seen, nullptr);
    build(true);
    std::size_t const all = kind.properties;
    EXPECT_EQ(seen.nodesAndProperties, (Counts{{1, all}, {2, all}, {3, all}}));
}

TEST_P(AccountNodes, AreAllDeletedOnARefreshBeforeANewOneIsMade)
{
    build(false);
    nodes()[1]->setDescription("Renamed");
    std::vector<IC::Node*> const before = listed();
    Recording const log;
    build(true);
    EXPECT_EQ(frame.deleted, before);
    std::string const destruction = kind.name + "Node::~" + kind.name + "Node: entry";
    Lines const texts = log.texts(3000);
    ASSERT_GE(texts.size(), 8U);
    EXPECT_EQ(
        Lines(texts.begin(), texts.begin() + 8),
        (Lines{"create" + kind.name + "Nodes: entry", kind.deletion + kind.description, destruction,
               kind.deletion + "Renamed", destruction, kind.deletion + kind.description,
               destruction, "get" + kind.name + "Info: entry"}));
    LogRecord const announcement = log.records().at(2);
    EXPECT_EQ(announcement.text, kind.deletion + kind.description);
    EXPECT_EQ(announcement.function, "create" + kind.name + "Nodes");
    EXPECT_EQ(announcement.file, "OsSwMI");
    EXPECT_EQ(announcement.category, "Veltrix.IC.MI.OsSwMI");
}

TEST_P(AccountNodes, AreNotDeletedWhenBuiltWithoutARefresh)
{
    build(false);
    build(false);
    EXPECT_TRUE(frame.deleted.empty());
    EXPECT_EQ(nodes().size(), 6U);
    EXPECT_EQ(listed().size(), 3U);
    EXPECT_EQ(nodes()[3]->getIndex(), 1U);
}

TEST_P(AccountNodes, AnswerTheirCountLive)
{
    build(false);
    nodes()[0]->setProperty(51, IC::values::number(99));
    files.write(kind.database, contentOf(files.realPath(kind.database)) + kind.oneMore);
    IC::PropertyValue value = IC::values::emptyValue();
    IC::Error const error = nodes()[0]->getProperty(51, value);
    EXPECT_EQ(static_cast<std::string>(error), "status 0");
    EXPECT_EQ(shown(value), "number 4 true");
    EXPECT_EQ(storedValue(*nodes()[0], 51), "number 99 true");
    EXPECT_EQ(storedValue(*nodes()[1], 51), "number 3 true");
}

TEST_P(AccountNodes, AnswerAllElseFromWhatIsStored)
{
    build(false);
    files.write(kind.database, "");
    IC::PropertyValue value = IC::values::emptyValue();
    EXPECT_EQ(nodes()[1]->getProperty(108, value).getStatus(), 0);
    EXPECT_EQ(shown(value), "text " + kind.names[1] + " true");
    IC::PropertyValue untouched = IC::values::text("untouched");
    EXPECT_EQ(nodes()[1]->getProperty(4711, untouched).getStatus(), 1);
    EXPECT_EQ(shown(untouched), "text untouched true");
}

INSTANTIATE_TEST_SUITE_P(
    Of, AccountNodes,
    testing::Values(Kind{"User", typeid(IC::UserNode), 46, &IC::OsSwMI::createUserNodes,
                         &OpenInterface::userNodes_, "User Account", 24, "/etc/passwd",
                         account("new", 1002), Lines{"root", "anna", "ben"},
                         "Delete a user entry: "},
                    Kind{"Group", typeid(IC::GroupNode), 51, &IC::OsSwMI::createGroupNodes,
                         &OpenInterface::groupNodes_, "Group", 4, "/etc/group", "new:x:502:\n",
                         Lines{"root", "team", "crew"}, "Delete a group entry: "}),
    [](auto const& kind) { return kind.param.name + "s"; });

} // namespace account_nodes_test
