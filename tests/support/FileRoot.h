#ifndef TESTS_SUPPORT_FILEROOT_H
#define TESTS_SUPPORT_FILEROOT_H

#include "tests/interpose/Libc.h"

#include <string>

/**
 * Replaces the machine's files while it exists: opening any path below /etc or /var/log opens it
 * below the root directory given here, and the group database is the /etc/group there. The
 * machine's account lock is not taken.
 */
class FileRoot
{
public:
    explicit FileRoot(std::string root);
    ~FileRoot();
    FileRoot(FileRoot const&) = delete;
    FileRoot& operator=(FileRoot const&) = delete;
};

#endif
