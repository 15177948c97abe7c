#include "mihost/cli/output/NodeTable.h"

#include "mihost/cli/input/Suggestion.h"
#include "mihost/cli/output/TextTable.h"
#include "mihost/cli/system/Failure.h"
#include "mihost/runtime/Text.h"

#include <algorithm>
#include <fmt/format.h>

namespace mihost
{

namespace
{

struct Attribute {
    char const* name;
    std::string (*of)(IC::MutableNode const& node);
};

constexpr Attribute attributes[] = {
    {"id", [](IC::MutableNode const& node) { return std::to_string(node.getNodeId()); }},
    {"index", [](IC::MutableNode const& node) { return std::to_string(node.getIndex()); }},
    {"status", [](IC::MutableNode const& node) { return std::to_string(node.getStatus()); }},
    {"description", [](IC::MutableNode const& node) { return node.getDescription(); }},
};

std::vector<std::string> namesFor(NodeKind const& kind)
{
    std::vector<std::string> names = rowNames(kind.properties);
    for (Attribute const& attribute : attributes)
        names.emplace_back(attribute.name);
    return names;
}

} // namespace

NodeTable::NodeTable(NodeKind const& kind, std::vector<std::string> const& columns)
    : chosen_(!columns.empty())
{
    for (std::string const& name : chosen_ ? columns : kind.columns)
        columns_.push_back(columnOf(kind, name));
}

NodeTable::Column NodeTable::columnOf(NodeKind const& kind, std::string const& name)
{
    // A property first: an index that is read comes before the attribute of that name.
    for (Property const& property : kind.properties)
        if (property.name == name || std::to_string(property.id) == name)
            return {property.name, nullptr, property.id};
    for (Attribute const& attribute : attributes)
        if (attribute.name == name)
            return {attribute.name, attribute.of, 0};
    throw Failure(NotFound, fmt::format("no column '{}' for {}; {}", name, kind.listName,
                                        suggestion(name, namesFor(kind), "there are")));
}

std::string NodeTable::cell(Column const& column, NodeView const& view, ShownText const& shownText)
{
    if (column.attribute)
        return column.attribute(*view.node);
    for (PropertyView const& property : view.properties)
        if (property.id == column.property)
            return shownText(property);
    return "";
}

void NodeTable::write(std::vector<IC::MutableNode*> const& nodes, Secrets secrets, Output& out,
                      ShownText const& shownText) const
{
    std::vector<std::string> heading;
    for (Column const& column : columns_)
        heading.push_back(column.heading);
    TextTable table(heading);
    for (IC::MutableNode const* node : nodes) {
        NodeView const view = storedView(*node, secrets);
        std::vector<std::string> cells;
        for (Column const& column : columns_)
            cells.push_back(printable(cell(column, view, shownText)));
        table.add(cells);
    }
    for (std::string const& line : table.lines(out.room()))
        out.line(line);
}

Json NodeTable::json(std::vector<IC::MutableNode*> const& nodes, Secrets secrets) const
{
    Json list = Json::array();
    for (IC::MutableNode const* node : nodes) {
        NodeView view = storedView(*node, secrets);
        auto const isLeftOut = [this](PropertyView const& property) {
            return std::none_of(columns_.begin(), columns_.end(), [&property](auto const& column) {
                return column.property == property.id;
            });
        };
        if (chosen_)
            view.properties.erase(
                std::remove_if(view.properties.begin(), view.properties.end(), isLeftOut),
                view.properties.end());
        list.push_back(toJson(view));
    }
    return list;
}

} // namespace mihost
