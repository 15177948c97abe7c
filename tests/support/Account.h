#ifndef TESTS_SUPPORT_ACCOUNT_H
#define TESTS_SUPPORT_ACCOUNT_H

#include <string>

/** A line of /etc/passwd. */
inline std::string account(std::string const& name, unsigned int uid, unsigned int gid = 100)
{
    return name + ":x:" + std::to_string(uid) + ":" + std::to_string(gid) + ":" + name +
           " full:/home/" + name + ":/bin/sh\n";
}

#endif
