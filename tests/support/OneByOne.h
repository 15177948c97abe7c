#ifndef TESTS_SUPPORT_ONEBYONE_H
#define TESTS_SUPPORT_ONEBYONE_H

#include <functional>

/**
 * Runs every selected test in its own process, forked from this one, and prints the output of those
 * that fail or are skipped. Filters, shards, repetitions and shuffling are GoogleTest's. If only
 * one test is selected, it runs in this process.
 *
 * @param runTests  prepares the process and runs the tests; returns its exit status
 * @return the program's exit status
 */
int runTestsOneByOne(std::function<int()> const& runTests);

#endif
