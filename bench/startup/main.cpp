// The plug-in's start-up against the bare cost of the commands that it runs.
//
// In a copy of this machine with 120 kernel modules, whose lsmod and modinfo are scripts that print
// recorded text, and with a log of 1,000, 100,000 and 1,000,000 lines, run by turns
//
//   plug-in   startup_host: loads the plug-in and initialises it, from its start to its end
//   bare      startup_commands: gives the very same command lines in the same order to popen and
//             reads what they print, likewise
//
// For each log it prints the number of commands and, for both, the median of the time taken
// (whole), of the processor time with the commands (cpu) and of the processor time without them
// (own: the plug-in's share of a start); the ratios are medians of those of the pairs. On a busy
// machine that of cpu says more than that of whole.

#include "mihost/sandbox/Sandbox.h"
#include "tests/support/Machine.h"
#include "tests/support/Program.h"

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <stdexcept>
#include <string>
#include <sys/resource.h>
#include <vector>

namespace
{

constexpr int modules = 120;
constexpr char const* list = "/tmp/commands";

struct Size {
    int logLines;
    std::size_t pairs;
};

constexpr Size sizes[] = {{1000, 21}, {100000, 21}, {1000000, 7}};

double wholeTime()
{
    std::chrono::duration<double, std::milli> const time =
        std::chrono::steady_clock::now().time_since_epoch();
    return time.count();
}

double cpuTime()
{
    rusage used{};
    getrusage(RUSAGE_CHILDREN, &used);
    return 1e3 * static_cast<double>(used.ru_utime.tv_sec + used.ru_stime.tv_sec) +
           1e-3 * static_cast<double>(used.ru_utime.tv_usec + used.ru_stime.tv_usec);
}

/** What one run took, in milliseconds. */
struct Times {
    double whole;
    double cpu;
    double own;
};

struct Column {
    char const* name;
    double Times::*time;
};

constexpr Column columns[] = {{"whole", &Times::whole}, {"cpu", &Times::cpu}, {"own", &Times::own}};

void makeMachine()
{
    setenv("PATH", "/usr/local/sbin:/usr/local/bin:/usr/sbin:/usr/bin:/sbin:/bin", 1);
    setenv("LC_ALL", "C", 1);
    machine::lay("odd-modules");
    std::string lsmod = "Module                  Size  Used by\n";
    for (int i = 0; i < modules; ++i)
        lsmod += "module" + std::to_string(i) + " 16384 0\n";
    machine::write("/usr/share/recorded/lsmod", lsmod);
    std::string const modinfo = machine::read("/usr/share/recorded/modinfo/e1000");
    for (int i = 0; i < modules; ++i)
        machine::write("/usr/share/recorded/modinfo/module" + std::to_string(i), modinfo);
}

void writeLog(int lines)
{
    std::ofstream log("/var/log/messages");
    for (int i = 0; i < lines; ++i)
        log << "Nov 20 10:11:12 host systemd[1]: Started Session " << i << " of user root.\n";
}

Times run(std::vector<std::string> const& arguments)
{
    double const wholeBefore = wholeTime();
    double const cpuBefore = cpuTime();
    Outcome const outcome = runToEnd(arguments);
    if (outcome.code != 0)
        throw std::runtime_error(arguments.front() + " failed: " + outcome.err);
    return {wholeTime() - wholeBefore, cpuTime() - cpuBefore, std::stod(outcome.out) / 1000};
}

struct Pair {
    Times plugin;
    Times bare;
};

Pair runPair(bool pluginFirst)
{
    std::vector<std::string> const host{STARTUP_HOST, PLUGIN_FILE};
    std::vector<std::string> const commands{STARTUP_COMMANDS, list};
    Times const first = run(pluginFirst ? host : commands);
    Times const second = run(pluginFirst ? commands : host);
    return pluginFirst ? Pair{first, second} : Pair{second, first};
}

/** The median over all pairs; their number is odd. */
template <class Value> double median(std::vector<Pair> const& pairs, Value const& valueOf)
{
    std::vector<double> values(pairs.size());
    std::transform(pairs.begin(), pairs.end(), values.begin(), valueOf);
    auto const middle = values.begin() + static_cast<std::ptrdiff_t>(values.size() / 2);
    std::nth_element(values.begin(), middle, values.end());
    return *middle;
}

int countCommands()
{
    std::ifstream commands(list);
    int count = 0;
    for (std::string line; std::getline(commands, line);)
        ++count;
    return count;
}

void measure(Size const& size)
{
    writeLog(size.logLines);
    run({STARTUP_HOST, PLUGIN_FILE, list});
    std::vector<Pair> pairs(size.pairs);
    for (std::size_t i = 0; i < pairs.size(); ++i)
        pairs[i] = runPair(i % 2 == 0);
    for (Column const& column : columns) {
        auto const time = column.time;
        std::printf("%9d %8d %5zu  %-5s %10.2f %10.2f %7.3f\n", size.logLines, countCommands(),
                    size.pairs, column.name,
                    median(pairs, [time](Pair const& pair) { return pair.plugin.*time; }),
                    median(pairs, [time](Pair const& pair) { return pair.bare.*time; }),
                    median(pairs, [time](Pair const& pair) {
                        return pair.plugin.*time / pair.bare.*time;
                    }));
    }
    std::fflush(stdout);
}

} // namespace

int main()
{
    if (auto const reason = mihost::enterSandbox({})) {
        std::fprintf(stderr, "no sandbox: %s\n", reason->c_str());
        return EXIT_FAILURE;
    }
    makeMachine();
    std::printf("%9s %8s %5s  %-5s %10s %10s %7s\n", "log lines", "commands", "pairs", "time",
                "plug-in ms", "bare ms", "ratio");
    for (Size const& size : sizes)
        measure(size);
    return EXIT_SUCCESS;
}
