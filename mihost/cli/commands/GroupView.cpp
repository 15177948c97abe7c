#include "mihost/cli/commands/GroupView.h"

#include "mihost/cli/accounts/GroupDescription.h"
#include "mihost/cli/commands/Facts.h"
#include "mihost/cli/commands/UnknownName.h"
#include "mihost/cli/plugin/Session.h"

#include <fmt/format.h>
#include <fmt/ranges.h>

namespace mihost
{

namespace
{

std::string memberText(GroupDescription::Member const& member)
{
    return member.hasAccount ? member.name : member.name + " (no such local account)";
}

std::vector<Fact> factsOf(GroupDescription const& group)
{
    std::vector<std::string> members;
    for (GroupDescription::Member const& member : group.listedMembers)
        members.push_back(memberText(member));
    return {
        {"Group", group.name},
        {"GID", std::to_string(group.id)},
        {"Primary group of", fmt::format("{}", fmt::join(group.primaryMembers, ", "))},
        {"Other members", fmt::format("{}", fmt::join(members, ", "))},
        {"Node", group.noNode.empty() ? "group:" + group.name : "none: " + group.noNode},
    };
}

Json documentOf(GroupDescription const& group)
{
    Json primary = Json::array();
    for (std::string const& name : group.primaryMembers)
        primary.push_back(toJson(name));
    Json listed = Json::array();
    for (GroupDescription::Member const& member : group.listedMembers)
        listed.push_back({{"user", toJson(member.name)}, {"account", member.hasAccount}});
    return {{"group", toJson(group.name)},
            {"gid", group.id},
            {"primary-group-of", primary},
            {"other-members", listed},
            {"node", group.noNode.empty() ? toJson("group:" + group.name) : Json(nullptr)},
            {"no-node", group.noNode.empty() ? Json(nullptr) : toJson(group.noNode)}};
}

} // namespace

void showGroup(Session& session, std::string const& name)
{
    AccountData const data = readAccountData();
    auto const group = describeGroup(data, name);
    if (!group)
        failForUnknownGroup(name);
    if (session.out().takesDocuments())
        session.out().json(documentOf(*group));
    else
        writeFacts(factsOf(*group), session.out());
}

} // namespace mihost
