#ifndef TESTS_SUPPORT_READCOUNTER_H
#define TESTS_SUPPORT_READCOUNTER_H

#include "tests/interpose/Libc.h"

#include <cstddef>

/** Counts the bytes that pread reads from now on. */
class ReadCounter
{
public:
    ReadCounter();

    std::size_t bytes() const;
    void reset();

private:
    libc::HookGuard guard_;
    std::size_t bytes_ = 0;
};

#endif
