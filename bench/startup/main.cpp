// bench_startup [--quick]: the plug-in's start-up against the bare cost of the commands that it
// runs.
//
// In a copy of this machine with 120 kernel modules, 10 users and a log of 1,000, 100,000 and
// 1,000,000 lines, run alternately
//
//   bare         startup_commands: runs the commands of a start, in order, with popen
//   plug-in      startup_host: loads the plug-in and initialises it
//   accelerated  startup_host_fast: the same host, linked to the accelerator
//   mihost       mihost get os: the first answer of the program, with the accelerator
//
// Prints for each log the time of each, from its start to its end, and the processor time that
// bare and plug-in take themselves, without that of their children; then what reading a log
// entry takes once the plug-in has started.

#include "TestPaths.h"
#include "bench/support/MadeUp.h"
#include "bench/support/Samples.h"
#include "bench/support/Table.h"
#include "bench/support/Timed.h"

#include <fstream>
#include <sstream>

namespace
{

constexpr int modules = 120;
constexpr int users = 10;
constexpr char const* list = "/tmp/commands";

struct Size {
    int logLines;
    std::size_t rounds;
};

constexpr Size sizes[] = {{1000, 21}, {100000, 11}, {1000000, 5}};
constexpr std::size_t quickRounds = 3;

/** What the runs of one program took, in milliseconds. */
struct Runs {
    std::vector<std::string> arguments;
    Samples whole = {};
    Samples cpu = {};
    Samples own = {};
    Samples firstRead = {};
    Samples laterReads = {};

    void once()
    {
        Timed const run = timed(arguments);
        std::istringstream output(run.output);
        double ownTime = 0;
        double first = 0;
        double later = 0;
        output >> ownTime;
        whole.push_back(run.whole);
        cpu.push_back(run.cpu);
        own.push_back(ownTime / 1000);
        if (output >> first >> later) {
            firstRead.push_back(first / 1000);
            laterReads.push_back(later / 1000);
        }
    }
};

Samples differences(Samples const& one, Samples const& other)
{
    Samples result;
    for (std::size_t i = 0; i < one.size(); ++i)
        result.push_back(one[i] - other[i]);
    return result;
}

Samples percent(Samples parts, Samples const& wholes)
{
    parts = ratios(parts, wholes);
    for (double& part : parts)
        part *= 100;
    return parts;
}

int countCommands()
{
    std::ifstream commands(list);
    int count = 0;
    for (std::string line; std::getline(commands, line);)
        ++count;
    return count;
}

struct Result {
    int logLines;
    int commands;
    Runs bare{{STARTUP_COMMANDS, list}};
    Runs plugin{{STARTUP_HOST, PLUGIN_FILE}};
    Runs fast{{STARTUP_HOST_FAST, PLUGIN_FILE}};
    Runs mihost{{MIHOST_FILE, "get", "os"}};
    Runs pluginReads{{STARTUP_HOST, PLUGIN_FILE, "5"}};
    Runs fastReads{{STARTUP_HOST_FAST, PLUGIN_FILE, "500"}};
};

Result measure(Size const& size, bool quick)
{
    madeUp::systemLog(size.logLines);
    timed({STARTUP_HOST, PLUGIN_FILE, "0", list});
    Result result{size.logLines, countCommands()};
    byTurns(quick ? quickRounds : size.rounds,
            {[&] { result.bare.once(); }, [&] { result.plugin.once(); },
             [&] { result.fast.once(); }, [&] { result.mihost.once(); }});
    byTurns(quickRounds, {[&] { result.pluginReads.once(); }, [&] { result.fastReads.once(); }});
    return result;
}

void printWhole(std::vector<Result> const& results)
{
    say("Time of a start in milliseconds, from the start of the process to its end.");
    Table table({"Log lines", "Commands", "Bare loop", "Plug-in", "Plug-in / bare",
                 "The same, processor time", "With accelerator", "Accelerated / bare",
                 "mihost get os"});
    for (Result const& result : results)
        table.add(
            {number(result.logLines), number(result.commands), shown(result.bare.whole),
             shown(result.plugin.whole), shown(ratios(result.plugin.whole, result.bare.whole), 3),
             shown(ratios(result.plugin.cpu, result.bare.cpu), 3), shown(result.fast.whole, 1),
             shown(ratios(result.fast.whole, result.bare.whole), 4),
             shown(result.mihost.whole, 1)});
    table.print();
}

void printOwn(std::vector<Result> const& results)
{
    say("Processor time of the process itself in milliseconds, user and system, without that of "
        "the commands. The bare loop's is what starting and reading commands costs its process.");
    Table table({"Log lines", "Bare loop", "Plug-in", "Plug-in - bare", "Bare, % of its time",
                 "Plug-in, % of its time", "Plug-in - bare, % of plug-in's time",
                 "With accelerator"});
    for (Result const& result : results) {
        Samples const more = differences(result.plugin.own, result.bare.own);
        table.add({number(result.logLines), shown(result.bare.own, 1), shown(result.plugin.own, 1),
                   shown(more, 1), shown(percent(result.bare.own, result.bare.whole), 1),
                   shown(percent(result.plugin.own, result.plugin.whole), 1),
                   shown(percent(more, result.plugin.whole), 1), shown(result.fast.own, 1)});
    }
    table.print();
}

void printReads(std::vector<Result> const& results)
{
    say("Reading the newest log entry's message once the plug-in has started, in milliseconds.");
    Table table({"Log lines", "Plug-in", "With accelerator, first", "With accelerator, later"});
    for (Result const& result : results)
        table.add({number(result.logLines), shown(result.pluginReads.laterReads, 2),
                   shown(result.fastReads.firstRead, 3), shown(result.fastReads.laterReads, 3)});
    table.print();
}

void measureAll(bool quick)
{
    enterCopy();
    madeUp::accounts(users);
    madeUp::modules(modules);
    std::vector<Result> results;
    for (Size const& size : sizes)
        results.push_back(measure(size, quick));
    printWhole(results);
    printOwn(results);
    printReads(results);
}

} // namespace

int main(int argc, char* argv[])
{
    return runBench(argc, argv, measureAll);
}
