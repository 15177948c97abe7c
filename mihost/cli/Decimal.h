#ifndef MIHOST_CLI_DECIMAL_H
#define MIHOST_CLI_DECIMAL_H

#include <optional>
#include <string_view>

namespace mihost
{

/** The number that the text is, digits from its first to its last; nothing where it does not fit. */
std::optional<unsigned int> parseDecimal(std::string_view text);

} // namespace mihost

#endif
