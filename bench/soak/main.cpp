// soak [SHARE]: long use of one plug-in, and what it leaks.
//
// In a copy of this machine with 1,000 users and as many groups, in one process:
//
//   reads       1,000,000 property reads, stored and live, of all nodes in turn
//   refreshes   1,000 rebuilds of the user and group nodes
//   lives       1,000 times loaded, initialised, unloaded and closed (on a machine with 10 users)
//
// For each it prints resident memory, open descriptors and children at 10, 50 and 100 percent of
// the way; flat figures mean no leak. SHARE, a percentage, shortens all three. Exits 1
// when descriptors or children grew, or memory by more than 2 percent between 50 and 100.

#include "bench/support/MadeUp.h"
#include "bench/support/Timed.h"
#include "host/Properties.h"
#include "tests/support/Plugin.h"

#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <functional>
#include <iostream>
#include <malloc.h>
#include <sys/wait.h>
#include <unistd.h>
#include <vector>

namespace
{

struct Figures {
    long memory; // KiB
    long descriptors;
    long children;
};

Figures figuresNow()
{
    malloc_trim(0); // so that memory which the allocator only keeps does not count
    long pages = 0;
    long resident = 0;
    std::ifstream("/proc/self/statm") >> pages >> resident;
    auto const listing = std::filesystem::directory_iterator("/proc/self/fd");
    long children = 0;
    while (waitpid(-1, nullptr, WNOHANG) >= 0)
        ++children;
    return {resident * (sysconf(_SC_PAGESIZE) / 1024), std::distance(begin(listing), end(listing)),
            children};
}

/** @return whether nothing grew */
bool report(char const* what, int times, std::function<void(int)> const& once)
{
    std::vector<Figures> figures;
    for (int done = 0; done < times; ++done) {
        once(done);
        for (int const percent : {10, 50, 100})
            if (done + 1 == times * percent / 100)
                figures.push_back(figuresNow());
    }
    std::printf("| %s | %d |", what, times);
    for (Figures const& at : figures)
        std::printf(" %ld KiB, %ld, %ld |", at.memory, at.descriptors, at.children);
    std::printf("\n");
    std::fflush(stdout);
    Figures const& start = figures.front();
    Figures const& middle = figures[1];
    Figures const& end = figures.back();
    return end.descriptors == start.descriptors && end.children == start.children &&
           end.memory <= middle.memory + middle.memory / 50;
}

class Reads
{
public:
    explicit Reads(Plugin const& plugin) : nodes_(plugin.nodes()) {}

    void operator()(int number) const
    {
        static constexpr unsigned int ids[] = {IC::property::name, IC::property::physicalMemoryFree,
                                               IC::property::fixedNumbers,
                                               IC::property::processCount};
        IC::PropertyValue value(IC::PropertyValue::EmptyKind, true);
        auto const at = static_cast<std::size_t>(number);
        nodes_[at % nodes_.size()]->getProperty(ids[at % std::size(ids)], value);
    }

private:
    std::vector<IC::MutableNode*> const nodes_;
};

} // namespace

int main(int argc, char** argv)
try {
    int const share = argc > 1 ? std::atoi(argv[1]) : 100;
    if (share < 1 || share > 100) {
        std::cerr << "soak: SHARE is a percentage from 1 to 100\n";
        return 2;
    }
    enterCopy();
    madeUp::modules(1);
    madeUp::systemLog(1);
    std::printf(
        "| what | times | at 10 %% (memory, descriptors, children) | at 50 %% | at 100 %% |\n"
        "|---|---|---|---|---|\n");
    bool flat = true;
    madeUp::accounts(1000);
    {
        Plugin plugin;
        plugin.initialize();
        flat = report("property reads", 10000 * share, Reads(plugin)) && flat;
        IC::MutableNode& os = plugin.node(IC::nodeType::operatingSystem);
        flat = report("refreshes", 10 * share,
                      [&os](int) {
                          os.setProperty(IC::property::refresh,
                                         IC::PropertyValue(IC::Number(IC::command::rebuild), true));
                      }) &&
               flat;
    }
    madeUp::accounts(10);
    flat = report("load, start, stop, close", 10 * share,
                  [](int) {
                      Plugin plugin;
                      plugin.initialize();
                  }) &&
           flat;
    if (!flat)
        std::cerr << "soak: something grew\n";
    return flat ? 0 : 1;
} catch (std::exception const& problem) {
    std::cerr << "soak: " << problem.what() << '\n';
    return 1;
}
