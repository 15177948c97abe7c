#ifndef MIHOST_CLI_ACCOUNTS_ACCOUNTDATA_H
#define MIHOST_CLI_ACCOUNTS_ACCOUNTDATA_H

#include "mihost/cli/accounts/AccountFiles.h"
#include "mihost/cli/accounts/LoginDefs.h"

#include <string>

namespace mihost
{

/** The contents of this machine's files about local accounts and groups. */
struct AccountData {
    AccountFiles files;
    LoginDefs loginDefs;
    std::string loginRules;    // the text of /etc/pam.d/login
    std::string shadowProblem; // why /etc/shadow cannot be read; empty if it can
};

AccountData readAccountData();

/** The login failures that the rules allow, by the last "deny=" with a number; 0 for any. */
long allowedLoginFailures(std::string const& loginRules);

} // namespace mihost

#endif
