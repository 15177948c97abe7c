#include "mihost/cli/output/ColumnPrinter.h"

#include "mihost/cli/output/DisplayWidth.h"
#include "mihost/cli/output/Style.h"
#include "mihost/runtime/Text.h"

#include <cstdlib>
#include <fmt/format.h>
#include <fmt/ranges.h>
#include <libsmartcols/libsmartcols.h>
#include <new>
#include <sstream>
#include <string_view>

namespace mihost
{

namespace
{

// The library's calls fail only for lack of memory.

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

} // namespace

void ColumnPrinter::Unref::operator()(libscols_table* table) const
{
    scols_unref_table(table);
}

ColumnPrinter::ColumnPrinter(bool hasHeadings)
    : table_(made(scols_new_table())), hasHeadings_(hasHeadings)
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
void ColumnPrinter::addColumn(std::string const& heading, bool isRight)
{
    std::string const printed = hasHeadings_ ? measurable(heading) : "";
    int const flags = SCOLS_FL_WRAP | (isRight ? SCOLS_FL_RIGHT : 0);
    libscols_column* const column =
        made(scols_table_new_column(table_.get(), printed.c_str(), 0, flags));
    require(
        scols_column_set_wrapfunc(column, scols_wrapnl_chunksize, scols_wrapnl_nextchunk, nullptr));
}

void ColumnPrinter::addRow(std::vector<std::string> const& cells)
{
    libscols_line* const line = made(scols_table_new_line(table_.get(), nullptr));
    for (std::size_t at = 0; at < cells.size(); ++at)
        require(scols_line_set_data(line, at, measurable(cells[at]).c_str()));
}

std::vector<std::string> ColumnPrinter::lines() const
{
    UnicodeCharacters const unicode;
    char* text = nullptr;
    require(scols_print_table_to_string(table_.get(), &text));
    std::unique_ptr<char, decltype(&std::free)> const owned(text, &std::free);
    std::istringstream stream(text ? text : "");
    std::vector<std::string> lines;
    for (std::string line; std::getline(stream, line);) {
        line.erase(line.find_last_not_of(' ') + 1);
        lines.push_back(line);
    }
    return lines;
}

std::string joined(std::vector<std::string> const& lines)
{
    return fmt::format("{}", fmt::join(lines, "\n"));
}

} // namespace mihost
