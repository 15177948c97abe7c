#include "mihost/cli/output/NodeTree.h"

#include "host/Properties.h"
#include "mihost/cli/input/Address.h"
#include "mihost/cli/output/NodeJson.h"
#include "mihost/cli/output/PropertyText.h"
#include "mihost/cli/output/Style.h"
#include "mihost/cli/output/TreeLayout.h"
#include "mihost/runtime/Text.h"

#include <fmt/format.h>
#include <unordered_map>

namespace mihost
{

namespace
{

/** @return the most useful value of a node besides its description; empty for none */
std::string headlineOf(IC::MutableNode const& node)
{
    NodeKind const* const kind = findKind(node.getNodeType());
    return kind && kind->headline != 0 ? storedText(node, kind->headline) : "";
}

std::string textOf(IC::MutableNode const& node)
{
    std::string const description = printable(node.getDescription());
    std::string const headline = printable(headlineOf(node));
    return description + (headline.empty() ? "" : ": " + headline);
}

/** The kinds of which there are many, each in its own colour. */
Style styleOf(unsigned int nodeType)
{
    switch (nodeType) {
    case IC::nodeType::driver:
        return Style::Cyan;
    case IC::nodeType::user:
        return Style::Green;
    case IC::nodeType::group:
        return Style::Yellow;
    default:
        return Style::Bold;
    }
}

std::vector<Branch> branchesOf(std::vector<IC::MutableNode*> const& nodes, TreeStyle const& style)
{
    std::unordered_map<unsigned int, std::size_t> places;
    std::vector<Branch> branches;
    for (IC::MutableNode const* node : nodes) {
        auto const parent = places.find(node->getLinkedId());
        Branch branch{parent == places.end() ? branches.size() : parent->second,
                      styled(styleOf(node->getNodeType()), printable(addressOf(*node))) +
                          styled(Style::Faint, fmt::format(" #{}", node->getNodeId())),
                      textOf(*node),
                      {}};
        if (style.properties)
            branch.details = propertyGrid(storedView(*node, style.secrets).properties);
        places[node->getNodeId()] = branches.size();
        branches.push_back(std::move(branch));
    }
    return branches;
}

Json documentOf(std::vector<IC::MutableNode*> const& nodes, Secrets secrets)
{
    Json list = Json::array();
    for (IC::MutableNode const* node : nodes)
        list.push_back(toJson(storedView(*node, secrets)));
    return list;
}

Table tableOf(std::vector<IC::MutableNode*> const& nodes)
{
    Table table({{"id"}, {"parent"}, {"kind"}, {"address"}, {"description"}, {"headline"}});
    for (IC::MutableNode const* node : nodes)
        table.add({std::to_string(node->getNodeId()), std::to_string(node->getLinkedId()),
                   kindName(node->getNodeType()), addressOf(*node), node->getDescription(),
                   headlineOf(*node)});
    return table;
}

} // namespace

void writeTree(std::vector<IC::MutableNode*> const& nodes, TreeStyle const& style, Output& out)
{
    if (out.takesDocuments())
        out.json(documentOf(nodes, style.secrets));
    else if (out.takesRows())
        out.table(tableOf(nodes));
    else
        out.lines(layOut(branchesOf(nodes, style), out.room()));
}

} // namespace mihost
