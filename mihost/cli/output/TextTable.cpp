#include "mihost/cli/output/TextTable.h"

#include "mihost/runtime/Text.h"

#include <algorithm>
#include <clocale>
#include <cwchar>
#include <numeric>
#include <utility>

namespace mihost
{

namespace
{

constexpr std::size_t gap = 2;
constexpr std::size_t narrowest = 4;

/** Widths are those of Unicode, whatever the user's code set. */
locale_t unicode()
{
    static locale_t const made = newlocale(LC_CTYPE_MASK, "C.UTF-8", nullptr);
    return made;
}

std::size_t widthOf(char32_t character)
{
    if (character < 0x80 || !unicode())
        return 1;
    locale_t const before = uselocale(unicode());
    int const width = wcwidth(static_cast<wchar_t>(character));
    uselocale(before);
    return width < 0 ? 1 : static_cast<std::size_t>(width);
}

std::size_t lineWidth(std::vector<std::size_t> const& widths)
{
    return std::accumulate(widths.begin(), widths.end(), gap * (widths.size() - 1));
}

/** Takes from the widest columns until the line fits or nothing can be taken. */
void shrink(std::vector<std::size_t>& widths, std::size_t columns)
{
    while (lineWidth(widths) > columns) {
        auto const widest = std::max_element(widths.begin(), widths.end());
        if (*widest <= narrowest)
            return;
        --*widest;
    }
}

} // namespace

std::size_t displayWidth(std::string const& text)
{
    std::size_t width = 0;
    for (std::string_view rest = text; !rest.empty();) {
        Utf8Piece const piece = firstPiece(rest);
        width += widthOf(piece.character);
        rest.remove_prefix(piece.length);
    }
    return width;
}

std::string fitted(std::string const& text, Room const& room)
{
    if (displayWidth(text) <= room.columns)
        return text;
    if (room.columns == 0)
        return "";
    std::string cut;
    std::size_t width = 1; // the sign that it was cut
    for (std::string_view rest = text; !rest.empty();) {
        Utf8Piece const piece = firstPiece(rest);
        width += widthOf(piece.character);
        if (width > room.columns)
            break;
        cut += rest.substr(0, piece.length);
        rest.remove_prefix(piece.length);
    }
    return cut + room.cutSign;
}

TextTable::TextTable(std::vector<std::string> heading) : rows_{std::move(heading)} {}

void TextTable::add(std::vector<std::string> cells)
{
    rows_.push_back(std::move(cells));
}

std::vector<std::string> TextTable::lines(Room const& room) const
{
    std::vector<std::size_t> widths(rows_.front().size());
    for (auto const& row : rows_)
        for (std::size_t at = 0; at < widths.size(); ++at)
            widths[at] = std::max(widths[at], displayWidth(row[at]));
    shrink(widths, room.columns);

    std::vector<std::string> lines;
    for (auto const& row : rows_) {
        std::string line;
        for (std::size_t at = 0; at < widths.size(); ++at) {
            std::string const cell = fitted(row[at], {widths[at], room.cutSign});
            line += cell;
            line.append(widths[at] - displayWidth(cell) + gap, ' ');
        }
        line.erase(line.find_last_not_of(' ') + 1);
        lines.push_back(line);
    }
    return lines;
}

} // namespace mihost
