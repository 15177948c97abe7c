#include "mihost/cli/output/PropertyText.h"

#include "mihost/runtime/Text.h"

#include <algorithm>
#include <fmt/format.h>

namespace mihost
{

void writeProperties(std::vector<PropertyView> const& properties, std::string const& indent,
                     Output& out)
{
    std::size_t width = 0;
    for (PropertyView const& property : properties)
        width = std::max(width, nameOf(property).size());
    for (PropertyView const& property : properties) {
        bool const hasUnit = property.row && *property.row->unit && property.unknown.empty();
        std::string line = fmt::format("{}{:>3} {:<{}}  {}{}{}", indent, property.id,
                                       nameOf(property), width, printable(valueText(property)),
                                       hasUnit ? " " : "", hasUnit ? property.row->unit : "");
        line.erase(line.find_last_not_of(' ') + 1);
        out.line(line);
    }
}

} // namespace mihost
