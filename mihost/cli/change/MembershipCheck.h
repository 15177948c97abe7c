#ifndef MIHOST_CLI_CHANGE_MEMBERSHIPCHECK_H
#define MIHOST_CLI_CHANGE_MEMBERSHIPCHECK_H

#include "mihost/cli/input/MethodCall.h"

#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

/**
 * Checks a change of group membership against the machine. The plug-in reads the names of all the
 * member's groups from id and puts them into a usermod command line.
 */
namespace mihost
{

struct Group {
    unsigned int id;
    std::string name; // empty if it has none
};

/** What id prints about a user. */
struct Identity {
    std::string user;
    Group primary;
    std::vector<Group> groups; // the primary one among them
};

/** Nothing if the text is not what id prints in the C locale about one user. */
std::optional<Identity> parseIdentity(std::string_view text);

/** How usermod finds a group by name: its id, or nothing if no group has this name. */
using FindGroup = std::function<std::optional<unsigned int>(std::string const& name)>;

/**
 * Why a usermod command line made from an identity would do something else than keep these groups;
 * nothing if it keeps them.
 *
 * @param member  as usermod gets it
 */
std::optional<std::string> objectionToIdentity(Identity const& identity, std::string const& member,
                                               FindGroup const& findGroup);

/** Runs id as the plug-in will. Any call but a membership change passes. @throws Failure (BadUsage)
 */
void checkMembership(MethodCall const& call);

} // namespace mihost

#endif
