// What the builder of log entries reads from them and from the log reader.

#include "nodes/LogEntryNode.h"
#include "sysdata/logInfo_linux.h"
#include "tests/interpose/Real.h"
#include "tests/interposed/StandIns.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/Frame.h"
#include "tests/support/Lines.h"
#include "tests/support/Shown.h"
#include "tests/support/SystemLog.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

namespace
{

struct Asked {
    Lines reads;
    std::vector<void const*> values;
    Lines fetches;
};

Asked& asked()
{
    static Asked inUse;
    return inUse;
}

} // namespace

IC::Error IC::LogEntryNode::getProperty(unsigned int id, PropertyValue& value) const
{
    static auto* const real =
        interpose::real<Error(LogEntryNode const*, unsigned int, PropertyValue&)>();
    asked().reads.push_back(std::to_string(id) + " " + shown(value));
    asked().values.push_back(&value);
    return real(this, id, value);
}

void NQ::logInfo::getLog(unsigned int line, char* buffer, int length)
{
    static auto* const real = interpose::real(&logInfo::getLog);
    asked().fetches.push_back(std::to_string(line) + " " + std::to_string(length));
    real(this, line, buffer, length);
}

namespace
{

class LogEntryBuild : public testing::Test
{
protected:
    LogEntryBuild()
    {
        useZone("UTC0");
        commands.answers = systemLog::answers({"Nov 20 10:11:12 host"});
        frame.createLogNodes();
        standIns() = {};
        asked() = {};
        frame.createLogEntryNodes(false);
    }

    static Lines readers(int count)
    {
        Lines lives;
        for (int i = 0; i < count; ++i)
            lives.insert(lives.end(), {"logInfo made", "logInfo gone"});
        return lives;
    }

    FakeCommands commands;
    Frame frame;
};

TEST_F(LogEntryBuild, ReadsMessageAndTimeIntoOneValue)
{
    EXPECT_EQ(asked().reads, (Lines{"81 empty  true", "79 text *host* true"}));
    ASSERT_EQ(asked().values.size(), 2U);
    EXPECT_EQ(asked().values[0], asked().values[1]);
    EXPECT_EQ(asked().fetches, (Lines{"1 511", "1 511"})); // at most 511 characters
    // No sub-seconds.
    EXPECT_EQ(standIns().dates, (std::vector<std::pair<long, unsigned short>>{{1795169472, 0}}));
}

TEST_F(LogEntryBuild, MakesAReaderForTheCountAndForEachRead)
{
    EXPECT_EQ(standIns().lives, readers(3));
    for (unsigned int const id : {81U, 89U, 79U, 4711U}) {
        standIns().lives.clear();
        IC::PropertyValue value("", true);
        frame.logEntryNodes_.at(0)->getProperty(id, value);
        EXPECT_EQ(standIns().lives, readers(1)) << id;
    }
}

} // namespace
