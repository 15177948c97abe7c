#include "mihost/cli/input/Decimal.h"

#include <charconv>

namespace mihost
{

std::optional<unsigned int> parseDecimal(std::string_view text)
{
    unsigned int number = 0;
    char const* const end = text.data() + text.size();
    auto const [stop, problem] = std::from_chars(text.data(), end, number);
    return problem == std::errc() && stop == end ? std::optional(number) : std::nullopt;
}

} // namespace mihost
