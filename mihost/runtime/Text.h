#ifndef MIHOST_RUNTIME_TEXT_H
#define MIHOST_RUNTIME_TEXT_H

#include <cstddef>
#include <string>
#include <string_view>

namespace mihost
{

/** One character of a text, or one byte that is part of none. */
struct Utf8Piece {
    std::size_t length; // bytes taken; 0 at the end of the text
    char32_t character; // or that byte
    bool valid;         // false for a byte that is part of no character
};

/** The piece that the text begins with. Overlong forms and surrogates are not UTF-8. */
Utf8Piece firstPiece(std::string_view text);

/** The byte as \xNN. */
std::string hexByte(unsigned char byte);

/** The text with each byte that is not UTF-8 written as \xNN. */
std::string validUtf8(std::string_view text);

/**
 * The text on one line and harmless to a terminal: control characters, characters that change the
 * direction of writing or break lines, and bytes that are not UTF-8 are written as escapes.
 */
std::string printable(std::string_view text);

/** The text as a JSON string, quotes included. */
std::string jsonString(std::string_view text);

/** As jsonString, at the end of a text. */
void appendJsonString(std::string& to, std::string_view text);

} // namespace mihost

#endif
