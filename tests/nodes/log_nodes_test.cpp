#include "nodes/LogEntryNode.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/Frame.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"
#include "tests/support/SystemLog.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <typeinfo>
#include <utility>
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

TEST_F(LogNodes, SetTheLogUpInTheOrderThatHostsSee)
{
    Recording const recording;
    NodeCalls const calls;
    frame.createLogNodes();
    EXPECT_EQ(calls.calls, (Lines{"setStatus(1)", "setDescription(OS Log)", "setProperty(123)",
                                  "setProperty(125)", "setProperty(37)", "setProperty(108)",
                                  "setProperty(114)", "setProperty(84)"}));
    EXPECT_EQ(frame.logNode_->getProperties().size(), 6U);
    EXPECT_EQ(storedValue(*frame.logNode_, 123), "enumeration 1 true");
    EXPECT_EQ(storedValue(*frame.logNode_, 125), "numbers 0,1,24 true");
    EXPECT_EQ(storedValue(*frame.logNode_, 37), "number 0 true");
    EXPECT_EQ(storedValue(*frame.logNode_, 108), "text OS Log true");
    EXPECT_EQ(storedValue(*frame.logNode_, 114), "enumeration 2 true");
    EXPECT_EQ(storedValue(*frame.logNode_, 84), "text *string LogData* true");
    EXPECT_EQ(recording.texts(3000), (Lines{"createLogNodes: entry", "createLogNodes: exit"}));
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
        EXPECT_EQ(entry.getProperties().size(), 3U);
        EXPECT_EQ(storedValue(entry, 89), "number " + std::to_string(i + 1) + " true");
        EXPECT_EQ(storedValue(entry, 81), "text *message " + std::to_string(3 - i) + "* true");
        EXPECT_EQ(storedValue(entry, 79), "date " + std::to_string(firstStamp + 3 - i) + " true");
    }
    EXPECT_EQ(frame.logEntryNodes_.size(), 3U);
    EXPECT_EQ(frame.nextNodeId_, 63U);
    EXPECT_EQ(*frame.nodeIds_, (Ids{9, 60, 61, 62}));
    EXPECT_EQ(frame.currentNode_, entries().back());
    EXPECT_TRUE(frame.published.empty());
}

TEST_F(LogNodes, ReadTheirParentsIdOnceEachAfterTakingTheirOwn)
{
    haveLines(2);
    CountingParent system(frame);
    IC::MutableNode* const realSystem = std::exchange(frame.osNode_, &system);
    frame.createLogNodes();
    frame.osNode_ = realSystem;
    EXPECT_TRUE(CountingParent::wasReadInOrder(frame.ofType(35)));
    CountingParent log(frame);
    IC::MutableNode* const realLog = std::exchange(frame.logNode_, &log);
    frame.createLogEntryNodes(false);
    frame.logNode_ = realLog;
    EXPECT_EQ(entries().size(), 2U);
    EXPECT_TRUE(CountingParent::wasReadInOrder(entries()));
}

TEST_F(LogNodes, SetAnEntryUpInTheOrderThatHostsAndTheShellSee)
{
    haveLines(1);
    frame.createLogNodes();
    NodeCalls const calls;
    frame.createLogEntryNodes(false);
    EXPECT_EQ(calls.calls, (Lines{"setStatus(1)", "setDescription(OS LogEntry)", "setProperty(89)",
                                  "setProperty(81)", "setProperty(79)"}));
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
    for (LogRecord const& record : recording.records()) {
        if (record.trace || record.category != "Veltrix.IC.MI.OsSwMI")
            continue;
        nodesOnly.push_back(record.function + " | " + record.text);
        EXPECT_EQ(record.file, "OsSwMI");
    }
    Lines expected{"createLogEntryNodes | createLogEntryNodes: entry",
                   "LogEntryNode | LogEntryNode::LogEntryNode: entry"};
    for (std::string const function :
         {"setProperty", "getProperty", "setProperty", "getProperty", "setProperty"})
        for (char const* end : {": entry", ": exit"})
            expected.push_back(function + " | LogEntryNode::" + function + end);
    expected.emplace_back("createLogEntryNodes | createLogEntryNodes: exit");
    EXPECT_EQ(nodesOnly, expected);
    EXPECT_EQ(recording.texts(6000), Lines{});
}

