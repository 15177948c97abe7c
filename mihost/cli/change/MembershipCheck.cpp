#include "mihost/cli/change/MembershipCheck.h"

#include "host/Methods.h"
#include "mihost/cli/input/Decimal.h"
#include "mihost/cli/input/InputValidation.h"
#include "mihost/cli/plugin/CommandTap.h"
#include "mihost/cli/system/Failure.h"
#include "mihost/cli/system/TextFile.h"
#include "mihost/runtime/Text.h"

#include <algorithm>
#include <fmt/format.h>
#include <grp.h>

namespace mihost
{

namespace
{

/** Reads a text from its beginning; each step removes its part if the text has it. */
class Reader
{
public:
    explicit Reader(std::string_view text) : rest_(text) {}

    bool take(std::string_view part)
    {
        if (rest_.substr(0, part.size()) != part)
            return false;
        rest_.remove_prefix(part.size());
        return true;
    }

    /** An id and, in parentheses, its name; groups without a name have none. */
    std::optional<Group> takeGroup()
    {
        std::size_t const digits = std::min(rest_.find_first_not_of("0123456789"), rest_.size());
        auto const id = parseDecimal(std::string(rest_.substr(0, digits)));
        if (!id)
            return std::nullopt;
        rest_.remove_prefix(digits);
        Group group{*id, ""};
        if (!take("("))
            return group;
        std::size_t const end = rest_.find_first_of("()");
        if (end == std::string_view::npos || end == 0 || rest_[end] != ')')
            return std::nullopt;
        group.name = rest_.substr(0, end);
        rest_.remove_prefix(end + 1);
        return group;
    }

    bool isAtEnd() const
    {
        return rest_.empty();
    }

private:
    std::string_view rest_;
};

/** @return the text without id's warnings about groups without a name, which the plug-in skips */
std::string_view withoutWarnings(std::string_view text)
{
    constexpr std::string_view warning = "id: cannot find name for group ID ";
    while (text.substr(0, warning.size()) == warning)
        text.remove_prefix(std::min(text.find('\n'), text.size() - 1) + 1);
    return text;
}

/** Whether usermod reads the text as a GID, even if a group has that name. */
bool isReadAsId(std::string_view name)
{
    if (!name.empty() && (name[0] == '+' || name[0] == '-'))
        name.remove_prefix(1);
    return !name.empty() && name.find_first_not_of("0123456789") == std::string_view::npos;
}

/** @param form  the primary group's name goes into the command line without quotes */
std::optional<std::string> objectionToGroup(Group const& group, Form form,
                                            FindGroup const& findGroup)
{
    if (group.name.empty())
        return std::nullopt;
    auto const because = [&group](std::string const& reason) {
        return fmt::format("its group '{}' {}", printable(group.name), reason);
    };
    if (isReadAsId(group.name))
        return because("has a name that usermod reads as a GID");
    if (auto const reason = objection(form, group.name))
        return because(*reason);
    if (group.name.find(misjudgedWord) != std::string::npos)
        return because(
            fmt::format("contains '{}', so the plug-in would report the change as failed "
                        "even if it succeeds",
                        misjudgedWord));
    auto const found = findGroup(group.name);
    if (!found)
        return because("is not found by usermod");
    if (*found != group.id)
        return because(fmt::format("has GID {}, but usermod finds GID {}", group.id, *found));
    return std::nullopt;
}

std::optional<unsigned int> groupOfMachine(std::string const& name)
{
    group const* const found = getgrnam(name.c_str());
    return found ? std::optional(found->gr_gid) : std::nullopt;
}

bool isMembershipChange(MethodCall const& call)
{
    std::string_view const name = call.method->name;
    return name == IC::method::localGroupAddUser || name == IC::method::localGroupDelUser;
}

} // namespace

std::optional<Identity> parseIdentity(std::string_view text)
{
    Reader reader(withoutWarnings(text));
    Identity identity;
    if (!reader.take("uid="))
        return std::nullopt;
    auto const user = reader.takeGroup(); // of the same form
    if (!user || !reader.take(" gid="))
        return std::nullopt;
    identity.user = user->name;
    auto const primary = reader.takeGroup();
    if (!primary || !reader.take(" groups="))
        return std::nullopt;
    identity.primary = *primary;
    do {
        auto const group = reader.takeGroup();
        if (!group)
            return std::nullopt;
        identity.groups.push_back(*group);
    } while (reader.take(","));
    if (!reader.take("\n") || !reader.isAtEnd())
        return std::nullopt;
    return identity;
}

std::optional<std::string> objectionToIdentity(Identity const& identity, std::string const& member,
                                               FindGroup const& findGroup)
{
    if (identity.user != member)
        return fmt::format("id reads it as a UID, that of the account '{}'",
                           printable(identity.user));
    if (auto reason = objectionToGroup(identity.primary, Form::AccountName, findGroup))
        return reason;
    for (Group const& group : identity.groups)
        if (auto reason = objectionToGroup(group, Form::Words, findGroup))
            return reason;
    return std::nullopt;
}

void checkMembership(MethodCall const& call)
{
    if (!isMembershipChange(call))
        return;
    std::string const member = valueOf(call, IC::parameter::domainAndMember);
    std::string const said =
        commandTap::outputOf(fmt::format("LC_ALL=C /usr/bin/id \"{}\" 2>&1", member));
    // The plug-in stops there.
    if (said.find("gid") == std::string::npos)
        return;
    auto const identity = parseIdentity(said);
    auto const reason = identity ? objectionToIdentity(*identity, member, groupOfMachine)
                                 : "id printed: " + printable(linesOf(said).front()) +
                                       ", which is not its usual form";
    if (reason)
        throw Failure(BadUsage,
                      fmt::format("the groups of '{}' are not changed: {}", member, *reason));
}

} // namespace mihost
