#include "mihost/cli/input/Range.h"

#include <cstdlib>
#include <fmt/format.h>

namespace mihost
{

std::function<std::string(std::string const&)> between(double least, double most)
{
    return [least, most](std::string const& text) -> std::string {
        char* end = nullptr;
        double const number = std::strtod(text.c_str(), &end);
        bool const isNumber = !text.empty() && *end == '\0';
        if (isNumber && number >= least && number <= most) // which no NaN is
            return "";
        return fmt::format("'{}' is not a number from {:.0f} to {:.0f}", text, least, most);
    };
}

} // namespace mihost
