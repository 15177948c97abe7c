#include "mihost/cli/input/Address.h"

#include "mihost/cli/input/Decimal.h"
#include "mihost/cli/input/Suggestion.h"
#include "mihost/cli/system/Failure.h"

#include <algorithm>
#include <fmt/format.h>

namespace mihost
{

namespace
{

constexpr char forms[] =
    "an id, mi, root, computer, os, log, user:NAME, group:NAME, driver:NAME or log:INDEX";

bool matches(Address const& address, IC::MutableNode const& node)
{
    if (!address.kind)
        return node.getNodeId() == address.id;
    if (node.getNodeType() != address.kind->type)
        return false;
    return address.kind->single || storedText(node, address.kind->nameProperty) == address.name;
}

/** @return the name of a node of that kind that is similar to the address's; empty for none */
std::string nameMeant(std::vector<IC::MutableNode*> const& nodes, Address const& address)
{
    if (!address.kind || address.kind->single || parseDecimal(address.name))
        return "";
    std::vector<std::string> names;
    for (IC::MutableNode const* node : nodes)
        if (node->getNodeType() == address.kind->type)
            names.push_back(storedText(*node, address.kind->nameProperty));
    return nearest(address.name, names);
}

} // namespace

Address parseAddress(std::string const& text)
{
    if (auto const id = parseDecimal(text))
        return {nullptr, *id, ""};
    std::size_t const colon = text.find(':');
    bool const single = colon == std::string::npos;
    std::string const word = text.substr(0, colon);
    for (NodeKind const& kind : nodeKinds())
        if (kind.single == single && kind.address == word)
            return {&kind, 0, single ? "" : text.substr(colon + 1)};
    for (NodeKind const& kind : nodeKinds())
        if (!kind.single && (word == kind.address || word == kind.listName))
            throw Failure(NotFound,
                          fmt::format("no node '{}' (write {}:NAME; see 'mihost list {}')", text,
                                      kind.address, kind.listName));
    throw Failure(NotFound, fmt::format("no node '{}' (use {})", text, forms));
}

std::vector<IC::MutableNode*> nodesOf(IC::ManagementInterface& interface)
{
    std::vector<IC::Node*> all;
    interface.getMap(all);
    std::vector<IC::MutableNode*> nodes;
    nodes.reserve(all.size());
    for (IC::Node* const node : all)
        if (auto* const known = dynamic_cast<IC::MutableNode*>(node))
            nodes.push_back(known);
    return nodes;
}

IC::MutableNode& findNode(std::vector<IC::MutableNode*> const& nodes, std::string const& address)
{
    Address const wanted = parseAddress(address);
    auto const found = std::find_if(nodes.begin(), nodes.end(),
                                    [&wanted](auto const* node) { return matches(wanted, *node); });
    if (found != nodes.end())
        return **found;
    std::string const meant = nameMeant(nodes, wanted);
    throw Failure(NotFound, fmt::format("no node '{}' in the tree ({})", address,
                                        meant.empty() ? "see 'mihost tree'"
                                                      : fmt::format("did you mean {}:{}?",
                                                                    wanted.kind->address, meant)));
}

std::string storedText(IC::MutableNode const& node, unsigned int property)
{
    auto const properties = node.getProperties();
    auto const found = properties.find(property);
    return found == properties.end() ? "" : static_cast<std::string>(found->second);
}

std::string addressOf(IC::MutableNode const& node)
{
    NodeKind const* const kind = findKind(node.getNodeType());
    if (!kind)
        return std::to_string(node.getNodeId());
    return kind->single ? kind->address
                        : fmt::format("{}:{}", kind->address, storedText(node, kind->nameProperty));
}

} // namespace mihost
