#ifndef MIHOST_CLI_CHANGE_USERCHECK_H
#define MIHOST_CLI_CHANGE_USERCHECK_H

#include "host/MutableNode.h"

#include <optional>
#include <string>
#include <vector>

/**
 * Checks a write to a user node against the machine. The plug-in passes the node's name or UID to
 * account tools, even if another account has that name or UID by now.
 */
namespace mihost
{

/** An account as a user node stores it, in properties 108 and 89, or as /etc/passwd does. */
struct Account {
    std::string name;
    std::string id; // in decimal
};

enum class UserWrite { Change, Delete };

/**
 * Why a write would reach another account than the node's, or none; nothing if it reaches the
 * node's.
 *
 * @param node      as the node holds it
 * @param accounts  in the order of /etc/passwd
 */
std::optional<std::string> objectionToUserWrite(Account const& node, UserWrite write,
                                                std::vector<Account> const& accounts);

/** The same for a user node and this machine. @throws Failure (BadUsage) */
void checkUserWrite(IC::MutableNode const& node, UserWrite write);

} // namespace mihost

#endif
