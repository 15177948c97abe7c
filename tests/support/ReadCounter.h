#ifndef TESTS_SUPPORT_READCOUNTER_H
#define TESTS_SUPPORT_READCOUNTER_H

#include "tests/interpose/Libc.h"

#include <unistd.h>

/** Counts the bytes that pread reads from now on. */
class ReadCounter
{
public:
    ReadCounter()
    {
        libc::hooks().pread = [this](int descriptor, void* buffer, std::size_t size, off_t offset) {
            ssize_t const got = interpose::real(pread)(descriptor, buffer, size, offset);
            bytes += static_cast<std::size_t>(got > 0 ? got : 0);
            return got;
        };
    }

    std::size_t bytes = 0;

private:
    libc::HookGuard guard_;
};

#endif
