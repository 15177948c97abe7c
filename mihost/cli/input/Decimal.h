#ifndef MIHOST_CLI_INPUT_DECIMAL_H
#define MIHOST_CLI_INPUT_DECIMAL_H

#include <optional>
#include <string_view>

namespace mihost
{

/** The number that the whole text is, in digits; nothing if it is not one or does not fit. */
std::optional<unsigned int> parseDecimal(std::string_view text);

} // namespace mihost

#endif
