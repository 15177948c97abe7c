// What the four node classes add to a plain node: a few messages, no data.

#include "tests/contract/recording_host/Loaded.h"
#include "tests/support/SystemLog.h"

#include <filesystem>
#include <memory>

namespace node_classes_test
{

class NodeClasses : public Loaded, public testing::WithParamInterface<char const*>
{
protected:
    NodeClasses()
    {
        host.events.clear();
    }
};

TEST_P(NodeClasses, PassTheirArgumentsOnAndLogOneMessage)
{
    std::unique_ptr<IC::MutableNode> const node(construct(GetParam()));
    std::string const name = GetParam();
    EXPECT_EQ(host.events, (Lines{"MutableNode(11, 12, [13 14], 15, 16)",
                                  "log: " + name + "::" + name + ": entry"}));
}

TEST_P(NodeClasses, LogOneMessageBeforeTheyAreDestroyed)
{
    std::unique_ptr<IC::MutableNode> node(construct(GetParam()));
    host.events.clear();
    node.reset();
    std::string const name = GetParam();
    EXPECT_EQ(host.events, (Lines{"log: " + name + "::~" + name + ": entry", "~MutableNode()"}));
}

TEST_P(NodeClasses, LogUnderTheFramesCategoryAndFile)
{
    host.logCalls.clear();
    std::unique_ptr<IC::MutableNode>(construct(GetParam())).reset();
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
    char const* says; // the beginning of its two messages
};

void PrintTo(Operation const& operation, std::ostream* out)
{
    *out << operation.says;
}

// No class handles this id: it is only stored and read back.
constexpr unsigned int plainProperty = 4711;

class Reads : public Loaded, public testing::WithParamInterface<Operation>
{
};

TEST_P(Reads, LogEntryAndExitAroundTheFrameworksRead)
{
    std::unique_ptr<IC::MutableNode> const node(construct(GetParam().className));
    host.events.clear();
    IC::PropertyValue value(IC::PropertyValue::EmptyKind, true);
    IC::Error const answer = node->getProperty(plainProperty, value);
    EXPECT_EQ(static_cast<std::string>(answer), "status 1, not set");
    std::string const says = GetParam().says;
    EXPECT_EQ(host.events, (Lines{"log: " + says + ": entry", "log: " + says + ": exit"}));
}

// Contract: a user node's read logs under its constructor's name.
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

TEST_P(Writes, LogEntryAndExitAroundTheFrameworksStore)
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

TEST_P(Writes, ReturnTheFrameworksStatus)
{
    std::unique_ptr<IC::MutableNode> const node(construct(GetParam().className));
    host.setterStatus = 7;
    IC::PropertyValue const value("x", true);
    EXPECT_EQ(node->setProperty(plainProperty, value).getStatus(), 7);
}

INSTANTIATE_TEST_SUITE_P(All, Writes,
                         testing::Values(Operation{"OsNode", "OsNode::setProperty"},
                                         Operation{"UserNode", "UserNode::setProperty"},
                                         Operation{"LogEntryNode", "LogEntryNode::setProperty"}),
                         [](auto const& operation) {
                             return std::string(operation.param.className);
                         });

/** A property that a class reads itself, and the status that it makes. */
struct OwnAnswer {
    char const* name;
    char const* className;
    unsigned int id;
    char const* status;
};

void PrintTo(OwnAnswer const& answer, std::ostream* out)
{
    *out << answer.name;
}

class OwnReads : public Loaded, public testing::WithParamInterface<OwnAnswer>
{
};

TEST_P(OwnReads, MakeOneStatusWithoutTheFramework)
{
    std::unique_ptr<IC::MutableNode> const node(construct(GetParam().className));
    host.errors.clear();
    IC::PropertyValue value(IC::PropertyValue::EmptyKind, true);
    node->getProperty(GetParam().id, value);
    EXPECT_EQ(host.errors, Lines{GetParam().status});
}

constexpr char const* success = "Error(0, empty 0, \"\")";
constexpr char const* countSuccess = "Error(0, unsigned 0, \"\")";
constexpr char const* failure = "Error(1, empty 0, \"\")";

// The log cannot be counted here, and the index of the entry's node is 16.
INSTANTIATE_TEST_SUITE_P(All, OwnReads,
                         testing::Values(OwnAnswer{"ProcessCount", "OsNode", 144, success},
                                         OwnAnswer{"ClearCommand", "OsNode", 191, success},
                                         OwnAnswer{"UserCount", "UserNode", 51, countSuccess},
                                         OwnAnswer{"GroupCount", "GroupNode", 51, countSuccess},
                                         OwnAnswer{"LogIndex", "LogEntryNode", 89, success},
                                         OwnAnswer{"LogMessage", "LogEntryNode", 81, failure},
                                         OwnAnswer{"LogTime", "LogEntryNode", 79, failure}),
                         [](auto const& answer) { return std::string(answer.param.name); });

class CommandWrites : public Loaded
{
protected:
    std::unique_ptr<IC::MutableNode> const os{construct("OsNode")};
};

TEST_F(CommandWrites, ReturnTheirOwnStatusIfAMethodFails)
{
    host.setterStatus = 7;
    host.errors.clear();
    EXPECT_EQ(os->setProperty(74, IC::PropertyValue("NoSuchMethod", true)).getStatus(), 1);
    EXPECT_EQ(host.errors, (Lines{"Error(7, empty 0, \"\")", failure}));
}

TEST_F(CommandWrites, ReturnTheStoresStatusIfTheActionFails)
{
    host.setterStatus = 7;
    for (unsigned int const id : {123U, 191U})
        EXPECT_EQ(os->setProperty(id, IC::PropertyValue(IC::Number(12U), true)).getStatus(), 7);
    EXPECT_EQ(os->setProperty(74, IC::PropertyValue("dummy", true)).getStatus(), 7);
    EXPECT_EQ(commands.ran, Lines{"/sbin/shutdown -h now"}); // which could not be started
}

TEST_F(CommandWrites, TakeNoLockIfNothingIsRebuilt)
{
    host.events.clear();
    for (unsigned int const id : {123U, 191U, 75U, 108U})
        os->setProperty(id, IC::PropertyValue(IC::Number(5U), true));
    os->setProperty(74, IC::PropertyValue("NoSuchMethod", true));
    for (std::string const& event : host.events)
        EXPECT_EQ(event.find("lock("), std::string::npos) << event;
}

class GroupNodeWrites : public Loaded
{
};

TEST_F(GroupNodeWrites, OnlyStoreTheValueAndLogNothing)
{
    std::unique_ptr<IC::MutableNode> const node(construct("GroupNode"));
    host.events.clear();
    node->setProperty(plainProperty, IC::PropertyValue("x", true));
    EXPECT_EQ(host.events, Lines{"setProperty(4711, text x true)"});
}

class UserCommandWrites : public Loaded
{
};

TEST_F(UserCommandWrites, ReturnTheStoresStatusIfTheActionFails)
{
    std::filesystem::current_path("/proc"); // "usrandpwd" cannot be created there
    std::unique_ptr<IC::MutableNode> const user(construct("UserNode"));
    host.setterStatus = 7;
    for (unsigned int const id : {117U, 118U, 91U, 138U})
        EXPECT_EQ(user->setProperty(id, IC::PropertyValue("1", true)).getStatus(), 7) << id;
    EXPECT_FALSE(commands.ran.empty());
    commands.ran.clear();
    bool& flag = object<bool>("IC::OSSWMI::MI_call");
    flag = true;
    for (unsigned int const id : {117U, 118U, 91U, 138U})
        EXPECT_EQ(user->setProperty(id, IC::PropertyValue("1", true)).getStatus(), 7) << id;
    flag = false;
    EXPECT_EQ(commands.ran, Lines());
    std::filesystem::current_path("/");
}

class LogEntryReads : public Loaded
{
};

TEST_F(LogEntryReads, MakeOneSuccessStatusAndTakeNoLock)
{
    commands.answers = systemLog::answers(systemLog::messages(16));
    std::unique_ptr<IC::MutableNode> const node(construct("LogEntryNode")); // its index is 16
    for (unsigned int const id : {81U, 79U}) {
        host.errors.clear();
        host.events.clear();
        IC::PropertyValue value(IC::PropertyValue::EmptyKind, true);
        EXPECT_EQ(node->getProperty(id, value).getStatus(), 0);
        EXPECT_EQ(host.errors, Lines{success});
        for (std::string const& event : host.events)
            EXPECT_EQ(event.find("lock("), std::string::npos) << event;
    }
}

TEST_F(CommandWrites, ReturnTheStoresStatusIfTheRebuildFails)
{
    commands.otherwise = "";
    plugin.initialize();
    host.addNewNodeStatus = 1;
    host.logCalls.clear();
    for (unsigned char const status :
         {static_cast<unsigned char>(0), static_cast<unsigned char>(7)}) {
        host.setterStatus = status;
        EXPECT_EQ(os->setProperty(75, IC::PropertyValue(IC::Number(0U), true)).getStatus(), status);
        EXPECT_EQ(
            os->setProperty(74, IC::PropertyValue("LocalGroupAdd,GroupName:CMPI_string:g", true))
                .getStatus(),
            status);
    }
    EXPECT_FALSE(host.messages(6000).empty()); // the refusals
}

} // namespace node_classes_test
