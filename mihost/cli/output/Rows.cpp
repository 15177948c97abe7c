#include "mihost/cli/output/Rows.h"

#include "mihost/cli/output/UnknownValues.h"
#include "mihost/runtime/Text.h"

#include <fmt/format.h>
#include <fmt/ranges.h>

namespace mihost
{

namespace
{

/** A line with a single empty field would be read as no line. */
std::string csvField(std::string const& text, bool isOnlyOne)
{
    bool const isQuoted = text.find_first_of(",\"") != std::string::npos ||
                          (text.empty() && isOnlyOne) ||
                          (!text.empty() && (text.front() == ' ' || text.back() == ' '));
    if (!isQuoted)
        return text;
    std::string field = "\"";
    for (char const byte : text)
        field.append(byte == '"' ? 2 : 1, byte);
    return field + '"';
}

std::string csvLine(std::vector<std::string> const& texts)
{
    std::vector<std::string> fields;
    fields.reserve(texts.size());
    for (std::string const& text : texts)
        fields.push_back(csvField(text, texts.size() == 1));
    return fmt::format("{}\n", fmt::join(fields, ","));
}

std::vector<std::string> textsOf(Table::Row const& row)
{
    std::vector<std::string> texts;
    for (Cell const& cell : row.cells) {
        noteUnknown(cell.unknown);
        texts.push_back(printable(cell.text));
    }
    return texts;
}

} // namespace

std::string csvText(Table const& table, bool hasHeadings)
{
    std::string text;
    std::vector<std::string> names;
    for (Column const& column : table.columns())
        names.push_back(column.name);
    if (hasHeadings)
        text += csvLine(names);
    for (Table::Row const& row : table.rows())
        text += csvLine(textsOf(row));
    return text;
}

std::string valueText(Table const& table)
{
    std::string text;
    for (Table::Row const& row : table.rows())
        text += fmt::format("{}\n", fmt::join(textsOf(row), "\t"));
    return text;
}

} // namespace mihost
