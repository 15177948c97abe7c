#include "mihost/cli/output/PropertyText.h"

#include "mihost/cli/output/DisplayWidth.h"
#include "mihost/cli/output/UnknownValues.h"
#include "mihost/runtime/Text.h"

#include <fmt/format.h>

namespace mihost
{

namespace
{

std::string unitOf(PropertyView const& property)
{
    return property.row ? property.row->unit : "";
}

std::string textOf(PropertyView const& property)
{
    noteUnknown(property.unknown);
    std::string const value = valueText(property);
    if (value.empty())
        return "-";
    bool const hasUnit = property.unknown.empty() && !property.hidden && !unitOf(property).empty();
    return printable(value) + (hasUnit ? " " + unitOf(property) : "");
}

} // namespace

Grid propertyGrid(std::vector<PropertyView> const& properties)
{
    Grid grid{{Column(""), Column("")}, {}};
    for (PropertyView const& property : properties)
        grid.rows.push_back(
            {fmt::format("{:>3} {}", property.id, nameOf(property)), textOf(property)});
    return grid;
}

Table propertyTable(std::vector<PropertyView> const& properties)
{
    Table table({{"id"}, {"name"}, {"kind"}, {"flag"}, {"value"}, {"unit"}});
    for (PropertyView const& property : properties) {
        bool const flag = property.value.getFlag();
        table.add({Cell(property.id, std::to_string(property.id)), nameOf(property),
                   valueKindName(property.value.getKind()), Cell(flag, flag ? "true" : "false"),
                   cellOf(property), unitOf(property)});
    }
    return table;
}

void writeProperties(std::vector<PropertyView> const& properties, std::string const& lead,
                     Output& out)
{
    Room const room = out.room().indented(displayWidth(lead));
    for (std::string const& line : layOut(propertyGrid(properties), room))
        out.line(lead + line);
}

} // namespace mihost
