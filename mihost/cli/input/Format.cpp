#include "mihost/cli/input/Format.h"

#include <algorithm>

namespace mihost
{

std::vector<std::string> const& formatNames()
{
    static std::vector<std::string> const names = {"table", "json", "jsonl",
                                                   "yaml",  "csv",  "value"};
    return names;
}

Format formatOf(std::string_view name)
{
    auto const& names = formatNames();
    return static_cast<Format>(std::find(names.begin(), names.end(), name) - names.begin());
}

std::string const& nameOf(Format format)
{
    return formatNames()[static_cast<std::size_t>(format)];
}

bool isDocument(Format format)
{
    return format == Format::JsonText || format == Format::JsonLines || format == Format::YamlText;
}

bool isRows(Format format)
{
    return format == Format::CsvText || format == Format::BareValues;
}

} // namespace mihost
