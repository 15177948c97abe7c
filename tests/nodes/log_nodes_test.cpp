#include "nodes/LogEntryNode.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/Frame.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"
#include "tests/support/SystemLog.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <string>
#include <typeinfo>
#include <vector>

namespace log_nodes_test
{

using Ids = std::vector<unsigned int>;

// 2026-11-20 10:11:00 UTC, the minute of all the log lines below.
constexpr long firstStamp = 1795169460;

class LogNodes : public testing::Test
{
protected:
    LogNodes()
    {
        useZone("UTC0");
        haveLines(0);
    }

    /** Line n of the log says "message n", the seconds of its stamp being n modulo 60. */
    void haveLines(unsigned int count)
    {
        commands.answers = systemLog::answers(systemLog::messages(count));
    }

    void build()
    {
        frame.createLogNodes();
        frame.createLogEntryNodes(false);
    }

    std::vector<IC::MutableNode*> entries() const
    {
        return frame.ofType(47);
    }

    /** A live read, as status and value; the value starts as a text "before". */
    static std::string read(IC::MutableNode const& node, unsigned int id)
    {
        IC::PropertyValue value("before", true);
        IC::Error const error = node.getProperty(id, value);
        return std::to_string(error.getStatus()) + " " + shown(value);
    }

    FakeCommands commands;
    Frame frame;
};

TEST_F(LogNodes, HaveOneLogUnderTheOperatingSystem)
{
    frame.nextNodeId_ = 40;
    frame.createLogNodes();
    ASSERT_EQ(frame.ofType(35).size(), 1U);
    IC::MutableNode const& log = *frame.ofType(35)[0];
    EXPECT_EQ(log.getNodeId(), 40U);
    EXPECT_EQ(log.getLinkedId(), frame.osNode_->getNodeId());
    EXPECT_EQ(log.getMIIds(), Ids{7});
    EXPECT_EQ(log.getIndex(), 0U);
    EXPECT_EQ(log.getStatus(), 1U);
    EXPECT_EQ(log.getDescription(), "OS Log");
    EXPECT_TRUE(typeid(log) == typeid(IC::MutableNode));
    EXPECT_EQ(frame.nextNodeId_, 41U);
    EXPECT_EQ(*frame.nodeIds_, Ids{40});
    EXPECT_EQ(frame.currentNode_, &log);
    EXPECT_EQ(frame.logNode_, &log);
    EXPECT_TRUE(frame.published.empty());
}

TEST_F(LogNodes, HaveSixPropertiesOnTheLog)
{
    frame.createLogNodes();
    EXPECT_EQ(frame.logNode_->getProperties().size(), 6U);
    EXPECT_EQ(storedValue(*frame.logNode_, 123), "enumeration 1 true");
    EXPECT_EQ(storedValue(*frame.logNode_, 125), "numbers 0,1,24 true");
    EXPECT_EQ(storedValue(*frame.logNode_, 37), "number 0 true");
    EXPECT_EQ(storedValue(*frame.logNode_, 108), "text OS Log true");
    EXPECT_EQ(storedValue(*frame.logNode_, 114), "enumeration 2 true");
    EXPECT_EQ(storedValue(*frame.logNode_, 84), "text *string LogData* true");
}

TEST_F(LogNodes, SetTheLogUpInTheOrderThatHostsSee)
{
    NodeCalls const calls;
    frame.createLogNodes();
    EXPECT_EQ(calls.calls, (Lines{"setStatus(1)", "setDescription(OS Log)", "setProperty(123)",
                                  "setProperty(125)", "setProperty(37)", "setProperty(108)",
                                  "setProperty(114)", "setProperty(84)"}));
}

TEST_F(LogNodes, LogOnlyEntryAndExitOfTheLogsBuilder)
{
    Recording const recording;
    frame.createLogNodes();
    EXPECT_EQ(recording.texts(3000), (Lines{"createLogNodes: entry", "createLogNodes: exit"}));
    EXPECT_EQ(recording.records().front().category, "Veltrix.IC.MI.OsSwMI");
    EXPECT_EQ(recording.records().front().file, "OsSwMI");
    EXPECT_TRUE(commands.ran.empty());
}

TEST_F(LogNodes, HaveOneEntryForEachLineNewestFirst)
{
    haveLines(3);
    frame.createLogNodes();
    frame.nextNodeId_ = 60;
    frame.createLogEntryNodes(false);
    ASSERT_EQ(entries().size(), 3U);
    for (unsigned int i = 0; i < 3; ++i) {
        IC::MutableNode const& entry = *entries()[i];
        EXPECT_EQ(entry.getNodeId(), 60 + i);
        EXPECT_EQ(entry.getLinkedId(), frame.logNode_->getNodeId());
        EXPECT_EQ(entry.getMIIds(), Ids{7});
        EXPECT_EQ(entry.getIndex(), i + 1);
        EXPECT_EQ(entry.getStatus(), 1U);
        EXPECT_EQ(entry.getDescription(), "OS LogEntry");
        EXPECT_TRUE(typeid(entry) == typeid(IC::LogEntryNode));
        EXPECT_EQ(frame.logEntryNodes_[i], &entry);
    }
    EXPECT_EQ(frame.logEntryNodes_.size(), 3U);
    EXPECT_EQ(frame.nextNodeId_, 63U);
    EXPECT_EQ(*frame.nodeIds_, (Ids{9, 60, 61, 62}));
    EXPECT_EQ(frame.currentNode_, entries().back());
    EXPECT_TRUE(frame.published.empty());
}

TEST_F(LogNodes, StoreIndexMessageAndTimeOnAnEntry)
{
    haveLines(3);
    build();
    ASSERT_EQ(entries().size(), 3U);
    EXPECT_EQ(entries()[0]->getProperties().size(), 3U);
    EXPECT_EQ(storedValue(*entries()[0], 89), "number 1 true");
    EXPECT_EQ(storedValue(*entries()[0], 81), "text *message 3* true");
    EXPECT_EQ(storedValue(*entries()[0], 79), "date " + std::to_string(firstStamp + 3) + " true");
    EXPECT_EQ(storedValue(*entries()[2], 89), "number 3 true");
    EXPECT_EQ(storedValue(*entries()[2], 81), "text *message 1* true");
    EXPECT_EQ(storedValue(*entries()[2], 79), "date " + std::to_string(firstStamp + 1) + " true");
}

TEST_F(LogNodes, SetAnEntryUpInTheOrderThatHostsSee)
{
    haveLines(1);
    frame.createLogNodes();
    NodeCalls const calls;
    frame.createLogEntryNodes(false);
    EXPECT_EQ(calls.calls, (Lines{"setStatus(1)", "setDescription(OS LogEntry)", "setProperty(89)",
                                  "setProperty(81)", "setProperty(79)"}));
}

TEST_F(LogNodes, RunTheCommandsOfAnEntryInOrder)
{
    haveLines(1);
    frame.createLogNodes();
    frame.createLogEntryNodes(false);
    std::string const wc = systemLog::count;
    std::string const sed = systemLog::line(1);
    EXPECT_EQ(commands.ran, (Lines{wc, wc, wc, wc, sed, wc, wc, wc, sed, "date"}));
}

TEST_F(LogNodes, LogTheStepsOfAnEntryInOrder)
{
    haveLines(1);
    frame.createLogNodes();
    Recording const recording;
    frame.createLogEntryNodes(false);
    Lines nodesOnly;
    Lines functions;
    for (LogRecord const& record : recording.records()) {
        if (record.trace || record.category != "Veltrix.IC.MI.OsSwMI")
            continue;
        nodesOnly.push_back(record.text);
        functions.push_back(record.function);
        EXPECT_EQ(record.file, "OsSwMI");
    }
    EXPECT_EQ(functions,
              (Lines{"createLogEntryNodes", "LogEntryNode", "setProperty", "setProperty",
                     "getProperty", "getProperty", "setProperty", "setProperty", "getProperty",
                     "getProperty", "setProperty", "setProperty", "createLogEntryNodes"}));
    EXPECT_EQ(nodesOnly,
              (Lines{"createLogEntryNodes: entry", "LogEntryNode::LogEntryNode: entry",
                     "LogEntryNode::setProperty: entry", "LogEntryNode::setProperty: exit",
                     "LogEntryNode::getProperty: entry", "LogEntryNode::getProperty: exit",
                     "LogEntryNode::setProperty: entry", "LogEntryNode::setProperty: exit",
                     "LogEntryNode::getProperty: entry", "LogEntryNode::getProperty: exit",
                     "LogEntryNode::setProperty: entry", "LogEntryNode::setProperty: exit",
                     "createLogEntryNodes: exit"}));
    EXPECT_EQ(recording.texts(6000), Lines{});
}

TEST_F(LogNodes, HaveAsManyEntriesAsLinesUpToFifty)
{
    struct Case {
        unsigned int lines;
        std::size_t nodes;
    };
    for (Case const& example :
         {Case{0, 0}, {1, 1}, {3, 3}, {49, 49}, {50, 50}, {51, 50}, {120, 50}}) {
        Frame other;
        haveLines(example.lines);
        other.createLogNodes();
        other.createLogEntryNodes(false);
        EXPECT_EQ(other.ofType(47).size(), example.nodes) << example.lines;
        EXPECT_EQ(other.logEntryNodes_.size(), example.nodes) << example.lines;
    }
}

TEST_F(LogNodes, ShowTheLastFiftyOfALongLog)
{
    haveLines(120);
    build();
    ASSERT_EQ(entries().size(), 50U);
    for (unsigned int i = 0; i < 50; ++i) {
        EXPECT_EQ(entries()[i]->getIndex(), i + 1);
        EXPECT_EQ(storedValue(*entries()[i], 81),
                  "text *message " + std::to_string(120 - i) + "* true");
    }
}

TEST_F(LogNodes, HaveNoEntriesWhenTheLogCannotBeCounted)
{
    commands.answers[systemLog::count] = "";
    build();
    EXPECT_TRUE(entries().empty());
    commands.answers.erase(systemLog::count);
    frame.createLogEntryNodes(false);
    EXPECT_TRUE(entries().empty());
}

TEST_F(LogNodes, LeaveTheTimeUnsetIfALineHasNone)
{
    haveLines(2);
    commands.answers[systemLog::line(2)] = "kernel: no stamp at all here\n";
    build();
    ASSERT_EQ(entries().size(), 2U);
    EXPECT_EQ(storedValue(*entries()[0], 81), "text * at all here* true");
    EXPECT_EQ(storedValue(*entries()[0], 79), "unset");
    EXPECT_EQ(read(*entries()[0], 79), "1 text before true");
    EXPECT_NE(storedValue(*entries()[1], 79), "unset");
}

TEST_F(LogNodes, LeaveMessageAndTimeUnsetIfTheLogShrinks)
{
    haveLines(0);
    commands.first[systemLog::count] = {"2 f\n"};
    commands.answers[systemLog::line(0)] = "";
    build();
    ASSERT_EQ(entries().size(), 2U);
    EXPECT_EQ(storedValue(*entries()[0], 81), "text ** true"); // one past the oldest is accepted
    EXPECT_EQ(storedValue(*entries()[1], 81), "unset");
    EXPECT_EQ(storedValue(*entries()[1], 79), "unset");
    EXPECT_EQ(storedValue(*entries()[1], 89), "number 2 true");
}

TEST_F(LogNodes, ReadTheCurrentLineWhileTheStoredCopiesStay)
{
    haveLines(3);
    build();
    haveLines(5);
    ASSERT_EQ(entries().size(), 3U);
    IC::MutableNode const& newest = *entries()[0];
    EXPECT_EQ(read(newest, 81), "0 text *message 5* true");
    EXPECT_EQ(read(newest, 79), "0 date " + std::to_string(firstStamp + 5) + " true");
    EXPECT_EQ(read(newest, 89), "0 number 1 true");
    EXPECT_EQ(storedValue(newest, 81), "text *message 3* true");
    EXPECT_EQ(storedValue(newest, 79), "date " + std::to_string(firstStamp + 3) + " true");
}

TEST_F(LogNodes, RunNoCommandForTheIndexAndForStoredProperties)
{
    haveLines(1);
    build();
    commands.ran.clear();
    ASSERT_EQ(entries().size(), 1U);
    EXPECT_EQ(read(*entries()[0], 89), "0 number 1 true");
    EXPECT_EQ(read(*entries()[0], 500), "1 text before true");
    EXPECT_TRUE(commands.ran.empty());
}

TEST_F(LogNodes, AnswerOtherPropertiesFromTheStore)
{
    haveLines(1);
    build();
    ASSERT_EQ(entries().size(), 1U);
    EXPECT_EQ(read(*entries()[0], 108), "1 text before true");
    entries()[0]->setProperty(108, IC::PropertyValue("mine", true));
    EXPECT_EQ(read(*entries()[0], 108), "0 text mine true");
}

TEST_F(LogNodes, FailAReadBeyondTheLogAndKeepTheValue)
{
    haveLines(3);
    build();
    haveLines(0);
    ASSERT_EQ(entries().size(), 3U);
    Recording const recording;
    EXPECT_EQ(read(*entries()[2], 81), "1 text before true");
    EXPECT_EQ(read(*entries()[2], 79), "1 text before true");
    EXPECT_EQ(recording.texts(6000), (Lines{"Invalid index: getMaxLine()=0, Index=3",
                                            "Invalid index: getMaxLine()=0, logIndex=3"}));
}

TEST_F(LogNodes, FailWithAnEmptyText)
{
    haveLines(3);
    build();
    haveLines(0);
    ASSERT_EQ(entries().size(), 3U);
    IC::PropertyValue value("before", true);
    IC::Error const error = entries()[2]->getProperty(81, value);
    EXPECT_EQ(static_cast<std::string>(error),
              static_cast<std::string>(IC::Error(1, IC::Number(IC::Number::EmptyKind), "")));
}

TEST_F(LogNodes, StoreWhatIsWrittenAndKeepTheLog)
{
    haveLines(1);
    build();
    ASSERT_EQ(entries().size(), 1U);
    commands.ran.clear();
    EXPECT_EQ(entries()[0]->setProperty(81, IC::PropertyValue("mine", true)).getStatus(), 0);
    EXPECT_TRUE(commands.ran.empty());
    EXPECT_EQ(storedValue(*entries()[0], 81), "text mine true");
    EXPECT_EQ(read(*entries()[0], 81), "0 text *message 1* true");
}

TEST_F(LogNodes, LogAnEntrysDestruction)
{
    haveLines(1);
    build();
    ASSERT_EQ(entries().size(), 1U);
    Recording const recording;
    frame.deleteNode(entries()[0]);
    EXPECT_EQ(recording.texts(), Lines{"LogEntryNode::~LogEntryNode: entry"});
}

TEST_F(LogNodes, AreReplacedOnARefresh)
{
    haveLines(2);
    build();
    auto const old = frame.logEntryNodes_;
    IC::MutableNode const* const log = frame.logNode_;
    unsigned int const next = frame.nextNodeId_;
    haveLines(3);
    frame.createLogEntryNodes(true);
    EXPECT_EQ(frame.deleted, old);
    ASSERT_EQ(entries().size(), 3U);
    EXPECT_EQ(frame.published, frame.logEntryNodes_);
    for (unsigned int i = 0; i < 3; ++i) {
        EXPECT_EQ(entries()[i], frame.logEntryNodes_[i]);
        EXPECT_EQ(entries()[i]->getNodeId(), next + i);
        EXPECT_EQ(entries()[i]->getIndex(), i + 1);
        EXPECT_EQ(storedValue(*entries()[i], 81),
                  "text *message " + std::to_string(3 - i) + "* true");
    }
    EXPECT_EQ(frame.logNode_, log);
}

TEST_F(LogNodes, NoteTheirIdsOnARefreshToo)
{
    haveLines(1);
    build();
    EXPECT_EQ(*frame.nodeIds_, (Ids{9, 10}));
    frame.createLogEntryNodes(true);
    EXPECT_EQ(*frame.nodeIds_, (Ids{9, 10, 11}));
}

TEST_F(LogNodes, AreAllDeletedAndNoneMadeWhenTheLogWasCleared)
{
    haveLines(3);
    build();
    auto const old = frame.logEntryNodes_;
    haveLines(0);
    frame.createLogEntryNodes(true);
    EXPECT_EQ(frame.deleted, old);
    EXPECT_TRUE(frame.logEntryNodes_.empty());
    EXPECT_TRUE(entries().empty());
    EXPECT_TRUE(frame.published.empty());
    EXPECT_EQ(frame.ofType(35).size(), 1U);
}

TEST_F(LogNodes, ArePublishedAsSoonAsEachIsComplete)
{
    haveLines(2);
    frame.createLogNodes();
    Recording const recording;
    frame.createLogEntryNodes(true);
    Lines order;
    for (std::string const& text : recording.texts())
        if (text == "LogEntryNode::LogEntryNode: entry" || text == "publishNode: entry")
            order.push_back(text);
    EXPECT_EQ(order, (Lines{"LogEntryNode::LogEntryNode: entry", "publishNode: entry",
                            "LogEntryNode::LogEntryNode: entry", "publishNode: entry"}));
    ASSERT_EQ(frame.published.size(), 2U);
    EXPECT_NE(storedValue(*frame.published[0], 79), "unset");
}

TEST_F(LogNodes, AreAllMadeEvenIfTheHostRefusesThem)
{
    haveLines(2);
    frame.createLogNodes();
    frame.setLoadCallBack(
        [](IC::Node* const&, void const*) {
            return IC::Error(1, IC::Number(IC::Number::EmptyKind), "no room");
        },
        nullptr, nullptr);
    Recording const recording;
    frame.createLogEntryNodes(true);
    EXPECT_EQ(entries().size(), 2U);
    EXPECT_EQ(frame.logEntryNodes_.size(), 2U);
    EXPECT_EQ(recording.texts(6000), Lines(2, "addNewNode error = status 1: no room"));
}

TEST_F(LogNodes, AreForgottenAfterUnload)
{
    haveLines(2);
    build();
    frame.unload();
    EXPECT_TRUE(frame.logEntryNodes_.empty());
    EXPECT_TRUE(frame.deleted.empty());
}

TEST_F(LogNodes, AreNotDeletedWithoutARefresh)
{
    haveLines(2);
    build();
    frame.createLogEntryNodes(false);
    EXPECT_TRUE(frame.deleted.empty());
    EXPECT_EQ(frame.logEntryNodes_.size(), 4U);
}

struct RefusingFrame : Frame {
    IC::Error deleteNode(IC::Node* node) override
    {
        Frame::deleteNode(node);
        return {1, IC::Number(IC::Number::EmptyKind), "refused"};
    }
};

TEST_F(LogNodes, AreAllReplacedWhateverTheirDeletionReturns)
{
    RefusingFrame other;
    haveLines(3);
    other.createLogNodes();
    other.createLogEntryNodes(false);
    auto const old = other.logEntryNodes_;
    Recording const recording;
    other.createLogEntryNodes(true);
    EXPECT_EQ(other.deleted, old);
    EXPECT_EQ(other.logEntryNodes_.size(), 3U);
    EXPECT_EQ(other.published.size(), 3U);
    EXPECT_EQ(recording.texts(6000), Lines{});
}

TEST_F(LogNodes, AreDeletedBeforeTheLogIsCountedAgain)
{
    haveLines(2);
    build();
    Recording const recording;
    frame.createLogEntryNodes(true);
    Lines const said = recording.texts();
    ASSERT_GE(said.size(), 4U);
    EXPECT_EQ(Lines(said.begin(), said.begin() + 4),
              (Lines{"createLogEntryNodes: entry", "LogEntryNode::~LogEntryNode: entry",
                     "LogEntryNode::~LogEntryNode: entry", "getMaxLine: entry"}));
}

struct WatchingFrame : Frame {
    IC::Error addNewNode(IC::Node*& node) override
    {
        seen.push_back(node->getDescription() + " " + std::to_string(node->getStatus()) + " " +
                       std::to_string(node->getProperties().size()));
        return Frame::addNewNode(node);
    }
    Lines seen;
};

TEST_F(LogNodes, AreCompleteWhenTheyArePublished)
{
    WatchingFrame other;
    haveLines(2);
    other.createLogNodes();
    other.createLogEntryNodes(true);
    EXPECT_EQ(other.seen, Lines(2, "OS LogEntry 1 3"));
}

} // namespace log_nodes_test
