#include "mihost/cli/accounts/UserDescription.h"

#include "mihost/cli/input/Decimal.h"

#include <algorithm>
#include <cstdlib>
#include <fmt/format.h>

namespace mihost
{

namespace
{

/** Contract of the account tools: a password this old never expires. */
constexpr long neverExpires = 10000;

/** Nothing for an empty field, -1 and texts that are not numbers. */
std::optional<long> daysOf(std::string const& field)
{
    auto const days = parseDecimal(field);
    return days ? std::optional<long>(*days) : std::nullopt;
}

std::optional<long> sum(std::optional<long> first, std::optional<long> second)
{
    return first && second ? std::optional(*first + *second) : std::nullopt;
}

PasswordAgeing ageingOf(Record const& shadow)
{
    auto const field = [&shadow](int at) { return daysOf(shadow[static_cast<std::size_t>(at)]); };
    PasswordAgeing ageing;
    ageing.changed = field(shadowField::LastChange);
    if (ageing.changed == 0L) {
        ageing.mustChange = true;
        ageing.changed.reset();
    }
    ageing.minDays = field(shadowField::MinDays);
    ageing.maxDays = field(shadowField::MaxDays);
    ageing.warnDays = field(shadowField::WarnDays);
    ageing.inactiveDays = field(shadowField::Inactive);
    ageing.changeableFrom = sum(ageing.changed, ageing.minDays);
    if (!ageing.maxDays || *ageing.maxDays >= neverExpires)
        return ageing;
    ageing.lastValid = sum(ageing.changed, ageing.maxDays);
    if (ageing.lastValid && ageing.warnDays)
        ageing.warnsFrom = *ageing.lastValid - *ageing.warnDays;
    ageing.lastActive = sum(ageing.lastValid, ageing.inactiveDays);
    return ageing;
}

/** Contract: the first entry of an id or a name counts, as for libc. */
NamedGroup groupOfId(AccountData const& data, unsigned int id)
{
    for (std::string const& line : data.files.at(groupFile)) {
        Record const group = fieldsOf(line, ':');
        if (group.size() > groupField::Id && parseDecimal(group[groupField::Id]) == id)
            return {id, group[0]};
    }
    return {id, ""};
}

std::vector<NamedGroup> groupsThatList(AccountData const& data, std::string const& name)
{
    std::vector<NamedGroup> groups;
    for (std::string const& line : data.files.at(groupFile)) {
        Record const group = fieldsOf(line, ':');
        if (group.size() <= groupField::Members)
            continue;
        auto const members = fieldsOf(group[groupField::Members], ',');
        auto const id = parseDecimal(group[groupField::Id]);
        if (id && std::find(members.begin(), members.end(), name) != members.end())
            groups.push_back({*id, group[0]});
    }
    return groups;
}

void addPassword(UserDescription& user, AccountData const& data, std::string const& inAccount)
{
    constexpr char inShadow[] = "x";
    Record const shadow = recordIn(data.files.at(shadowFile), user.name);
    if (!shadow.empty()) {
        user.ageing = ageingOf(shadow);
        user.expires = daysOf(shadow[shadowField::Expiry]);
    }
    if (inAccount != inShadow)
        user.password = passwordState(inAccount);
    else if (!shadow.empty())
        user.password = passwordState(shadow[shadowField::Password]);
    else if (!data.shadowProblem.empty())
        user.unknown = fmt::format("{} cannot be read: {}", shadowFile, data.shadowProblem);
    else
        user.unknown = fmt::format("'{}' has no entry in {}", user.name, shadowFile);
}

std::string stateOfPassword(UserDescription const& user, long today)
{
    auto const& ageing = user.ageing;
    if (ageing.mustChange)
        return "active; the password must be changed at the next login";
    if (!ageing.lastValid)
        return "active";
    if (today > *ageing.lastValid)
        return fmt::format("active; the password expired {} and must be changed at the next login",
                           relativeDay(*ageing.lastValid, today));
    if (ageing.warnsFrom && today > *ageing.warnsFrom)
        return fmt::format("active; the password expires {}",
                           relativeDay(*ageing.lastValid, today));
    return "active";
}

} // namespace

PasswordState passwordState(std::string const& stored)
{
    if (stored.empty())
        return PasswordState::None;
    if (stored[0] == '!')
        return PasswordState::Locked;
    // A hash by any method begins with $, or is one of the two old forms of 13 and 20 characters.
    constexpr std::size_t shortestHash = 13;
    bool const isHash = stored[0] == '$' || stored.size() >= shortestHash;
    return isHash ? PasswordState::Set : PasswordState::Unusable;
}

std::optional<UserDescription> describeUser(AccountData const& data, std::string const& name)
{
    Record const account = recordIn(data.files.at(accountFile), name);
    if (account.empty())
        return std::nullopt;
    auto const id = parseDecimal(account[accountField::Id]);
    auto const group = parseDecimal(account[accountField::Group]);
    if (!id || !group)
        return std::nullopt;
    UserDescription user{};
    user.name = name;
    user.id = *id;
    user.fullName = account[accountField::Comment];
    user.home = account[accountField::Home];
    user.shell = account[accountField::Shell];
    user.primaryGroup = groupOfId(data, *group);
    user.otherGroups = groupsThatList(data, name);
    addPassword(user, data, account[accountField::Password]);
    user.loginFailures = allowedLoginFailures(data.loginRules);
    user.noNode = data.loginDefs.users().objectionTo("uid", *id);
    return user;
}

std::string accountState(UserDescription const& user, long today)
{
    if (user.expires && today >= *user.expires)
        return fmt::format("expired {}", relativeDay(*user.expires, today));
    if (user.ageing.lastActive && today > *user.ageing.lastActive)
        return fmt::format("inactive; the password expired {}",
                           relativeDay(*user.ageing.lastValid, today));
    switch (user.password) {
    case PasswordState::Unknown:
        return "";
    case PasswordState::Locked:
        return "locked";
    case PasswordState::Unusable:
        return "no login by password";
    case PasswordState::Set:
    case PasswordState::None:
        break;
    }
    return stateOfPassword(user, today);
}

std::string relativeDay(long day, long today)
{
    long const distance = std::labs(day - today);
    if (distance == 0)
        return "today";
    std::string const days = fmt::format("{} {}", distance, distance == 1 ? "day" : "days");
    return day > today ? "in " + days : days + " ago";
}

} // namespace mihost
