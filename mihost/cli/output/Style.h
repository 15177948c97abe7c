#ifndef MIHOST_CLI_OUTPUT_STYLE_H
#define MIHOST_CLI_OUTPUT_STYLE_H

#include <string>
#include <string_view>

namespace mihost
{

enum class Style { Bold, Faint, Green, Yellow, Red, Cyan };

/**
 * The text with marks around it, which take no room and which no printable() text holds. Output
 * makes colours of them or drops them.
 */
std::string styled(Style style, std::string_view text);

/** The text with its marks as a terminal's controls, none of them in effect past a line's end. */
std::string withColours(std::string_view text);

/** The text without its marks. */
std::string withoutStyles(std::string_view text);

} // namespace mihost

#endif
