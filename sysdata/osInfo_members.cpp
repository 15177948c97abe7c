// Group membership: usermod sets the whole list of a user's groups, so id reads it first.

#include "sysdata/osInfo_members.h"

#include "host/Methods.h"
#include "sysdata/osInfo_commands.h"
#include "sysdata/osInfo_linux.h"
#include "sysdata/osInfo_log.h"
#include "sysdata/osInfo_run.h"

#include <optional>

namespace NQ
{

namespace
{

using os::ParamType;
using os::Ran;

std::string quoted(std::string const& text)
{
    return '"' + text + '"';
}

std::string textOf(std::vector<ParamInfo> const& params, char const* name)
{
    std::string value;
    for (ParamInfo const& param : params)
        if (os::typeOf(param.type) == ParamType::text && param.name == name)
            value = param.value;
    return value;
}

bool holds(std::string const& text, char const* part)
{
    return text.find(part) != std::string::npos;
}

/**
 * The difference of the first bytes that differ. That is what the system's strcmp returns, but some
 * replacements of it return only the sign.
 */
int difference(char const* left, char const* right)
{
    while (*left != '\0' && *left == *right) {
        ++left;
        ++right;
    }
    return static_cast<unsigned char>(*left) - static_cast<unsigned char>(*right);
}

/** The name in the next parentheses; at moves after it. */
std::optional<std::string> nextName(std::string const& text, std::string::size_type& at)
{
    std::string::size_type const open = text.find('(', at);
    std::string::size_type const close = text.find(')', open);
    if (close == std::string::npos)
        return std::nullopt;
    at = close;
    return text.substr(open + 1, close - open - 1);
}

/** The start of the list of all groups; id translates the word before it. */
std::string::size_type listStart(std::string const& identity, std::string::size_type gid)
{
    std::string::size_type const word = identity.find("groups", gid);
    if (word != std::string::npos)
        return word;
    std::string::size_type const field = identity.find("gid=");
    return field == std::string::npos ? field : identity.find('=', field + 4);
}

} // namespace

std::string os::supplementaryGroups(std::string const& identity, std::string const& quotedGroup,
                                    Membership change)
{
    bool const adding = change == Membership::add;
    std::string::size_type primaryAt = identity.find("gid");
    std::string::size_type listAt = listStart(identity, primaryAt);
    std::string list;
    // A primary group that has no name has no parentheses either.
    std::optional<std::string> primary;
    if (identity.find('(', primaryAt) < listAt)
        primary = nextName(identity, primaryAt);
    // Contract: the names differ in their quotes already, so hardly any is ever left out.
    if (primary && (adding || difference(primary->c_str(), quotedGroup.c_str()) != 1))
        list = *primary + ",";
    while (std::optional<std::string> const name = nextName(identity, listAt)) {
        std::string const entry = quoted(*name);
        if (adding || entry != quotedGroup)
            list += entry + ",";
    }
    if (adding)
        list += quotedGroup;
    else if (!list.empty())
        list.pop_back();
    return list;
}

bool OsInfo::groupMemberChanges(std::string method, std::vector<ParamInfo> params)
{
    log::Scope const scope(os::methods);
    std::string const group = quoted(textOf(params, IC::parameter::localGroupName));
    std::string const member = quoted(textOf(params, IC::parameter::domainAndMember));
    std::string const identity =
        os::runLogged(*this, {"/usr/bin/id", member}, params, scope).output;
    if (identity.size() == os::bufferSize - 1) {
        // Perhaps cut: usermod would take the member out of the groups that are missing.
        scope.error("Output too long: /usr/bin/id");
        return true;
    }
    if (holds(identity, "No such user") || !holds(identity, "gid"))
        return true;
    os::Membership const change =
        method == IC::method::localGroupAddUser ? os::Membership::add : os::Membership::remove;
    os::Arguments const command{"/usr/sbin/usermod", "-G",
                                os::supplementaryGroups(identity, group, change), member};
    Ran const changed = os::runLogged(*this, command, params, scope);
    return changed.status != 0 && !holds(changed.output, "is primary group name");
}

} // namespace NQ
