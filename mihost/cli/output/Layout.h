#ifndef MIHOST_CLI_OUTPUT_LAYOUT_H
#define MIHOST_CLI_OUTPUT_LAYOUT_H

#include "mihost/cli/output/Table.h"

#include <limits>
#include <string>
#include <vector>

/** Tables as lines for people. */
namespace mihost
{

/** The width of lines, and how they are drawn. */
struct Room {
    static constexpr std::size_t unlimited = std::numeric_limits<std::size_t>::max();

    std::size_t columns = unlimited;
    bool hasUnicode = true; // for a tree's branches

    /** The width left after an indentation. */
    Room indented(std::size_t by) const
    {
        return {columns == unlimited ? unlimited : columns - (columns < by ? columns : by),
                hasUnicode};
    }
};

/** Columns; in fewer, wrapped text is hard to read. */
constexpr std::size_t leastText = 20;

/** Texts in columns, printable and perhaps styled. */
struct Grid {
    std::vector<Column> columns;
    std::vector<std::vector<std::string>> rows;
    bool hasHeadings = false;
};

/** The lines of a grid, without line ends. Only its last left-aligned column is ever wrapped. */
std::vector<std::string> layOut(Grid const& grid, Room const& room);

/**
 * A table as rows below headings. If the rows do not fit with leastText columns for the wrapping
 * text, each row becomes lines of heading and value, with an empty line between rows.
 */
std::vector<std::string> layOut(Table const& table, Room const& room, bool hasHeadings = true);

/** Each row as lines of heading and value, at any width. */
std::vector<std::string> layOutRecords(Table const& table, Room const& room);

} // namespace mihost

#endif