TEST_F(LogNodes, HaveAsManyEntriesAsLinesUpToFifty)
{
    for (unsigned int const lines : {0U, 1U, 3U, 49U, 50U, 51U, 120U}) {
        Frame other;
        haveLines(lines);
        other.createLogNodes();
        other.createLogEntryNodes(lines % 3 == 0); // 51 and 120 on a refresh
        std::vector<IC::MutableNode*> const shown = other.ofType(47);
        ASSERT_EQ(shown.size(), std::min(lines, 50U));
        EXPECT_EQ(other.logEntryNodes_.size(), shown.size());
        for (unsigned int i = 0; i < shown.size(); ++i) {
            EXPECT_EQ(shown[i]->getIndex(), i + 1);
            EXPECT_EQ(storedValue(*shown[i], 81),
                      "text *message " + std::to_string(lines - i) + "* true");
        }
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
    Recording const recording;
    build();
    ASSERT_EQ(entries().size(), 2U);
    EXPECT_EQ(recording.texts(6000),
              (Lines{"Invalid format: buffer = ", "Invalid index: getMaxLine()=0, Index=2",
                     "Invalid index: getMaxLine()=0, logIndex=2"})); // each is tried
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
    IC::MutableNode& entry = *entries().at(0);
    EXPECT_EQ(read(entry, 89), "0 number 1 true");
    EXPECT_EQ(read(entry, 500), "1 text before true");
    for (unsigned int const id : {108U, 81U}) {
        EXPECT_EQ(entry.setProperty(id, IC::PropertyValue("mine", true)).getStatus(), 0);
        EXPECT_EQ(storedValue(entry, id), "text mine true");
    }
    EXPECT_EQ(read(entry, 108), "0 text mine true");
    EXPECT_TRUE(commands.ran.empty());
    EXPECT_EQ(read(entry, 81), "0 text *message 1* true");
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

TEST_F(LogNodes, AreReplacedOnARefresh)
{
    haveLines(2);
    build();
    auto const old = frame.logEntryNodes_;
    IC::MutableNode const* const log = frame.logNode_;
    haveLines(3);
    frame.createLogEntryNodes(true);
    EXPECT_EQ(frame.deleted, old);
    ASSERT_EQ(entries().size(), 3U);
    EXPECT_EQ(frame.published, frame.logEntryNodes_);
    for (unsigned int i = 0; i < 3; ++i) {
        EXPECT_EQ(entries()[i], frame.logEntryNodes_[i]);
        EXPECT_EQ(entries()[i]->getNodeId(), 12 + i);
        EXPECT_EQ(entries()[i]->getIndex(), i + 1);
        EXPECT_EQ(storedValue(*entries()[i], 81),
                  "text *message " + std::to_string(3 - i) + "* true");
    }
    EXPECT_EQ(*frame.nodeIds_, (Ids{9, 10, 11, 12, 13, 14}));
    EXPECT_EQ(frame.logNode_, log);
}

TEST_F(LogNodes, AreAllDeletedBeforeTheLogIsCounted)
{
    haveLines(2);
    build();
    auto const old = frame.logEntryNodes_;
    haveLines(0);
    Recording const recording;
    frame.createLogEntryNodes(true);
    EXPECT_EQ(frame.deleted, old);
    EXPECT_TRUE(frame.logEntryNodes_.empty());
    EXPECT_TRUE(entries().empty());
    EXPECT_TRUE(frame.published.empty());
    EXPECT_EQ(frame.ofType(35).size(), 1U);
    Lines const said = recording.texts();
    ASSERT_GE(said.size(), 4U);
    EXPECT_EQ(Lines(said.begin(), said.begin() + 4),
              (Lines{"createLogEntryNodes: entry", "LogEntryNode::~LogEntryNode: entry",
                     "LogEntryNode::~LogEntryNode: entry", "getMaxLine: entry"}));
}

TEST_F(LogNodes, ArePublishedAsSoonAsEachIsComplete)
{
    struct : Frame {
        IC::Error addNewNode(IC::Node*& node) override
        {
            seen.push_back(std::to_string(ofType(47).size()) + " " + node->getDescription() + " " +
                           std::to_string(node->getStatus()) + " " +
                           std::to_string(node->getProperties().size()));
            return Frame::addNewNode(node);
        }
        Lines seen;
    } other;
    haveLines(2);
    other.createLogNodes();
    other.createLogEntryNodes(true);
    EXPECT_EQ(other.seen, (Lines{"1 OS LogEntry 1 3", "2 OS LogEntry 1 3"}));
}

TEST_F(LogNodes, AreForgottenAfterUnloadAndKeptWithoutARefresh)
{
    haveLines(2);
    build();
    frame.createLogEntryNodes(false);
    EXPECT_EQ(frame.logEntryNodes_.size(), 4U);
    frame.unload();
    EXPECT_TRUE(frame.logEntryNodes_.empty());
    EXPECT_TRUE(frame.deleted.empty());
}

} // namespace log_nodes_test
