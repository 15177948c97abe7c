// bench_reads [--benchmark_...]: what single reads and writes of properties cost.
//
// In a copy of this machine with 10, 1,000 and 10,000 users and groups, through the plug-in's
// library as a host loads it. Prints how often a second each can be done and how many allocations
// it takes.

#include "bench/support/Heap.h"
#include "bench/support/MadeUp.h"
#include "bench/support/Samples.h"
#include "bench/support/Table.h"
#include "bench/support/Timed.h"
#include "host/Properties.h"
#include "tests/support/Plugin.h"

#include <benchmark/benchmark.h>

#include <functional>
#include <map>
#include <memory>
#include <stdexcept>

namespace
{

constexpr char const* perCall = "allocations per call";

/** Runs something repeatedly and counts its allocations. */
void repeat(benchmark::State& state, std::function<void()> const& once)
{
    unsigned long const before = allocations();
    for (auto const& iteration : state) {
        static_cast<void>(iteration);
        once();
    }
    state.counters[perCall] =
        static_cast<double>(allocations() - before) / static_cast<double>(state.iterations());
}

void add(std::string const& what, std::function<void()> const& once)
{
    benchmark::RegisterBenchmark(what.c_str(), repeat, once)->Unit(benchmark::kNanosecond);
}

void addRead(std::string const& what, IC::MutableNode const& node, unsigned int id)
{
    add(what, [&node, id] {
        IC::PropertyValue value(IC::PropertyValue::EmptyKind, true);
        benchmark::DoNotOptimize(node.getProperty(id, value));
        benchmark::DoNotOptimize(value);
    });
}

void addRejectedCall(IC::MutableNode& os)
{
    IC::PropertyValue const call("UserAdd,UserName:CMPI_string:jdoe,Comment:CMPI_real:Test", true);
    if (os.setProperty(IC::property::createUser, call).getStatus() != 1)
        throw std::runtime_error("the method call was not rejected");
    add("method call that the parser rejects",
        [&os, call] { benchmark::DoNotOptimize(os.setProperty(IC::property::createUser, call)); });
}

/** Records the time of each repetition, in the order in which they were added. */
class Keeper : public benchmark::BenchmarkReporter
{
public:
    bool ReportContext(Context const&) override
    {
        return true;
    }

    void ReportRuns(std::vector<Run> const& runs) override
    {
        for (Run const& run : runs) {
            if (run.run_type != Run::RT_Iteration)
                continue;
            std::string const& what = run.run_name.function_name;
            if (times_.count(what) == 0)
                order_.push_back(what);
            times_[what].push_back(run.GetAdjustedRealTime());
            allocations_[what] = run.counters.at(perCall);
        }
    }

    void print() const
    {
        Table table({"Operation", "Nanoseconds", "Per second", "Allocations per call"});
        for (std::string const& what : order_)
            table.add({what, shown(times_.at(what)), number(1e9 / median(times_.at(what))),
                       number(allocations_.at(what))});
        table.print();
    }

private:
    std::vector<std::string> order_;
    std::map<std::string, Samples> times_;
    std::map<std::string, double> allocations_;
};

} // namespace

int main(int argc, char* argv[])
{
    enterCopy();
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv))
        return EXIT_FAILURE;
    madeUp::modules(0);
    madeUp::systemLog(0);
    Keeper keeper;
    for (int const users : {10, 1000, 10000}) {
        madeUp::accounts(users);
        Plugin plugin;
        plugin.initialize();
        IC::MutableNode& os = plugin.node(IC::nodeType::operatingSystem);
        if (users == 10) {
            addRead("stored text (operating system's name)", os, IC::property::name);
            addRead("stored list (of three numbers)", os, IC::property::fixedNumbers);
            addRead("live memory (free)", os, IC::property::physicalMemoryFree);
            addRead("live count of processes", os, IC::property::processCount);
            addRejectedCall(os);
        }
        std::string const among = " among " + number(users);
        addRead("live count of users" + among, *plugin.nodes(IC::nodeType::user).front(),
                IC::property::elementCount);
        addRead("live count of groups" + among, *plugin.nodes(IC::nodeType::group).front(),
                IC::property::elementCount);
        benchmark::RunSpecifiedBenchmarks(&keeper);
        benchmark::ClearRegisteredBenchmarks();
    }
    keeper.print();
    return EXIT_SUCCESS;
}
