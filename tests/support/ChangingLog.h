#ifndef TESTS_SUPPORT_CHANGINGLOG_H
#define TESTS_SUPPORT_CHANGINGLOG_H

#include "tests/support/ScratchFolder.h"

#include <random>
#include <string>

/** A log in its own directory, which is changed in every way that logs are changed. */
class ChangingLog
{
public:
    explicit ChangingLog(unsigned int seed) : random_(seed) {}

    std::string path() const
    {
        return folder_.path("log");
    }

    /**
     * Appends to the log, truncates, rotates, replaces or overwrites it, with or without a change
     * of its times. Its lines are of every kind: empty, without an end, of 2 MB, with NUL bytes or
     * carriage returns.
     */
    void change();

    /** @return a random number from 0 to limit - 1 */
    unsigned long choose(unsigned long limit)
    {
        return random_() % limit;
    }

private:
    std::string line();
    std::string text();
    void overwriteMapped();

    ScratchFolder folder_;
    std::mt19937 random_;
};

#endif
