#ifndef MIHOST_CLI_OUTPUT_TABLE_H
#define MIHOST_CLI_OUTPUT_TABLE_H

#include "mihost/cli/output/Json.h"

#include <string>
#include <vector>

namespace CLI
{
class App;
}

namespace mihost
{

/** One value of a table, as a program and as a person reads it. */
struct Cell {
    Cell(std::string const& cellText) : value(toJson(cellText)), text(cellText) {}
    Cell(char const* cellText) : Cell(std::string(cellText)) {}
    Cell(Json cellValue, std::string cellText)
        : value(std::move(cellValue)), text(std::move(cellText))
    {
    }

    Json value;
    std::string text;    // empty for nothing; not yet safe for a terminal
    std::string unknown; // why the value is unknown; empty if it is known
};

struct Column {
    enum class Align { Left, Right };

    Column(std::string columnName, Align alignment = Align::Left, std::string alsoCalled = "")
        : name(std::move(columnName)), align(alignment), otherName(std::move(alsoCalled))
    {
    }

    std::string name; // heading, and key in documents
    Align align;
    std::string otherName; // which --columns, --sort and --where accept, too; empty for none
};

/** Which columns and rows of a table are shown, and in which order. */
struct Selection {
    /** Adds the options --columns, --sort and --where. */
    void declare(CLI::App& app);

    std::vector<std::string> columns; // empty for the usual ones
    std::string sort;                 // a column, "-" before it for descending; empty for none
    std::vector<std::string> where;   // COLUMN=VALUE or COLUMN~TEXT; a row meets all of them
};

/** Rows of named columns, to be printed in any format. */
class Table
{
public:
    struct Row {
        std::size_t number; // in the order of add(), from 0
        std::vector<Cell> cells;
    };

    /** @param usual  the names of the columns that are shown unless others are chosen; empty for
     * all */
    explicit Table(std::vector<Column> columns, std::vector<std::string> usual = {});

    /** @param cells  one for each column */
    void add(std::vector<Cell> cells);

    std::vector<Column> const& columns() const
    {
        return columns_;
    }
    std::vector<Row> const& rows() const
    {
        return rows_;
    }

    /** @throws Failure for a column that the table does not have */
    Table selected(Selection const& selection) const;

private:
    std::size_t columnOf(std::string const& name) const;

    std::vector<Column> columns_;
    std::vector<std::string> usual_;
    std::vector<Row> rows_;
};

/** A list with an object for each row. */
Json toJson(Table const& table);

} // namespace mihost

#endif
