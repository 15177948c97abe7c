#include "mihost/cli/plugin/Phases.h"

#include "host/VXLogger.h"
#include "mihost/cli/plugin/Timing.h"

#include <gtest/gtest.h>

namespace phases_test
{

using mihost::LogMessage;

void say(mihost::LogSink& sink, char const* function, std::string const& text,
         LogMessage::Operation operation = LogMessage::Operation::Log)
{
    std::string const category;
    sink.write({operation, function, "OsSwMI", 1, category, 3000, nullptr, 0, 0, text});
}

class Notes : public mihost::PhaseListener
{
public:
    void phaseBegins(mihost::Phase const& phase) override
    {
        heard.push_back("+" + std::string(phase.name));
    }
    void phaseEnds(mihost::Phase const& phase) override
    {
        heard.push_back("-" + std::string(phase.name));
    }

    std::vector<std::string> heard;
};

TEST(PhaseSink, SeesABuildersEntryAndExitOnceEach)
{
    Notes notes;
    mihost::PhaseSink sink({&notes});
    for (auto const operation : {LogMessage::Operation::Log, LogMessage::Operation::Trace})
        say(sink, "createDriverNodes", "createDriverNodes: entry", operation);
    say(sink, "getDriverInfo", "getDriverInfo: entry");
    say(sink, "createDriverNodes", "something else");
    say(sink, "createDriverNodes", "createDriverNodes: exit");
    EXPECT_EQ(notes.heard, (std::vector<std::string>{"+drivers", "-drivers"}));
}

TEST(PhaseSink, KnowsTheBuildersInTheirOrder)
{
    std::vector<std::string> functions;
    for (auto const& phase : mihost::phases())
        functions.emplace_back(phase.function);
    EXPECT_EQ(functions, (std::vector<std::string>{
                             "createOsSwNodes", "createRootNode", "createComputerNodes",
                             "createOsNodes", "createDriverNodes", "createUserNodes",
                             "createGroupNodes", "createLogNodes", "createLogEntryNodes"}));
}

TEST(Timing, HasARowForEachPhaseAndASum)
{
    mihost::Timing timing;
    timing.begin("load");
    timing.end();
    timing.phaseBegins(mihost::phases()[4]);
    timing.phaseEnds(mihost::phases()[4]);
    auto const json = toJson(timing.rows());
    ASSERT_EQ(json["timing"].size(), 2U);
    EXPECT_EQ(json["timing"][0]["phase"], "load");
    EXPECT_EQ(json["timing"][1]["phase"], "drivers");
    EXPECT_EQ(json["timing"][1]["commands"], 0);

    std::vector<mihost::Timing::Row> const rows = {{"load", std::chrono::milliseconds(2), 0},
                                                   {"drivers", std::chrono::milliseconds(3), 4}};
    EXPECT_EQ(mihost::timingText(rows), "load                      2.000 ms      0 commands\n"
                                        "drivers                   3.000 ms      4 commands\n"
                                        "total                     5.000 ms      4 commands\n");
}

class Counter : public mihost::LogSink
{
public:
    void write(LogMessage const&) override
    {
        ++count;
    }

    int count = 0;
};

TEST(SinkGroup, PassesEachMessageToAllOfItsSinks)
{
    Counter first, second;
    mihost::SinkGroup group;
    group.add(first);
    group.add(second);
    say(group, "f", "f: entry");
    group.remove(first);
    say(group, "f", "f: exit");
    EXPECT_EQ(first.count, 1);
    EXPECT_EQ(second.count, 2);
}

TEST(SinkGroup, IsTheLogsSinkUntilItIsDestroyed)
{
    auto const log = [] {
        VXLog::VXLogger::logLevelMessage("f", "unit", 1, "category", 3000, nullptr, 0, 0, "text");
    };
    Counter counter;
    {
        mihost::SinkGroup group;
        log();
        group.add(counter);
        log();
    }
    log();
    EXPECT_EQ(counter.count, 1);
}

} // namespace phases_test
