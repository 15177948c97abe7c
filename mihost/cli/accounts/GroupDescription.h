#ifndef MIHOST_CLI_ACCOUNTS_GROUPDESCRIPTION_H
#define MIHOST_CLI_ACCOUNTS_GROUPDESCRIPTION_H

#include "mihost/cli/accounts/AccountData.h"

#include <optional>
#include <string>
#include <vector>

namespace mihost
{

/** A local group as the account files describe it. */
struct GroupDescription {
    struct Member {
        std::string name;
        bool hasAccount; // a local one
    };

    std::string name;
    unsigned int id;
    std::vector<std::string> primaryMembers; // accounts whose primary group it is
    std::vector<Member> listedMembers;
    std::string noNode; // why the plug-in has no node for it; empty if it has
};

/** @return nothing if there is no such group, or its record has no GID */
std::optional<GroupDescription> describeGroup(AccountData const& data, std::string const& name);

} // namespace mihost

#endif
