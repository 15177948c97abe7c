#ifndef TESTS_INTERPOSED_STANDINS_H
#define TESTS_INTERPOSED_STANDINS_H

#include <map>
#include <set>
#include <string>
#include <utility>
#include <vector>

/**
 * Replaces the facts of the operating system, the id ranges, points in time, values made of
 * literals and the store of its node, all of which this program replaces.
 *
 * The fact getters answer with what is given here and consult nothing.
 */
struct StandIns {
    std::map<std::string, unsigned int> numbers;
    std::map<std::string, std::string> texts;
    std::map<std::string, long> times;

    /** Getters that return false and leave the caller's value alone. */
    std::set<std::string> failing;

    /** What was called, in order: getters by name, stores as "set ID". */
    std::vector<std::string> calls;

    /** The points in time that were made, in order: seconds and what was given beside them. */
    std::vector<std::pair<long, unsigned short>> dates;

    /** The texts of values that were made of literals, in order. */
    std::vector<std::string> literals;

    /** The fact and log readers that came and went, in order, such as "OsInfo made". */
    std::vector<std::string> lives;
};

/** Those in use; a test starts with none set. */
StandIns& standIns();

/** Counts the accounts with the real getter. */
bool realGetUserCount(unsigned int& out);

/** Finds the install date with the real getter. */
bool realGetInstallDate(long& out);

#endif
