#ifndef TESTS_SANDBOX_MIHOST_CLI_LOGIN_H
#define TESTS_SANDBOX_MIHOST_CLI_LOGIN_H

#include "tests/support/Machine.h"

#include <crypt.h>

/** Whether a login with this password succeeds. */
inline bool opens(std::string const& account, std::string const& password)
{
    std::string const hash = machine::entry("/etc/shadow", account).at(1);
    char const* const again = crypt(password.c_str(), hash.c_str());
    return again && !hash.empty() && hash == again;
}

#endif
