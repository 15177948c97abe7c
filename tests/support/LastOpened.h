#ifndef TESTS_SUPPORT_LASTOPENED_H
#define TESTS_SUPPORT_LASTOPENED_H

#include "tests/interpose/Libc.h"

#include <fcntl.h>

inline bool isOpen(int descriptor)
{
    return fcntl(descriptor, F_GETFD) != -1;
}

/** The file that fopen opened last. Make it after FakeFiles, whose files it opens too. */
class LastOpened
{
public:
    LastOpened() : below_(libc::hooks().fopen.answer())
    {
        libc::hooks().fopen = [this](char const* path, char const* mode) {
            FILE* const stream = below_(path, mode);
            if (stream)
                descriptor_ = fileno(stream);
            return stream;
        };
    }
    ~LastOpened()
    {
        libc::hooks().fopen = below_;
    }
    LastOpened(LastOpened const&) = delete;
    LastOpened& operator=(LastOpened const&) = delete;

    /** -1 before the first one. */
    int descriptor() const
    {
        return descriptor_;
    }

private:
    std::function<FILE*(char const*, char const*)> const below_;
    int descriptor_ = -1;
};

#endif
