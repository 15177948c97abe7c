#include "mihost/cli/input/Range.h"

#include "mihost/cli/input/Decimal.h"

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

std::function<std::string(std::string const&)> wholeBetween(unsigned int least, unsigned int most)
{
    return [least, most](std::string const& text) -> std::string {
        auto const number = parseDecimal(text);
        // CLI11 reads 010 as octal.
        if (number && *number >= least && *number <= most && std::to_string(*number) == text)
            return "";
        return fmt::format("'{}' is not a whole number from {} to {}", text, least, most);
    };
}

} // namespace mihost
