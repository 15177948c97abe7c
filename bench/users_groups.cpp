// How the building of user and group nodes grows with the machine.
//
//   StartUp/N    builds the nodes of N users and N + 1 groups for the first time
//   Refresh/N    deletes them all and builds them again
//   peak memory  of the user nodes of the largest machine, start-up only, per node
//
// The machine is made up: every user has its own primary group, and one group contains all
// users. Files are real ones below a temporary folder; no command is run, nothing is logged.
// After the runs each one's growth from 1,000 to 10,000 users is printed; it must be at most 12.

#include "frame/OsSwMI.h"
#include "host/Properties.h"
#include "tests/support/FakeFiles.h"

#include <benchmark/benchmark.h>

#include <fstream>
#include <iostream>
#include <map>
#include <string>
#include <sys/wait.h>
#include <unistd.h>

namespace
{

constexpr unsigned int small = 1000;
constexpr unsigned int large = 10000;
constexpr double growthLimit = 12;
constexpr unsigned int firstId = 10000; // all ids have five digits, at any size

std::string nameOf(unsigned int user)
{
    return "user" + std::to_string(firstId + user);
}

/** Makes the program read the files of a machine with this many users while it exists. */
class MadeUpMachine
{
public:
    explicit MadeUpMachine(unsigned int users)
    {
        libc::hooks().popen = [](char const*, char const*) -> FILE* { return nullptr; };
        std::string passwd;
        std::string shadow;
        std::string group;
        std::string everyone = "everyone:x:60000:";
        for (unsigned int user = 0; user < users; ++user) {
            std::string const name = nameOf(user);
            std::string const id = std::to_string(firstId + user);
            passwd +=
                name + ":x:" + id + ':' + id + ":User " + id + ",,,:/home/" + name + ":/bin/bash\n";
            shadow += name + ":$6$saltsalt$" + std::string(86, 'h') + ":19000:0:99999:7:::\n";
            group += name + ":x:" + id + ":\n";
            everyone += (user == 0 ? "" : ",") + name;
        }
        files_.write("/etc/login.defs",
                     "UID_MIN 1000\nUID_MAX 60000\nGID_MIN 1000\nGID_MAX 60000\n");
        files_.write("/etc/passwd", passwd);
        files_.write("/etc/shadow", shadow);
        files_.write("/etc/group", group + everyone + "\n");
        files_.write("/etc/pam.d/login", loginRules());
    }

    ~MadeUpMachine()
    {
        libc::hooks().popen = nullptr;
    }

    MadeUpMachine(MadeUpMachine const&) = delete;
    MadeUpMachine& operator=(MadeUpMachine const&) = delete;

private:
    /** As many rules as a distribution has, of which one matters. */
    static std::string loginRules()
    {
        std::string rules;
        for (int line = 0; line < 100; ++line)
            rules += "# what the login service asks for, and why it does so\n";
        return rules + "auth required pam_tally2.so onerr=fail deny=3\n";
    }

    FakeFiles files_;
};

/** The interface with only the parents of users and groups. */
class Interface : public IC::OsSwMI
{
public:
    Interface()
    {
        ManagementInterface::initialize(1, IC::Number(0U), IC::Number(0U));
        nodeIds_ = new std::vector<unsigned int>;
        createOsSwNodes();
        createRootNode();
        createComputerNodes();
        createOsNodes();
    }

    ~Interface() override
    {
        OsSwMI::unload();
    }

    void buildUsersAndGroups(bool refresh)
    {
        createUserNodes(refresh);
        createGroupNodes(refresh);
    }

    std::size_t userCount() const
    {
        return userNodes_.size();
    }
};

void StartUp(benchmark::State& state)
{
    MadeUpMachine const machine(static_cast<unsigned int>(state.range(0)));
    for (auto const& iteration : state) {
        static_cast<void>(iteration);
        state.PauseTiming();
        {
            Interface interface;
            state.ResumeTiming();
            interface.buildUsersAndGroups(false);
            state.PauseTiming();
        }
        state.ResumeTiming();
    }
}

void Refresh(benchmark::State& state)
{
    MadeUpMachine const machine(static_cast<unsigned int>(state.range(0)));
    Interface interface;
    interface.buildUsersAndGroups(false);
    for (auto const& iteration : state) {
        static_cast<void>(iteration);
        interface.buildUsersAndGroups(true);
    }
}

BENCHMARK(StartUp)->Arg(100)->Arg(small)->Arg(large)->Unit(benchmark::kMillisecond);
BENCHMARK(Refresh)->Arg(100)->Arg(small)->Arg(large)->Unit(benchmark::kMillisecond);

/** Prints the runs as usual and records the median, or the only, time of each. */
class KeepingReporter : public benchmark::ConsoleReporter
{
public:
    void ReportRuns(std::vector<Run> const& runs) override
    {
        ConsoleReporter::ReportRuns(runs);
        for (Run const& run : runs)
            if (run.aggregate_name == "median" || run.repetitions <= 1)
                times_[run.run_name.function_name + '/' + run.run_name.args] =
                    run.GetAdjustedCPUTime();
    }

    void printGrowth(std::string const& what) const
    {
        auto const from = times_.find(what + '/' + std::to_string(small));
        auto const to = times_.find(what + '/' + std::to_string(large));
        if (from == times_.end() || to == times_.end())
            return;
        double const growth = to->second / from->second;
        std::cout << what << ": 10,000 users cost " << growth << " times what 1,000 cost (limit "
                  << growthLimit << (growth > growthLimit ? ", exceeded" : "") << ")\n";
    }

private:
    std::map<std::string, double> times_;
};

/** A figure of /proc/self/status in bytes. */
long memory(std::string const& key)
{
    std::ifstream status("/proc/self/status");
    for (std::string word; status >> word;)
        if (word == key + ":") {
            long kilobytes = 0;
            status >> kilobytes;
            return kilobytes * 1024;
        }
    return 0;
}

void printMemoryHere()
{
    MadeUpMachine const machine(large);
    Interface interface;
    std::ofstream("/proc/self/clear_refs") << '5'; // the peak counts from here
    long const before = memory("VmRSS");
    interface.createUserNodes(false);
    long const peak = memory("VmHWM") - before;
    long const kept = memory("VmRSS") - before;
    auto const nodes = static_cast<long>(interface.userCount());
    std::cout << "Memory: " << peak / nodes << " bytes per user node at the peak, " << kept / nodes
              << " kept" << std::endl;
}

/** Builds the user nodes in a new process with untouched memory. */
void printPeakMemory()
{
    pid_t const child = fork();
    if (child == 0) {
        printMemoryHere();
        _exit(0);
    }
    waitpid(child, nullptr, 0);
}

} // namespace

int main(int argc, char** argv)
{
    printPeakMemory();
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv))
        return 2;
    KeepingReporter reporter;
    benchmark::RunSpecifiedBenchmarks(&reporter);
    reporter.printGrowth("StartUp");
    reporter.printGrowth("Refresh");
    return 0;
}
