#include "mihost/cli/check/TreeRules.h"

#include "host/Properties.h"
#include "mihost/cli/catalogue/Catalogue.h"

#include <fmt/format.h>
#include <iterator>
#include <map>

namespace mihost::checks
{

namespace
{

struct KindRule {
    unsigned int type;
    unsigned int parentType; // 0 for none
    char const* description; // null if each node has its own
};

// In the order in which the kinds are built.
constexpr KindRule kindRules[] = {
    {IC::nodeType::osSw, 0, "OsSw Management Interface"},
    {IC::nodeType::root, IC::nodeType::osSw, "ROOT Node"},
    {IC::nodeType::computer, IC::nodeType::root, "Computer"},
    {IC::nodeType::operatingSystem, IC::nodeType::computer, "Operating System"},
    {IC::nodeType::driver, IC::nodeType::operatingSystem, nullptr},
    {IC::nodeType::user, IC::nodeType::operatingSystem, "User Account"},
    {IC::nodeType::group, IC::nodeType::operatingSystem, "Group"},
    {IC::nodeType::log, IC::nodeType::operatingSystem, "OS Log"},
    {IC::nodeType::logEntry, IC::nodeType::log, "OS LogEntry"},
};

KindRule const* ruleFor(IC::MutableNode const& node)
{
    for (KindRule const& rule : kindRules)
        if (rule.type == node.getNodeType())
            return &rule;
    return nullptr;
}

bool isSingle(unsigned int type)
{
    NodeKind const* const kind = findKind(type);
    return kind && kind->single;
}

/** Compares a number of every node with the one expected. */
template <class Number, class Expected>
Findings wrongNumbers(Nodes const& nodes, char const* what, Number number, Expected expected)
{
    Findings findings;
    for (IC::MutableNode const* node : nodes) {
        unsigned int const found = number(*node);
        if (unsigned int const wanted = expected(*node); found != wanted)
            findings.push_back(
                fmt::format("{}: {} {} rather than {}", nameOf(*node), what, found, wanted));
    }
    return findings;
}

} // namespace

std::string nameOf(IC::MutableNode const& node)
{
    return fmt::format("{} #{}", kindName(node.getNodeType()), node.getNodeId());
}

Findings wrongTypes(Nodes const& nodes)
{
    Findings findings;
    std::map<unsigned int, unsigned int> counts;
    for (IC::MutableNode const* node : nodes) {
        ++counts[node->getNodeType()];
        if (!ruleFor(*node))
            findings.push_back(fmt::format("node #{}: unknown node type {}", node->getNodeId(),
                                           node->getNodeType()));
    }
    for (KindRule const& rule : kindRules)
        if (isSingle(rule.type) && counts[rule.type] != 1)
            findings.push_back(fmt::format("{} nodes of the kind {} rather than 1",
                                           counts[rule.type], kindName(rule.type)));
    return findings;
}

Findings wrongTypeOrder(Nodes const& nodes)
{
    Findings findings = wrongTypes(nodes);
    KindRule const* latest = std::begin(kindRules);
    for (IC::MutableNode const* node : nodes) {
        KindRule const* const rule = ruleFor(*node);
        if (rule && rule < latest)
            findings.push_back(fmt::format("{}: listed after a node of the kind {}", nameOf(*node),
                                           kindName(latest->type)));
        else if (rule)
            latest = rule;
    }
    return findings;
}

Findings wrongIds(Nodes const& nodes, unsigned int ownId)
{
    unsigned int next = ownId;
    return wrongNumbers(
        nodes, "node id", [](IC::MutableNode const& node) { return node.getNodeId(); },
        [&next](IC::MutableNode const&) { return next++; });
}

Findings wrongParents(Nodes const& nodes)
{
    std::map<unsigned int, unsigned int> ids; // of single nodes, by type
    for (IC::MutableNode const* node : nodes)
        ids.emplace(node->getNodeType(), node->getNodeId());
    return wrongNumbers(
        nodes, "parent id", [](IC::MutableNode const& node) { return node.getLinkedId(); },
        [&ids](IC::MutableNode const& node) {
            KindRule const* const rule = ruleFor(node);
            return rule && rule->parentType != 0 ? ids[rule->parentType] : 0;
        });
}

Findings wrongIndexes(Nodes const& nodes)
{
    std::map<unsigned int, unsigned int> last; // by type
    return wrongNumbers(
        nodes, "index", [](IC::MutableNode const& node) { return node.getIndex(); },
        [&last](IC::MutableNode const& node) {
            return isSingle(node.getNodeType()) ? 0 : ++last[node.getNodeType()];
        });
}

Findings wrongStatuses(Nodes const& nodes)
{
    return wrongNumbers(
        nodes, "status", [](IC::MutableNode const& node) { return node.getStatus(); },
        [](IC::MutableNode const&) { return IC::statusOk; });
}

Findings wrongDescriptions(Nodes const& nodes)
{
    Findings findings;
    for (IC::MutableNode const* node : nodes) {
        KindRule const* const rule = ruleFor(*node);
        std::string const found = node->getDescription();
        if (rule && rule->description && found != rule->description)
            findings.push_back(fmt::format("{}: description '{}' rather than '{}'", nameOf(*node),
                                           found, rule->description));
        else if (found.empty())
            findings.push_back(fmt::format("{}: no description", nameOf(*node)));
    }
    return findings;
}

Findings wrongMiIds(Nodes const& nodes, unsigned int ownId)
{
    Findings findings;
    for (IC::MutableNode const* node : nodes)
        if (node->getMIIds() != std::vector<unsigned int>{ownId})
            findings.push_back(
                fmt::format("{}: its list of interface ids is not {{{}}}", nameOf(*node), ownId));
    return findings;
}

} // namespace mihost::checks
