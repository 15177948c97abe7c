#include "mihost/cli/output/Layout.h"

#include "mihost/cli/output/DisplayWidth.h"
#include "mihost/cli/output/Style.h"
#include "mihost/cli/output/UnknownValues.h"
#include "mihost/runtime/Text.h"

#include <algorithm>
#include <cstdlib>
#include <fmt/format.h>
#include <fmt/ranges.h>
#include <libsmartcols/libsmartcols.h>
#include <memory>
#include <new>
#include <numeric>
#include <optional>
#include <sstream>
#include <string_view>

namespace mihost
{

namespace
{

constexpr char columnGap[] = "  ";
constexpr std::size_t gapWidth = 2;
constexpr std::size_t branchWidth = 2; // of each level of a tree
constexpr std::size_t leastText = 20;  // columns; in fewer, wrapped text is hard to read

/** Owns what the library made. Its calls fail only for lack of memory. */
struct Unref {
    void operator()(libscols_table* table) const
    {
        scols_unref_table(table);
    }
    void operator()(char* text) const
    {
        std::free(text);
    }
};

template <class Object> using Owned = std::unique_ptr<Object, Unref>;

template <class Object> Object* made(Object* object)
{
    if (!object)
        throw std::bad_alloc();
    return object;
}

void require(int result)
{
    if (result < 0)
        throw std::bad_alloc();
}

/**
 * The text as libsmartcols can measure it. Without a UTF-8 locale it would never finish with a
 * character outside ASCII: '?' for each, and no styles.
 */
std::string measurable(std::string const& text)
{
    if (UnicodeCharacters::areAvailable())
        return text;
    std::string const plain = withoutStyles(text);
    std::string ascii;
    for (std::string_view rest = plain; !rest.empty();) {
        Utf8Piece const piece = firstPiece(rest);
        ascii += piece.character < 0x80 ? static_cast<char>(piece.character) : '?';
        rest.remove_prefix(piece.length);
    }
    return ascii;
}

class Printer
{
public:
    explicit Printer(bool hasHeadings) : table_(made(scols_new_table())), hasHeadings_(hasHeadings)
    {
        scols_table_enable_noheadings(table_.get(), hasHeadings ? 0 : 1);
        scols_table_enable_noencoding(table_.get(), 1);
        scols_table_set_termforce(table_.get(), SCOLS_TERMFORCE_NEVER);
        require(scols_table_set_column_separator(table_.get(), columnGap));
    }

    /**
     * libsmartcols would wrap in the middle of words, and cut columns other than the last; so texts
     * come in lines that fit. Some versions make a column as wide as a heading that is not printed.
     */
    void addColumn(std::string const& heading, int flags)
    {
        std::string const printed = hasHeadings_ ? measurable(heading) : "";
        libscols_column* const column =
            made(scols_table_new_column(table_.get(), printed.c_str(), 0, SCOLS_FL_WRAP | flags));
        require(scols_column_set_wrapfunc(column, scols_wrapnl_chunksize, scols_wrapnl_nextchunk,
                                          nullptr));
    }

    void addRow(std::vector<std::string> const& cells)
    {
        libscols_line* const line = made(scols_table_new_line(table_.get(), nullptr));
        for (std::size_t at = 0; at < cells.size(); ++at)
            require(scols_line_set_data(line, at, measurable(cells[at]).c_str()));
    }

    std::vector<std::string> lines() const
    {
        UnicodeCharacters const unicode;
        char* text = nullptr;
        require(scols_print_table_to_string(table_.get(), &text));
        Owned<char> const owned(text);
        std::istringstream stream(text ? text : "");
        std::vector<std::string> lines;
        for (std::string line; std::getline(stream, line);) {
            line.erase(line.find_last_not_of(' ') + 1);
            lines.push_back(line);
        }
        return lines;
    }

private:
    Owned<libscols_table> table_;
    bool hasHeadings_;
};

std::string joined(std::vector<std::string> const& lines)
{
    return fmt::format("{}", fmt::join(lines, "\n"));
}

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

/** A branch where it is drawn. */
struct DrawnBranch {
    Branch const* branch;
    std::size_t depth;
    std::string sign;  // before the name
    std::string below; // before the branch's further lines
    bool hasChildren;
};

/**
 * Puts each branch after its parent and draws the lines between them. libsmartcols can do that too,
 * but its versions draw the further lines of a branch differently.
 */
class TreeDrawing
{
public:
    TreeDrawing(std::vector<Branch> const& branches, bool hasUnicode)
        : branches_(branches), hasUnicode_(hasUnicode), children_(branches.size())
    {
        for (std::size_t at = 0; at < branches.size(); ++at)
            if (branches[at].parent != at)
                children_[branches[at].parent].push_back(at);
        for (std::size_t at = 0; at < branches.size(); ++at)
            if (branches[at].parent == at)
                draw(at, 0, "", "");
    }

