#ifndef TESTS_INTERPOSED_STANDINS_H
#define TESTS_INTERPOSED_STANDINS_H

#include <map>
#include <set>
#include <string>
#include <utility>
#include <vector>

/**
 * What this program's own fact getters, id ranges, log reader, points in time, values made of
 * literals and store of the operating-system node use and record.
 *
 * The fact getters return the values set here and read nothing of the machine.
 */
struct StandIns {
    std::map<std::string, unsigned int> numbers;
    std::map<std::string, std::string> texts;
    std::map<std::string, long> times;

    /** Getters that return false and keep the caller's value. */
    std::set<std::string> failing;

    /** What was called, in order: getters by name, stores as "set ID". */
    std::vector<std::string> calls;

    /** The points in time that were made, in order: seconds and sub-seconds. */
    std::vector<std::pair<long, unsigned short>> dates;

    /** The texts of values that were made of literals, in order. */
    std::vector<std::string> literals;

    /** The fact and log readers that were made and destroyed, in order, such as "OsInfo made". */
    std::vector<std::string> lives;
};

/** The ones in use; a test resets them with standIns() = {}. */
StandIns& standIns();

/** Counts the accounts with the real getter. */
bool realGetUserCount(unsigned int& out);

/** Finds the install date with the real getter. */
bool realGetInstallDate(long& out);

#endif
