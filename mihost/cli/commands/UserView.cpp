#include "mihost/cli/commands/UserView.h"

#include "mihost/cli/accounts/UserDescription.h"
#include "mihost/cli/commands/Facts.h"
#include "mihost/cli/commands/UnknownName.h"
#include "mihost/cli/input/Day.h"
#include "mihost/cli/output/UnknownValues.h"
#include "mihost/cli/plugin/Session.h"

#include <ctime>
#include <fmt/format.h>
#include <fmt/ranges.h>

namespace mihost
{

namespace
{

constexpr std::time_t secondsOfDay = 86400;

/** As the account tools count: in UTC. */
long today()
{
    return static_cast<long>(std::time(nullptr) / secondsOfDay);
}

char const* passwordText(PasswordState state)
{
    switch (state) {
    case PasswordState::Set:
        return "set";
    case PasswordState::Locked:
        return "locked";
    case PasswordState::Unusable:
        return "unusable";
    case PasswordState::None:
        return "none";
    case PasswordState::Unknown:
        break;
    }
    return "";
}

std::string groupText(NamedGroup const& group)
{
    return group.name.empty() ? fmt::format("{} (no group has this id)", group.id)
                              : fmt::format("{} ({})", group.name, group.id);
}

std::string groupsText(std::vector<NamedGroup> const& groups)
{
    std::vector<std::string> texts;
    texts.reserve(groups.size());
    for (NamedGroup const& group : groups)
        texts.push_back(groupText(group));
    return fmt::format("{}", fmt::join(texts, ", "));
}

std::string dateText(long number)
{
    auto const day = dayOfNumber(number);
    return day ? dayText(*day) : fmt::format("day {}", number);
}

std::string dateWithDistance(long day)
{
    return fmt::format("{} ({})", dateText(day), relativeDay(day, today()));
}

/** @param otherwise  if the day does not come */
std::string dateOr(std::optional<long> const& day, char const* otherwise)
{
    return day ? dateWithDistance(*day) : otherwise;
}

std::vector<Fact> passwordFacts(UserDescription const& user)
{
    PasswordAgeing const& ageing = user.ageing;
    bool const isKnown = user.unknown.empty();
    bool const isWaiting = ageing.changeableFrom.value_or(0) > today();
    auto const changeDay = isWaiting ? ageing.changeableFrom : std::nullopt;
    return {
        {"State", accountState(user, today())},
        {"Password", passwordText(user.password)},
        {"Password changed",
         ageing.mustChange ? "to be changed at the next login" : dateOr(ageing.changed, "")},
        {"Change allowed", isKnown ? dateOr(changeDay, "at any time") : ""},
        {"Warned from", dateOr(ageing.warnsFrom, "")},
        {"Password valid until", isKnown ? dateOr(ageing.lastValid, "no limit") : ""},
        {"Active until", isKnown ? dateOr(ageing.lastActive, "no limit") : ""},
        {"Account expires", isKnown ? dateOr(user.expires, "never") : ""},
    };
}

std::vector<Fact> factsOf(UserDescription const& user)
{
    std::vector<Fact> facts = {
        {"User", user.name},
        {"Full name", user.fullName},
        {"UID", std::to_string(user.id)},
        {"Primary group", groupText(user.primaryGroup)},
        {"Other groups", groupsText(user.otherGroups)},
        {"Home directory", user.home},
        {"Login shell", user.shell},
    };
    for (Fact const& fact : passwordFacts(user))
        facts.push_back(fact);
    facts.push_back({"Login failures", user.loginFailures == 0
                                           ? "not limited"
                                           : fmt::format("{} allowed", user.loginFailures)});
    facts.push_back({"Node", user.noNode.empty() ? "user:" + user.name : "none: " + user.noNode});
    return facts;
}

Json documentOf(NamedGroup const& group)
{
    return {{"name", group.name.empty() ? Json(nullptr) : toJson(group.name)}, {"gid", group.id}};
}

Json dayToJson(std::optional<long> const& day)
{
    return day ? Json(dateText(*day)) : Json(nullptr);
}

Json countToJson(std::optional<long> const& days)
{
    return days ? Json(*days) : Json(nullptr);
}

Json orNull(std::string const& text)
{
    return text.empty() ? Json(nullptr) : toJson(text);
}

Json documentOf(UserDescription const& user)
{
    PasswordAgeing const& ageing = user.ageing;
    Json groups = Json::array();
    for (NamedGroup const& group : user.otherGroups)
        groups.push_back(documentOf(group));
    Json const daysLeft = ageing.lastValid ? Json(*ageing.lastValid - today()) : Json(nullptr);
    Json document = {
        {"user", toJson(user.name)},
        {"full-name", toJson(user.fullName)},
        {"uid", user.id},
        {"primary-group", documentOf(user.primaryGroup)},
        {"other-groups", groups},
        {"home-directory", toJson(user.home)},
        {"login-shell", toJson(user.shell)},
        {"state", orNull(accountState(user, today()))},
        {"password", orNull(passwordText(user.password))},
        {"password-changed", dayToJson(ageing.changed)},
        {"must-change-password", user.unknown.empty() ? Json(ageing.mustChange) : Json(nullptr)},
        {"min-days", countToJson(ageing.minDays)},
        {"max-days", countToJson(ageing.maxDays)},
        {"warn-days", countToJson(ageing.warnDays)},
        {"inactive-days", countToJson(ageing.inactiveDays)},
        {"change-allowed-from", dayToJson(ageing.changeableFrom)},
        {"warned-from", dayToJson(ageing.warnsFrom)},
        {"password-valid-until", dayToJson(ageing.lastValid)},
        {"password-days-left", daysLeft},
        {"active-until", dayToJson(ageing.lastActive)},
        {"account-expires", dayToJson(user.expires)},
        {"login-failures-allowed",
         user.loginFailures == 0 ? Json(nullptr) : Json(user.loginFailures)},
        {"node", user.noNode.empty() ? toJson("user:" + user.name) : Json(nullptr)},
        {"no-node", orNull(user.noNode)}};
    if (!user.unknown.empty())
        document["unknown"] = toJson(user.unknown);
    return document;
}

} // namespace

void showUser(Session& session, std::string const& name)
{
    AccountData const data = readAccountData();
    auto const user = describeUser(data, name);
    if (!user)
        failForUnknownAccount(name);
    if (session.out().takesDocuments())
        session.out().json(documentOf(*user));
    else
        writeFacts(factsOf(*user), session.out());
    noteUnknown(user->unknown);
}

} // namespace mihost
