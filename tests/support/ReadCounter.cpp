#include "tests/support/ReadCounter.h"

#include <unistd.h>

ReadCounter::ReadCounter()
{
    libc::hooks().pread = [this](int descriptor, void* buffer, std::size_t size, off_t offset) {
        ssize_t const got = interpose::real(pread)(descriptor, buffer, size, offset);
        bytes_ += static_cast<std::size_t>(got > 0 ? got : 0);
        return got;
    };
}

std::size_t ReadCounter::bytes() const
{
    return bytes_;
}

void ReadCounter::reset()
{
    bytes_ = 0;
}
