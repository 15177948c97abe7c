#include "mihost/cli/output/Layout.h"

#include "mihost/cli/output/ColumnPrinter.h"
#include "mihost/cli/output/DisplayWidth.h"
#include "mihost/cli/output/Style.h"
#include "mihost/cli/output/UnknownValues.h"
#include "mihost/runtime/Text.h"

#include <algorithm>
#include <numeric>
#include <optional>

namespace mihost
{

namespace
{

std::vector<std::size_t> widthsOf(Grid const& grid)
{
    std::vector<std::size_t> widths;
    for (Column const& column : grid.columns)
        widths.push_back(grid.hasHeadings ? displayWidth(column.name) : 0);
    for (auto const& row : grid.rows)
        for (std::size_t at = 0; at < row.size(); ++at)
            widths[at] = std::max(widths[at], displayWidth(row[at]));
    return widths;
}

/** The column that wraps if needed. */
std::optional<std::size_t> wrappingColumn(Grid const& grid)
{
    for (std::size_t at = grid.columns.size(); at-- > 0;)
        if (grid.columns[at].align == Column::Align::Left)
            return at;
    return std::nullopt;
}

/** libsmartcols prints nothing of a table without rows. */
Grid headingsAlone(Grid const& grid)
{
    Grid headings{grid.columns, {{}}, false};
    for (Column const& column : grid.columns)
        headings.rows.front().push_back(styled(Style::Bold, column.name));
    return headings;
}

/** @return the width left for the wrapping column; nothing if everything fits */
std::optional<std::size_t> widthToWrap(Grid const& grid, Room const& room)
{
    std::vector<std::size_t> const widths = widthsOf(grid);
    std::size_t const all =
        std::accumulate(widths.begin(), widths.end(), gapWidth * (widths.size() - 1));
    auto const column = wrappingColumn(grid);
    if (all <= room.columns || !column)
        return std::nullopt;
    std::size_t const others = all - widths[*column];
    return others < room.columns ? room.columns - others : 0;
}

Grid gridOf(Table const& table, bool hasHeadings)
{
    Grid grid{table.columns(), {}, hasHeadings};
    for (Table::Row const& row : table.rows()) {
        std::vector<std::string> cells;
        for (Cell const& cell : row.cells) {
            noteUnknown(cell.unknown);
            cells.push_back(cell.text.empty() ? "-" : printable(cell.text));
        }
        grid.rows.push_back(std::move(cells));
    }
    return grid;
}

std::vector<std::string> recordLines(Grid const& rows, Room const& room)
{
    Grid records{{Column(""), Column("")}, {}};
    for (auto const& row : rows.rows) {
        if (!records.rows.empty())
            records.rows.push_back({"", ""});
        for (std::size_t at = 0; at < row.size(); ++at)
            records.rows.push_back({styled(Style::Bold, rows.columns[at].name), row[at]});
    }
    return layOut(records, room);
}

} // namespace

std::vector<std::string> layOut(Grid const& grid, Room const& room)
{
    if (grid.rows.empty() && grid.hasHeadings)
        return layOut(headingsAlone(grid), room);
    auto const width = widthToWrap(grid, room);
    auto const wrapping = wrappingColumn(grid);
    constexpr std::size_t leastWidth = 8; // narrower, and lines are longer than the room
    ColumnPrinter printer(grid.hasHeadings);
    for (Column const& column : grid.columns)
        printer.addColumn(styled(Style::Bold, column.name), column.align == Column::Align::Right);
    for (std::vector<std::string> row : grid.rows) {
        if (width)
            row[*wrapping] = joined(wrapped(row[*wrapping], std::max(*width, leastWidth)));
        printer.addRow(row);
    }
    return printer.lines();
}

std::vector<std::string> layOut(Table const& table, Room const& room, bool hasHeadings)
{
    Grid const grid = gridOf(table, hasHeadings);
    auto const width = widthToWrap(grid, room);
    bool const isTooNarrow = width && *width < leastText;
    return isTooNarrow ? recordLines(grid, room) : layOut(grid, room);
}

std::vector<std::string> layOutRecords(Table const& table, Room const& room)
{
    return recordLines(gridOf(table, false), room);
}

} // namespace mihost
