#include "mihost/cli/plugin/PhaseCounter.h"

#include <gtest/gtest.h>

namespace phase_counter_test
{

using mihost::LogMessage;
using mihost::PhaseCounter;

mihost::Phase const& phaseOf(std::string const& function)
{
    for (mihost::Phase const& phase : mihost::phases())
        if (phase.function == function)
            return phase;
    throw std::runtime_error("no phase " + function);
}

bool hears(PhaseCounter& counter, char const* function, std::string const& text,
           LogMessage::Operation operation = LogMessage::Operation::Log)
{
    std::string const category;
    return counter.take({operation, function, "unit", 1, category, 3000, nullptr, 0, 0, text});
}

TEST(PhaseCounter, CountsTheModulesThatLsmodPrints)
{
    PhaseCounter counter;
    counter.begin(phaseOf("createDriverNodes"));
    EXPECT_EQ(counter.text(), "drivers");
    EXPECT_FALSE(hears(counter, "getDriverInfo", "buffer = Module   Size  Used by\n"));
    EXPECT_TRUE(hears(counter, "getDriverInfo", "buffer = ext4  1  0\n"));
    EXPECT_FALSE(hears(counter, "getDriverInfo", "buffer2 = version: 1\n"));
    EXPECT_TRUE(hears(counter, "getDriverInfo", "buffer = xfs  1  0\n"));
    EXPECT_EQ(counter.text(), "drivers 2");
}

TEST(PhaseCounter, CountsAMessageOnceThoughItIsTracedToo)
{
    PhaseCounter counter;
    counter.begin(phaseOf("createUserNodes"));
    EXPECT_TRUE(hears(counter, "UserNode", "UserNode::UserNode: entry"));
    EXPECT_FALSE(
        hears(counter, "UserNode", "UserNode::UserNode: entry", LogMessage::Operation::Trace));
    EXPECT_EQ(counter.text(), "users 1");
}

TEST(PhaseCounter, HasTheTotalThatThePluginLogs)
{
    PhaseCounter counter;
    counter.begin(phaseOf("createGroupNodes"));
    EXPECT_TRUE(hears(counter, "createGroupNodes", "groups.size() = 57"));
    EXPECT_TRUE(hears(counter, "GroupNode", "GroupNode::GroupNode: entry"));
    EXPECT_EQ(counter.text(), "groups 1/57");
}

TEST(PhaseCounter, ExpectsNoMoreLogEntriesThanThePluginShows)
{
    PhaseCounter counter;
    counter.begin(phaseOf("createLogEntryNodes"));
    EXPECT_TRUE(hears(counter, "getMaxLine", "buffer = 7000 /var/log/messages\n"));
    EXPECT_FALSE(hears(counter, "getMaxLine", "buffer = 7001 /var/log/messages\n"));
    EXPECT_TRUE(hears(counter, "LogEntryNode", "LogEntryNode::LogEntryNode: entry"));
    EXPECT_EQ(counter.text(), "log entries 1/50");
}

TEST(PhaseCounter, BeginsAgainWithEachPhase)
{
    PhaseCounter counter;
    counter.begin(phaseOf("createUserNodes"));
    hears(counter, "UserNode", "UserNode::UserNode: entry");
    counter.end();
    EXPECT_EQ(counter.text(), "");
    EXPECT_FALSE(hears(counter, "UserNode", "UserNode::UserNode: entry"));
    counter.begin(phaseOf("createGroupNodes"));
    EXPECT_EQ(counter.text(), "groups");
}

TEST(PhaseCounter, CountsNothingInAPhaseOfOneStep)
{
    PhaseCounter counter;
    counter.begin(phaseOf("createOsNodes"));
    EXPECT_FALSE(hears(counter, "getDriverInfo", "buffer = ext4\n"));
    EXPECT_EQ(counter.text(), "operating system");
}

} // namespace phase_counter_test
