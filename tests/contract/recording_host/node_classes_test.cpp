// What the four node classes add to a plain node: a few messages, no data.

#include "tests/contract/recording_host/Loaded.h"
#include "tests/support/SystemLog.h"

#include <filesystem>
#include <memory>

namespace node_classes_test
{

class NodeClasses : public Loaded
{
};

TEST_F(NodeClasses, PassTheirArgumentsOnAndLogTheirLives)
{
    for (std::string const name : {"OsNode", "UserNode", "GroupNode", "LogEntryNode"}) {
        host.events.clear();
        host.logCalls.clear();
        std::unique_ptr<IC::MutableNode>(construct(name)).reset();
        EXPECT_EQ(
            host.events,
            (Lines{"MutableNode(11, 12, [13 14], 15, 16)", "log: " + name + "::" + name + ": entry",
                   "log: " + name + "::~" + name + ": entry", "~MutableNode()"}));
        ASSERT_EQ(host.logCalls.size(), 4U);
        for (LogCall const& call : host.logCalls) {
            EXPECT_EQ(call.file, "OsSwMI");
            EXPECT_EQ(call.category, "Veltrix.IC.MI.OsSwMI");
            EXPECT_EQ(call.level, 3000);
        }
    }
}

// No class handles this id: it is only stored and read back.
constexpr unsigned int plainProperty = 4711;

TEST_F(NodeClasses, LogEntryAndExitAroundTheFrameworksReadAndStore)
{
    struct {
        char const* name;
        std::string read;  // the beginning of the two messages of a read
        std::string write; // and of a write
    } const classes[] = {
        {"OsNode", "OsNode::getProperty", "OsNode::setProperty"},
        // Contract: a user node's read logs under its constructor's name.
        {"UserNode", "UserNode::UserNode", "UserNode::setProperty"},
        {"GroupNode", "GroupNode::getProperty", ""},
        {"LogEntryNode", "LogEntryNode::getProperty", "LogEntryNode::setProperty"}};
    for (auto const& [name, read, write] : classes) {
        std::unique_ptr<IC::MutableNode> const node(construct(name));
        host.events.clear();
        IC::PropertyValue value(IC::PropertyValue::EmptyKind, true);
        IC::Error const answer = node->getProperty(plainProperty, value);
        EXPECT_EQ(static_cast<std::string>(answer), "status 1, not set");
        EXPECT_EQ(host.events, (Lines{"log: " + read + ": entry", "log: " + read + ": exit"}));

        constexpr unsigned char statuses[] = {0, 7};
        for (unsigned char const status : statuses) {
            host.events.clear();
            host.setterStatus = status;
            EXPECT_EQ(node->setProperty(plainProperty, {"x", true}).getStatus(), status);
            Lines expected{"setProperty(4711, text x true)"};
            if (!write.empty())
                expected = {"log: " + write + ": entry", expected[0], "log: " + write + ": exit"};
            EXPECT_EQ(host.events, expected);
        }
        EXPECT_EQ(text(*node, plainProperty), "x");
    }
}

constexpr char const* success = "Error(0, empty 0, \"\")";
constexpr char const* countSuccess = "Error(0, unsigned 0, \"\")";
constexpr char const* failure = "Error(1, empty 0, \"\")";

TEST_F(NodeClasses, MakeOneStatusForAPropertyThatTheyReadThemselves)
{
    // The log cannot be counted here, and the index of the entry's node is 16.
    struct {
        char const* name;
        unsigned int id;
        char const* status;
    } const reads[] = {{"OsNode", 144, success},       {"OsNode", 191, success},
                       {"UserNode", 51, countSuccess}, {"GroupNode", 51, countSuccess},
                       {"LogEntryNode", 89, success},  {"LogEntryNode", 81, failure},
                       {"LogEntryNode", 79, failure}};
    for (auto const& [name, id, status] : reads) {
        std::unique_ptr<IC::MutableNode> const node(construct(name));
        host.errors.clear();
        IC::PropertyValue value(IC::PropertyValue::EmptyKind, true);
        node->getProperty(id, value);
        EXPECT_EQ(host.errors, Lines{status}) << name << ' ' << id;
    }
}

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

TEST_F(CommandWrites, OfAUserReturnTheStoresStatusIfTheActionFails)
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

TEST_F(NodeClasses, MakeOneSuccessStatusForALogEntryAndTakeNoLock)
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
