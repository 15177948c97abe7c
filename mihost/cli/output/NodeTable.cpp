#include "mihost/cli/output/NodeTable.h"

#include "mihost/cli/output/NodeJson.h"

#include <algorithm>

namespace mihost
{

namespace
{

struct Attribute {
    char const* name;
    Cell (*of)(IC::MutableNode const& node);
};

Cell number(unsigned int value)
{
    return {value, std::to_string(value)};
}

constexpr Attribute nodeAttributes[] = {
    {"id", [](IC::MutableNode const& node) { return number(node.getNodeId()); }},
    {"index", [](IC::MutableNode const& node) { return number(node.getIndex()); }},
    {"status", [](IC::MutableNode const& node) { return number(node.getStatus()); }},
    {"description", [](IC::MutableNode const& node) { return Cell(node.getDescription()); }},
};

/** Properties come first: a property named index hides the attribute of that name. */
std::vector<Column> columnsOf(NodeKind const& kind)
{
    std::vector<Column> columns;
    for (Property const& property : kind.properties)
        columns.push_back({property.name, Column::Align::Left, std::to_string(property.id)});
    for (Attribute const& attribute : nodeAttributes)
        columns.push_back({attribute.name, Column::Align::Left, ""});
    return columns;
}

Cell cellOf(NodeView const& view, unsigned int id, PropertyStyle const& style)
{
    for (PropertyView const& property : view.properties)
        if (property.id == id) {
            Cell cell = cellOf(property);
            cell.text = style.text(property);
            return cell;
        }
    return {nullptr, ""};
}

Table tableOf(NodeKind const& kind, std::vector<NodeView> const& views, PropertyStyle const& style)
{
    Table table(columnsOf(kind), kind.columns);
    for (NodeView const& view : views) {
        std::vector<Cell> cells;
        for (Property const& property : kind.properties)
            cells.push_back(cellOf(view, property.id, style));
        for (Attribute const& attribute : nodeAttributes)
            cells.push_back(attribute.of(*view.node));
        table.add(std::move(cells));
    }
    return table;
}

/** Leaves the properties that are columns. */
void keepColumns(NodeView& view, std::vector<Column> const& columns)
{
    auto const isLeftOut = [&columns](PropertyView const& property) {
        return std::none_of(columns.begin(), columns.end(), [&property](Column const& column) {
            return column.name == nameOf(property);
        });
    };
    view.properties.erase(std::remove_if(view.properties.begin(), view.properties.end(), isLeftOut),
                          view.properties.end());
}

} // namespace

void writeNodes(NodeKind const& kind, std::vector<IC::MutableNode*> const& nodes,
                PropertyStyle const& style, Selection const& selection, Output& out)
{
    std::vector<NodeView> views;
    views.reserve(nodes.size());
    for (IC::MutableNode const* node : nodes)
        views.push_back(storedView(*node, style.secrets));
    Table const table = tableOf(kind, views, style).selected(selection);
    if (!out.takesDocuments()) {
        out.table(table);
        return;
    }
    Json list = Json::array();
    for (Table::Row const& row : table.rows()) {
        NodeView& view = views[row.number];
        if (!selection.columns.empty())
            keepColumns(view, table.columns());
        list.push_back(toJson(view));
    }
    out.json(list);
}

} // namespace mihost
