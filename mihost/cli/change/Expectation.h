#ifndef MIHOST_CLI_CHANGE_EXPECTATION_H
#define MIHOST_CLI_CHANGE_EXPECTATION_H

#include "mihost/cli/catalogue/Catalogue.h"
#include "mihost/cli/input/MethodCall.h"

#include <functional>
#include <string>
#include <vector>

namespace mihost
{

/** A condition that holds after a successful write. */
struct Expectation {
    std::string subject;                 // such as "login shell of jdoe"
    std::string wanted;                  // such as "/bin/bash"
    std::function<std::string()> actual; // the present value, in the form of the wanted one
};

/** The results of a method call in the account files. */
std::vector<Expectation> expectationsOf(MethodCall const& call);

/** That the account's shadow record has this hash. */
Expectation passwordHash(std::string const& user, std::string const& hash);

/** That the account does not exist. */
Expectation deletedAccount(std::string const& user);

/** That the account never expires. */
Expectation noAccountExpiry(std::string const& user);

/** That the account's password expires on this day, YYYY-MM-DD. */
Expectation passwordExpiryDay(std::string const& user, std::string const& day);

/** That the account becomes inactive on this day, some days after its password expired. */
Expectation inactivityDay(std::string const& user, std::string const& day);

/** That the system log has lost its present contents. */
Expectation emptiedLog();

} // namespace mihost

#endif
