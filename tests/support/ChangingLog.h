#ifndef TESTS_SUPPORT_CHANGINGLOG_H
#define TESTS_SUPPORT_CHANGINGLOG_H

#include "tests/support/ScratchFolder.h"

#include <random>
#include <string>

/** A log of its own folder, to which everything happens that happens to logs. */
class ChangingLog
{
public:
    explicit ChangingLog(unsigned int seed) : random_(seed) {}

    std::string path() const
    {
        return folder_.path("log");
    }

    /**
     * Appends, truncates, rotates, replaces or overwrites it, with or without a change of its
     * times. What is in it are lines of every kind: without an end, empty, with NUL bytes, of 2 MB,
     * with carriage returns.
     */
    void change();

    /** A number from 0 to one less than the limit. */
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
