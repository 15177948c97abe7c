#ifndef MIHOST_CLI_ACCOUNTS_USERDESCRIPTION_H
#define MIHOST_CLI_ACCOUNTS_USERDESCRIPTION_H

#include "mihost/cli/accounts/AccountData.h"

#include <optional>
#include <string>
#include <vector>

namespace mihost
{

struct NamedGroup {
    unsigned int id;
    std::string name; // empty if no group has the id
};

enum class PasswordState {
    Unknown,
    Set,
    Locked,   // a hash after an exclamation mark, or nothing but the mark
    Unusable, // no password matches what is stored
    None      // no password is needed
};

/** @param stored  the password field of an account */
PasswordState passwordState(std::string const& stored);

/** Days are counted from 1970. A day that will never come is missing. */
struct PasswordAgeing {
    std::optional<long> minDays; // numbers of days, as stored; missing without a limit
    std::optional<long> maxDays;
    std::optional<long> warnDays;
    std::optional<long> inactiveDays;
    std::optional<long> changed;
    bool mustChange = false; // at the next login
    std::optional<long> changeableFrom;
    std::optional<long> warnsFrom;
    std::optional<long> lastValid;  // the next day the password has expired
    std::optional<long> lastActive; // the next day the account is inactive
};

/** A local account as the account files describe it. */
struct UserDescription {
    std::string name;
    unsigned int id;
    std::string fullName;
    std::string home;
    std::string shell;
    NamedGroup primaryGroup;
    std::vector<NamedGroup> otherGroups;
    PasswordState password = PasswordState::Unknown;
    std::string unknown; // why password and ageing are unknown; empty if they are not
    PasswordAgeing ageing;
    std::optional<long> expires; // the account, on this day
    long loginFailures = 0;      // allowed in a row; 0 for any number
    std::string noNode;          // why the plug-in has no node for it; empty if it has
};

/** @return nothing if there is no such account, or its record has no ids */
std::optional<UserDescription> describeUser(AccountData const& data, std::string const& name);

/** The state on a day, such as "locked" or "expired 3 days ago"; empty if it is unknown. */
std::string accountState(UserDescription const& user, long today);

/** Such as "in 12 days", "today" or "1 day ago". */
std::string relativeDay(long day, long today);

} // namespace mihost

#endif
