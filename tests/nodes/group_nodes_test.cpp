#include "TestPaths.h"
#include "nodes/GroupNode.h"

#include "nodes/nodeValues.h"
#include "tests/interpose/Libc.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/Frame.h"
#include "tests/support/Lines.h"
#include "tests/support/MutexCalls.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <grp.h>
#include <new>
#include <set>
#include <string>
#include <vector>

namespace group_nodes_test
{

/** A machine with two groups to report, one of them empty, and one that is not reported. */
class GroupNodes : public testing::Test
{
protected:
    GroupNodes()
    {
        files.write("/etc/login.defs", "GID_MIN 500\nGID_MAX 60000\n");
        files.write("/etc/passwd", "anna:x:1000:500:::\nben:x:1001:500:::\n");
        files.write("/etc/group", "root:x:0:\ntty:x:5:anna\nteam:x:500:ben,carl\n");
    }

    std::vector<IC::MutableNode*> groups() const
    {
        return frame.ofType(51);
    }

    FakeFiles const files;
    Frame frame;
};

TEST_F(GroupNodes, HoldFourProperties)
{
    frame.createGroupNodes(false);
    ASSERT_EQ(groups().size(), 2U);
    IC::MutableNode const& team = *groups()[1];
    EXPECT_EQ(team.getProperties().size(), 4U);
    EXPECT_EQ(storedValue(team, 108), "text team true");
    EXPECT_EQ(storedValue(team, 89), "number 500 true");
    EXPECT_EQ(storedValue(team, 165), "texts anna,ben,carl true");
    EXPECT_EQ(storedValue(team, 51), "number 2 true");
    EXPECT_EQ(storedValue(*groups()[0], 165), "texts  true");
    EXPECT_TRUE(groups()[0]->getProperties().at(165).getTexts().empty());
}

TEST_F(GroupNodes, AreSetUpInTheOrderThatHostsSee)
{
    files.write("/etc/group", "root:x:0:\n");
    NodeCalls const calls;
    frame.createGroupNodes(false);
    EXPECT_EQ(calls.calls, (Lines{"setStatus(1)", "setDescription(Group)", "setProperty(108)",
                                  "setProperty(89)", "setProperty(165)", "setProperty(51)"}));
}

TEST_F(GroupNodes, LogTheirNumberAndEachNameAndId)
{
    Recording const log;
    frame.createGroupNodes(false);
    Lines remarks;
    for (LogRecord const& record : log.records())
        if (!record.trace && record.file == "OsSwMI" && record.function == "createGroupNodes") {
            EXPECT_EQ(record.level, 3000);
            EXPECT_EQ(record.category, "Veltrix.IC.MI.OsSwMI");
            remarks.push_back(record.text);
        }
    EXPECT_EQ(remarks, (Lines{"createGroupNodes: entry", "groups.size() = 2", "Name = root",
                              "Id = 0", "Name = team", "Id = 500", "createGroupNodes: exit"}));
}

TEST_F(GroupNodes, LogTheirNameAndIdBeforeTheirProperties)
{
    files.write("/etc/group", "root:x:0:\n");
    NodeCalls const calls;
    struct CallsAtId : mihost::LogSink {
        explicit CallsAtId(NodeCalls const& of) : noted(of) {}
        void write(mihost::LogMessage const& message) override
        {
            if (message.text == "Id = 0")
                count = noted.calls.size();
        }
        NodeCalls const& noted;
        std::size_t count = 0;
    } sink(calls);
    mihost::setLogSink(&sink);
    frame.createGroupNodes(false);
    mihost::setLogSink(nullptr);
    EXPECT_EQ(sink.count, 2U); // status and description
}

TEST_F(GroupNodes, AreBuiltUnderTheLockThatTheyShareWithUsers)
{
    Lines steps;
    MutexCalls mutexes;
    mutexes.onLock = [&steps](NQ::Mutex const& mutex, unsigned long timeout) {
        steps.push_back((&mutex == &IC::OSSWMI::myuserlock ? "lock shared " : "lock own ") +
                        std::to_string(timeout));
    };
    mutexes.onUnlock = [&steps](NQ::Mutex const& mutex) {
        steps.emplace_back(&mutex == &IC::OSSWMI::myuserlock ? "unlock shared" : "unlock own");
        return 0;
    };
    frame.createGroupNodes(false);
    EXPECT_EQ(steps, (Lines{"lock shared 4294967295", "lock own 4294967295", "unlock own",
                            "unlock shared"}));
}

TEST_F(GroupNodes, ReleaseTheLocksWhenAnExceptionPasses)
{
    libc::hooks().getgrent = []() -> group* { throw std::bad_alloc(); };
    int held = 0;
    MutexCalls mutexes;
    mutexes.onLock = [&held](NQ::Mutex const&, unsigned long) { ++held; };
    mutexes.onUnlock = [&held](NQ::Mutex const&) {
        --held;
        return 0;
    };
    EXPECT_THROW(frame.createGroupNodes(false), std::bad_alloc);
    EXPECT_EQ(held, 0);
}

TEST_F(GroupNodes, NeitherSetNorClearTheUserBuildersFlag)
{
    struct FlagsSeen : mihost::LogSink {
        void write(mihost::LogMessage const&) override
        {
            seen.insert(IC::OSSWMI::MI_call);
        }
        std::set<bool> seen;
    };
    for (bool const before : {false, true}) {
        FlagsSeen sink;
        IC::OSSWMI::MI_call = before;
        mihost::setLogSink(&sink);
        frame.createGroupNodes(false);
        mihost::setLogSink(nullptr);
        EXPECT_EQ(sink.seen, std::set<bool>{before});
    }
    IC::OSSWMI::MI_call = false;
}

TEST_F(GroupNodes, AreNoneOnAnEmptyDatabase)
{
    files.write("/etc/group", "");
    Recording const log;
    frame.createGroupNodes(false);
    EXPECT_TRUE(groups().empty());
    EXPECT_TRUE(log.has("groups.size() = 0", 3000));
}

TEST_F(GroupNodes, AnswerTheirCountWithoutALock)
{
    frame.createGroupNodes(false);
    Lines locked;
    MutexCalls mutexes;
    mutexes.onLock = [&locked](NQ::Mutex const& mutex, unsigned long) {
        locked.emplace_back(&mutex == &IC::OSSWMI::myuserlock ? "shared" : "the listing's");
    };
    IC::PropertyValue value = IC::values::emptyValue();
    groups()[0]->getProperty(51, value);
    EXPECT_EQ(locked, Lines{"the listing's"});
}

TEST_F(GroupNodes, LogEveryReadUnderTheFramesName)
{
    frame.createGroupNodes(false);
    for (unsigned int const id : {51U, 108U}) {
        Recording const log;
        IC::PropertyValue value = IC::values::emptyValue();
        groups()[0]->getProperty(id, value);
        Lines const texts = log.texts(3000);
        ASSERT_GE(texts.size(), 2U);
        EXPECT_EQ(texts.front(), "GroupNode::getProperty: entry");
        EXPECT_EQ(texts[1], id == 51 ? "getGroupInfo: entry" : "GroupNode::getProperty: exit");
        EXPECT_EQ(texts.back(), "GroupNode::getProperty: exit");
        for (LogRecord const& record : log.records())
            if (record.function == "getProperty") {
                EXPECT_EQ(record.file, "OsSwMI");
                EXPECT_EQ(record.category, "Veltrix.IC.MI.OsSwMI");
            }
    }
}

TEST_F(GroupNodes, LogTheSourceLineOfEachMessage)
{
    Lines const source = linesOf(contentOf(TESTS_DIR "/../nodes/GroupNode.cpp"));
    Recording const log;
    frame.createGroupNodes(false);
    int found = 0;
    for (LogRecord const& record : log.records())
        for (std::string const text : {"groups.size() = ", "Name = ", "Id = "})
            if (record.category == "Veltrix.IC.MI.OsSwMI" && record.text.rfind(text, 0) == 0) {
                ++found;
                EXPECT_NE(
                    source.at(static_cast<std::size_t>(record.line - 1)).find('"' + text + '"'),
                    std::string::npos)
                    << record.text << " from line " << record.line;
            }
    EXPECT_EQ(found, 2 * (1 + 2 + 2)); // both operations; two groups
}

} // namespace group_nodes_test
