#include "host/Properties.h"
#include "mihost/cli/accounts/LoginDefs.h"
#include "mihost/cli/check/Accounts.h"
#include "mihost/cli/check/LogRules.h"
#include "mihost/cli/check/Scenarios.h"
#include "mihost/cli/check/Subject.h"
#include "mihost/cli/plugin/CommandTap.h"

#include <fmt/format.h>
#include <grp.h>
#include <unistd.h>

namespace mihost::checks
{

namespace
{

constexpr char groupName[] = "mihostck";
constexpr char groupTool[] = "/usr/sbin/groupadd";

IC::Error call(Subject& subject, std::string const& text)
{
    return subject.os().setProperty(IC::property::createUser, IC::PropertyValue(text, true));
}

std::string methodText(Subject& subject)
{
    IC::PropertyValue value(IC::PropertyValue::EmptyKind, true);
    subject.os().getProperty(IC::property::createUser, value);
    return value.getKind() == IC::PropertyValue::TextKind ? static_cast<std::string>(value)
                                                          : std::string("(not a text)");
}

std::string addition()
{
    return fmt::format("LocalGroupAdd,GroupName:CMPI_string:{}", groupName);
}

std::string lastMessage(Subject const& subject)
{
    auto const calls = subject.log();
    return calls.empty() ? "" : calls.back().text;
}

Verdict failure(Subject& subject)
{
    subject.initialize();
    subject.events().forget();
    IC::Error const error = call(subject, "NoSuchMethod,GroupName:CMPI_string:nobody");
    Findings findings;
    if (error.getStatus() != 1)
        findings.push_back(
            fmt::format("an unknown method: status {} rather than 1", +error.getStatus()));
    if (std::string const text = methodText(subject); !text.empty())
        findings.push_back(fmt::format("an unknown method: '{}' is stored rather than ''", text));
    auto const& events = subject.events();
    if (!events.deleted().empty() || !events.published().empty())
        findings.emplace_back("an unknown method: nodes were replaced");
    return {findings};
}

/** Why the check cannot add a group here, if it cannot. */
std::optional<std::string> obstacle()
{
    if (access(groupTool, X_OK) != 0)
        return fmt::format("no {} here", groupTool);
    if (getgrnam(groupName))
        return fmt::format("the group {} exists here", groupName);
    std::string const said = commandTap::outputOf(
        fmt::format("{0} {1} 2>&1; /usr/sbin/groupdel {1} 2>&1", groupTool, groupName));
    if (!said.empty())
        return fmt::format("a group cannot be added here: {}", said);
    return std::nullopt;
}

Verdict success(Subject& subject)
{
    if (auto const reason = obstacle())
        return skippedFor(*reason);
    subject.events().forget();
    IC::Error const error = call(subject, addition());
    Findings findings;
    if (error.getStatus() != 0)
        findings.push_back(fmt::format("LocalGroupAdd: status {} rather than 0; last message: {}",
                                       +error.getStatus(), lastMessage(subject)));
    if (std::string const text = methodText(subject); text != addition())
        findings.push_back(
            fmt::format("LocalGroupAdd: '{}' is stored rather than '{}'", text, addition()));
    if (!getgrnam(groupName))
        findings.emplace_back("LocalGroupAdd: the group does not exist");
    return {findings};
}

bool isShown(Subject& subject)
{
    for (IC::MutableNode const* node : subject.nodes()) {
        IC::PropertyValue value(IC::PropertyValue::EmptyKind, true);
        if (node->getNodeType() == IC::nodeType::group &&
            node->getProperty(IC::property::name, value).getStatus() == 0 &&
            static_cast<std::string>(value) == groupName)
            return true;
    }
    return false;
}

Verdict groupNode(Subject& subject)
{
    group const* const made = getgrnam(groupName);
    if (!made)
        return skippedFor("no group was added");
    std::string const objection = readLoginDefs().groups().objectionTo("gid", made->gr_gid);
    if (!objection.empty())
        return skippedFor(objection);
    if (!isShown(subject))
        return {{"the new group has no node"}};
    return {};
}

} // namespace

Scenario methodScenario()
{
    std::vector<Check> checks = {
        {"failure", "an unknown method returns 1 and empties the property", failure},
        {"success", "LocalGroupAdd returns 0, stores the call and adds the group", success},
        {"group-node", "the new group has a node", groupNode},
    };
    for (Check const& check : logChecks())
        checks.push_back(check);
    return {"method", checks};
}

} // namespace mihost::checks
