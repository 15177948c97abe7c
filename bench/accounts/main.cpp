// bench_accounts [--quick]: users and groups, at the start and on a refresh.
//
// In a copy of this machine with 10, 1,000 and 10,000 users, as many groups with one member and one
// group that holds all users, run alternately
//
//   plug-in  accounts_host: what a start spends on users and groups, and what a refresh takes
//   calls    accounts_calls: only the C library's calls of a refresh
//   Python   list.py: lists the same with the modules pwd, spwd and grp, for its own time and for
//            that of the whole program

#include "bench/support/MadeUp.h"
#include "bench/support/Samples.h"
#include "bench/support/Table.h"
#include "bench/support/Timed.h"

#include <map>
#include <sstream>

namespace
{

constexpr int small = 1000;
constexpr int large = 10000;
constexpr std::size_t rounds = 9;
constexpr std::size_t quickRounds = 3;

struct Result {
    Samples start = {};
    Samples refresh = {};
    Samples calls = {};
    Samples python = {};
    Samples pythonWhole = {};

    void plugin()
    {
        std::istringstream output(timed({ACCOUNTS_HOST, "5"}).output);
        double time = 0;
        output >> time;
        start.push_back(time);
        Samples refreshes;
        while (output >> time)
            refreshes.push_back(time);
        refresh.push_back(median(refreshes));
    }

    void callsAlone()
    {
        calls.push_back(std::stod(timed({ACCOUNTS_CALLS}).output));
    }

    void list()
    {
        Timed const run = timed({"/usr/bin/python3", LIST_SCRIPT});
        python.push_back(std::stod(run.output));
        pythonWhole.push_back(run.whole);
    }
};

void measureAll(bool quick)
{
    enterCopy();
    madeUp::modules(0);
    madeUp::systemLog(0);
    std::map<int, Result> results;
    for (int const users : {10, small, large}) {
        madeUp::accounts(users);
        Result& result = results[users];
        byTurns(quick ? quickRounds : rounds,
                {[&] { result.plugin(); }, [&] { result.callsAlone(); }, [&] { result.list(); }});
    }
    say("Milliseconds for all users and groups.");
    Table table({"Users", "Start's share", "Refresh", "Refresh / start's share", "Its calls alone",
                 "Python, listing alone", "Python, whole program", "Refresh / listing alone",
                 "Refresh / whole program", "Its calls / whole program"});
    for (auto const& [users, result] : results)
        table.add({number(users), shown(result.start, 2), shown(result.refresh, 2),
                   shown(ratios(result.refresh, result.start), 2), shown(result.calls, 2),
                   shown(result.python, 2), shown(result.pythonWhole, 1),
                   shown(ratios(result.refresh, result.python), 2),
                   shown(ratios(result.refresh, result.pythonWhole), 2),
                   shown(ratios(result.calls, result.pythonWhole), 2)});
    table.print();
    say("From " + number(small) + " to " + number(large) + " users a refresh grows " +
        shown(ratios(results[large].refresh, results[small].refresh), 2) +
        " times and a start's share " +
        shown(ratios(results[large].start, results[small].start), 2) + " times.");
}

} // namespace

int main(int argc, char* argv[])
{
    return runBench(argc, argv, measureAll);
}
