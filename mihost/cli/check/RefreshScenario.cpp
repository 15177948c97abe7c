#include "host/Properties.h"
#include "mihost/cli/check/Accounts.h"
#include "mihost/cli/check/LogRules.h"
#include "mihost/cli/check/PropertyRules.h"
#include "mihost/cli/check/Scenarios.h"
#include "mihost/cli/check/Subject.h"

#include <algorithm>
#include <fmt/format.h>
#include <map>
#include <set>

namespace mihost::checks
{

namespace
{

struct Identity {
    unsigned int id;
    unsigned int type;
};

/** The tree before the refresh. */
std::vector<Identity>& before()
{
    static std::vector<Identity> identities;
    return identities;
}

std::set<unsigned int> idsOf(std::vector<SeenNode> const& nodes)
{
    std::set<unsigned int> ids;
    for (SeenNode const& node : nodes)
        ids.insert(node.id);
    return ids;
}

Verdict refreshAnswer(Subject& subject)
{
    subject.initialize();
    before().clear();
    for (IC::MutableNode const* node : subject.nodes())
        before().push_back({node->getNodeId(), node->getNodeType()});
    subject.events().forget();
    IC::Error const error = refresh(subject);
    Findings findings;
    if (error.getStatus() != 0)
        findings.push_back(fmt::format("the write returned: {}", static_cast<std::string>(error)));
    IC::PropertyValue value(IC::PropertyValue::EmptyKind, true);
    subject.os().getProperty(IC::property::refresh, value);
    if (static_cast<std::string>(value) != "0")
        findings.push_back(fmt::format("the property then reads '{}' rather than '0'",
                                       static_cast<std::string>(value)));
    return {findings};
}

Verdict deleted(Subject& subject)
{
    Findings findings;
    auto const& events = subject.events().deleted();
    std::set<unsigned int> const ids = idsOf(events);
    if (ids.size() != events.size())
        findings.emplace_back("a node was deleted twice");
    for (Identity const& node : before())
        if (isAccount(node.type) != (ids.count(node.id) != 0))
            findings.push_back(
                fmt::format("node #{} was {}deleted", node.id, isAccount(node.type) ? "not " : ""));
    return {findings};
}

Verdict ids(Subject& subject)
{
    unsigned int highest = 0;
    for (Identity const& node : before())
        highest = std::max(highest, node.id);
    Findings findings;
    std::set<unsigned int> seen;
    for (IC::MutableNode const* node : subject.nodes())
        if (!seen.insert(node->getNodeId()).second)
            findings.push_back(fmt::format("{}: another node has this id, too", nameOf(*node)));
    for (IC::MutableNode const* node : accountsOf(subject.nodes()))
        if (node->getNodeId() <= highest)
            findings.push_back(fmt::format("{}: not a new id", nameOf(*node)));
    return {findings};
}

Verdict published(Subject& subject)
{
    Findings findings;
    std::map<IC::Node const*, unsigned int> times;
    for (SeenNode const& node : subject.events().published())
        ++times[node.node];
    for (IC::MutableNode const* node : subject.nodes()) {
        unsigned int const expected = isAccount(node->getNodeType()) ? 1 : 0;
        if (times[node] != expected)
            findings.push_back(fmt::format("{}: published {} times rather than {}", nameOf(*node),
                                           times[node], expected));
        times.erase(node);
    }
    if (!times.empty())
        findings.push_back(fmt::format("{} nodes were published and are not listed", times.size()));
    return {findings};
}

Verdict sameTree(Subject& subject)
{
    Nodes const nodes = subject.nodes();
    Findings findings;
    std::size_t const count = nodes.size();
    if (count != before().size())
        findings.push_back(fmt::format("{} nodes rather than {}", count, before().size()));
    for (auto const& wrong :
         {wrongTypes(nodes), wrongParents(nodes), wrongIndexes(nodes), wrongStatuses(nodes),
          wrongDescriptions(nodes), wrongMiIds(nodes, Subject::ownId), wrongPropertyIds(nodes),
          wrongKinds(nodes), wrongFlags(nodes), wrongValues(accountsOf(nodes))})
        findings.insert(findings.end(), wrong.begin(), wrong.end());
    return {findings};
}

} // namespace

Scenario refreshScenario()
{
    std::vector<Check> checks = {
        {"answer", "writing 0 to refresh returns 0 and stores the 0", refreshAnswer},
        {"deleted", "each user and group node is deleted once, and no other", deleted},
        {"node-ids", "the new nodes have new ids", ids},
        {"published", "each new node is published once, and no other", published},
        {"tree", "the new nodes are the same as at the start", sameTree},
    };
    for (Check const& check : logChecks())
        checks.push_back(check);
    return {"refresh", checks};
}

} // namespace mihost::checks