    std::vector<DrawnBranch> const& drawn() const
    {
        return drawn_;
    }

    char const* vertical() const
    {
        return hasUnicode_ ? "│ " : "| ";
    }

private:
    void draw(std::size_t at, std::size_t depth, std::string const& sign, std::string const& below)
    {
        drawn_.push_back({&branches_[at], depth, sign, below, !children_[at].empty()});
        for (std::size_t const child : children_[at])
            if (child == children_[at].back())
                draw(child, depth + 1, below + (hasUnicode_ ? "└─" : "`-"), below + "  ");
            else
                draw(child, depth + 1, below + (hasUnicode_ ? "├─" : "|-"), below + vertical());
    }

    std::vector<Branch> const& branches_;
    bool hasUnicode_;
    std::vector<std::vector<std::size_t>> children_;
    std::vector<DrawnBranch> drawn_;
};

/** The text of a branch within its width, with its details below. */
std::vector<std::string> branchText(Branch const& branch, Room const& room)
{
    std::vector<std::string> lines = wrapped(branch.text, room.columns);
    if (!branch.details.rows.empty())
        for (std::string const& line : layOut(branch.details, room))
            lines.push_back(line);
    return lines;
}

/** @return name and text of a branch in one column, for lines too narrow for two */
std::string wholeBranch(DrawnBranch const& drawn, Room const& room)
{
    Branch const& branch = *drawn.branch;
    std::string const start =
        branch.text.empty() ? branch.name : branch.name + columnGap + branch.text;
    std::vector<std::string> lines = wrapped(start, std::max(room.columns, leastText));
    if (!branch.details.rows.empty())
        for (std::string const& line : layOut(branch.details, room.indented(branchWidth)))
            lines.push_back(std::string(branchWidth, ' ') + line);
    for (std::size_t at = 0; at < lines.size(); ++at)
        lines[at].insert(0, at == 0 ? drawn.sign : drawn.below);
    return joined(lines);
}

} // namespace

std::vector<std::string> layOut(Grid const& grid, Room const& room)
{
    if (grid.rows.empty() && grid.hasHeadings)
        return layOut(headingsAlone(grid), room);
    auto const width = widthToWrap(grid, room);
    auto const wrapping = wrappingColumn(grid);
    constexpr std::size_t leastWidth = 8; // narrower, and lines are longer than the room
    Printer printer(grid.hasHeadings);
    for (Column const& column : grid.columns)
        printer.addColumn(styled(Style::Bold, column.name),
                          column.align == Column::Align::Right ? SCOLS_FL_RIGHT : 0);
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

std::vector<std::string> layOut(std::vector<Branch> const& branches, Room const& room)
{
    TreeDrawing const tree(branches, room.hasUnicode);
    std::size_t names = 0;
    for (DrawnBranch const& drawn : tree.drawn())
        names = std::max(names, branchWidth * drawn.depth + displayWidth(drawn.branch->name));
    bool const areBeside = room.columns >= names + gapWidth + leastText;

    Printer printer(false);
    printer.addColumn("", 0);
    if (areBeside)
        printer.addColumn("", 0);
    for (DrawnBranch const& drawn : tree.drawn()) {
        if (!areBeside) {
            printer.addRow({wholeBranch(drawn, room.indented(branchWidth * drawn.depth))});
            continue;
        }
        std::vector<std::string> const text =
            branchText(*drawn.branch, room.indented(names + gapWidth));
        std::vector<std::string> signs = {drawn.sign + drawn.branch->name};
        // libsmartcols would end the cell at an empty line.
        if (std::string const below = drawn.below + (drawn.hasChildren ? tree.vertical() : "");
            !below.empty())
            signs.resize(text.size(), below);
        printer.addRow({joined(signs), joined(text)});
    }
    return printer.lines();
}

} // namespace mihost
