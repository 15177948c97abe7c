#include "mihost/cli/output/Table.h"

#include "mihost/cli/input/Decimal.h"
#include "mihost/cli/input/Suggestion.h"
#include "mihost/cli/output/UnknownValues.h"
#include "mihost/cli/system/Failure.h"

#include <CLI/App.hpp>
#include <algorithm>
#include <fmt/format.h>
#include <optional>
#include <utility>

namespace mihost
{

namespace
{

/** One condition of --where, for the text of a cell. */
struct Condition {
    std::string column;
    std::string text;
    bool isWhole; // the cell is the text, rather than containing it

    bool isMetBy(std::string const& cell) const
    {
        return isWhole ? cell == text : cell.find(text) != std::string::npos;
    }
};

Condition parseCondition(std::string const& text)
{
    std::size_t const at = text.find_first_of("=~");
    if (at == 0 || at == std::string::npos)
        throw Failure(BadUsage, fmt::format("--where {}: not a condition (use COLUMN=VALUE for "
                                            "equal, COLUMN~TEXT for containing)",
                                            text));
    return {text.substr(0, at), text.substr(at + 1), text[at] == '='};
}

/** A number, also one that the plug-in has as text; nothing for other texts. */
std::optional<double> numberOf(Cell const& cell)
{
    if (cell.value.is_number())
        return cell.value.get<double>();
    if (auto const number = parseDecimal(cell.text))
        return *number;
    return std::nullopt;
}

/** Numbers by size, before everything else by its text. */
bool isBefore(Cell const& one, Cell const& other)
{
    auto const first = numberOf(one);
    auto const second = numberOf(other);
    if (first && second)
        return *first < *second;
    if (first || second)
        return first.has_value();
    return one.text < other.text;
}

} // namespace

void Selection::declare(CLI::App& app)
{
    app.add_option("--columns", columns, "show these columns, separated by commas")
        ->type_name("COLUMN[,COLUMN]")
        ->delimiter(',');
    app.add_option("--sort", sort, "sort the rows by this column; -COLUMN for descending order")
        ->type_name("[-]COLUMN");
    app.add_option("--where", where,
                   "show only rows whose COLUMN is VALUE, or contains TEXT; repeatable")
        ->type_name("COLUMN=VALUE|COLUMN~TEXT")
        ->expected(1)
        ->take_all();
}

Table::Table(std::vector<Column> columns, std::vector<std::string> usual)
    : columns_(std::move(columns)), usual_(std::move(usual))
{
}

void Table::add(std::vector<Cell> cells)
{
    rows_.push_back({rows_.size(), std::move(cells)});
}

std::size_t Table::columnOf(std::string const& name) const
{
    std::vector<std::string> names;
    for (Column const& column : columns_) {
        if (column.name == name || (!name.empty() && column.otherName == name))
            return names.size();
        names.push_back(column.name);
    }
    throw Failure(NotFound,
                  fmt::format("no column '{}' ({})", name, suggestion(name, names, "use")));
}

Table Table::selected(Selection const& selection) const
{
    std::vector<Row> rows = rows_;
    for (std::string const& text : selection.where) {
        Condition const condition = parseCondition(text);
        std::size_t const at = columnOf(condition.column);
        rows.erase(std::remove_if(rows.begin(), rows.end(),
                                  [&condition, at](Row const& row) {
                                      return !condition.isMetBy(row.cells[at].text);
                                  }),
                   rows.end());
    }
    if (!selection.sort.empty()) {
        bool const isDescending = selection.sort[0] == '-';
        std::size_t const at = columnOf(selection.sort.substr(isDescending ? 1 : 0));
        std::stable_sort(rows.begin(), rows.end(),
                         [at, isDescending](auto const& a, auto const& b) {
                             return isDescending ? isBefore(b.cells[at], a.cells[at])
                                                 : isBefore(a.cells[at], b.cells[at]);
                         });
    }

    std::vector<std::string> const& names = selection.columns.empty() ? usual_ : selection.columns;
    std::vector<std::size_t> shown;
    shown.reserve(names.size());
    for (std::string const& name : names)
        shown.push_back(columnOf(name));
    if (shown.empty())
        for (std::size_t at = 0; at < columns_.size(); ++at)
            shown.push_back(at);
    Table result({});
    for (std::size_t const at : shown)
        result.columns_.push_back(columns_[at]);
    for (Row const& row : rows) {
        Row chosen{row.number, {}};
        for (std::size_t const at : shown)
            chosen.cells.push_back(row.cells[at]);
        result.rows_.push_back(std::move(chosen));
    }
    return result;
}

Json toJson(Table const& table)
{
    Json list = Json::array();
    for (Table::Row const& row : table.rows()) {
        Json object = Json::object();
        for (std::size_t at = 0; at < row.cells.size(); ++at) {
            object[table.columns()[at].name] = row.cells[at].value;
            noteUnknown(row.cells[at].unknown);
        }
        list.push_back(std::move(object));
    }
    return list;
}

} // namespace mihost
