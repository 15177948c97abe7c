#ifndef BENCH_SUPPORT_TIMED_H
#define BENCH_SUPPORT_TIMED_H

#include <string>
#include <vector>

/** @return milliseconds of a clock that is never set */
double millisecondsNow();

/** The times of a program's run, in milliseconds, and what it printed. */
struct Timed {
    double whole; // from its start to its end
    double cpu;   // user and system time, its children's included
    std::string output;
};

/** @throws std::runtime_error if its exit code is not 0 */
Timed timed(std::vector<std::string> const& arguments);

/** Enters a copy of this machine. @throws std::runtime_error if none can be created */
void enterCopy();

/** A program's main: accepts --quick and writes errors to standard error. */
int runBench(int argc, char* argv[], void (*measure)(bool quick));

#endif
