// bench_memory [--quick]: what nodes take, and whether refreshes leak.
//
// In a copy of this machine, in one process: the heap and the resident memory of a plug-in with
// 10,000 users and as many groups for each of its nodes; then, with 1,000 of both, memory after 10
// and after 1,000 refreshes.

#include "bench/support/MadeUp.h"
#include "bench/support/Samples.h"
#include "bench/support/Table.h"
#include "bench/support/Timed.h"
#include "host/Properties.h"
#include "tests/support/Plugin.h"

#include <fstream>
#include <malloc.h>
#include <unistd.h>

namespace
{

/** In bytes. */
struct Memory {
    double heap;
    double resident;
};

Memory memoryNow()
{
    malloc_trim(0); // so that memory which the allocator only keeps does not count
    long pages = 0;
    long resident = 0;
    std::ifstream("/proc/self/statm") >> pages >> resident;
    struct mallinfo2 const info = mallinfo2();
    return {static_cast<double>(info.uordblks + info.hblkhd),
            static_cast<double>(resident * sysconf(_SC_PAGESIZE))};
}

void measureNodes()
{
    madeUp::accounts(10000);
    Plugin plugin;
    Memory const before = memoryNow();
    plugin.initialize();
    Memory const after = memoryNow();
    auto const nodes = static_cast<double>(plugin.nodes().size());
    Table table({"Nodes", "Heap for each, bytes", "Resident for each, bytes"});
    table.add({number(nodes), number((after.heap - before.heap) / nodes),
               number((after.resident - before.resident) / nodes)});
    table.print();
}

void measureRefreshes(int many)
{
    constexpr int few = 10;
    madeUp::accounts(1000);
    Plugin plugin;
    plugin.initialize();
    IC::MutableNode& os = plugin.node(IC::nodeType::operatingSystem);
    Table table({"Refreshes", "Heap, bytes", "Resident, bytes"});
    for (int done = 1; done <= many; ++done) {
        os.setProperty(IC::property::refresh,
                       IC::PropertyValue(IC::Number(IC::command::rebuild), true));
        if (done != few && done != many)
            continue;
        Memory const now = memoryNow();
        table.add({number(done), number(now.heap), number(now.resident)});
    }
    table.print();
}

void measureAll(bool quick)
{
    enterCopy();
    madeUp::modules(0);
    madeUp::systemLog(0);
    measureNodes();
    measureRefreshes(quick ? 100 : 1000);
}

} // namespace

int main(int argc, char* argv[])
{
    return runBench(argc, argv, measureAll);
}
