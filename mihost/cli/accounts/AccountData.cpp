#include "mihost/cli/accounts/AccountData.h"

#include "mihost/cli/system/TextFile.h"

#include <cerrno>
#include <cstdio>
#include <cstring>
#include <unistd.h>

namespace mihost
{

AccountData readAccountData()
{
    bool const canReadShadow = access(shadowFile, R_OK) == 0;
    std::string const problem = canReadShadow ? "" : std::strerror(errno);
    return {readAccountFiles(), readLoginDefs(), contentOf("/etc/pam.d/login"), problem};
}

long allowedLoginFailures(std::string const& loginRules)
{
    constexpr char key[] = "deny=";
    long allowed = 0;
    for (std::string const& line : linesOf(loginRules)) {
        std::size_t const at = line.find(key);
        int number = 0;
        if (at != std::string::npos && std::sscanf(line.c_str() + at, "deny=%d", &number) == 1)
            allowed = number;
    }
    return allowed;
}

} // namespace mihost
