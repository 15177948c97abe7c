#ifndef TESTS_SUPPORT_FILEROOT_H
#define TESTS_SUPPORT_FILEROOT_H

#include "tests/interpose/Libc.h"

#include <string>

/**
 * Lays files over the machine's own for as long as it lives: opening any path below /etc or
 * /var/log opens it below the root folder instead, and the group database is the root folder's
 * /etc/group. The machine's account lock is not taken.
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
