#include "mihost/runtime/Text.h"

#include <algorithm>

namespace mihost
{

namespace
{

constexpr char hexDigits[] = "0123456789abcdef";

/** The length and range that the first byte of a sequence implies. */
struct Lead {
    unsigned char mask;
    unsigned char pattern;
    std::size_t length;
    char32_t smallest; // a smaller character is written overlong
};

constexpr Lead leads[] = {
    {0x80, 0x00, 1, 0x0},
    {0xE0, 0xC0, 2, 0x80},
    {0xF0, 0xE0, 3, 0x800},
    {0xF8, 0xF0, 4, 0x10000},
};

/** Characters that control a terminal or make a line look different from what it is. */
bool isTreacherous(char32_t character)
{
    struct Range {
        char32_t first;
        char32_t last;
    };
    static constexpr Range ranges[] = {
        {0x00, 0x1F},       {0x7F, 0x9F},     // control characters
        {0xAD, 0xAD},       {0x61C, 0x61C},   // soft hyphen, direction mark
        {0x200B, 0x200F},                     // invisible and direction marks
        {0x2028, 0x202E},   {0x2060, 0x206F}, // line breaks, direction overrides
        {0xFEFF, 0xFEFF},   {0xFFF9, 0xFFFB}, // byte-order mark, annotations
        {0xE0000, 0xE0FFF},                   // tags
    };
    return std::any_of(std::begin(ranges), std::end(ranges), [character](Range const& range) {
        return character >= range.first && character <= range.last;
    });
}

std::string escape(char32_t character)
{
    switch (character) {
    case '\n':
        return "\\n";
    case '\r':
        return "\\r";
    case '\t':
        return "\\t";
    default:
        break;
    }
    if (character < 0x80)
        return hexByte(static_cast<unsigned char>(character));
    std::string escaped = character > 0xFFFF ? "\\U" : "\\u";
    for (int shift = character > 0xFFFF ? 28 : 12; shift >= 0; shift -= 4)
        escaped += hexDigits[(character >> shift) & 0xF];
    return escaped;
}

bool isCharacter(char32_t character, char32_t smallest)
{
    bool const surrogate = character >= 0xD800 && character <= 0xDFFF;
    return character >= smallest && character <= 0x10FFFF && !surrogate;
}

/** Printable ASCII, which is never rewritten. */
bool isPlain(char byte)
{
    return byte >= 0x20 && byte < 0x7F;
}

/** Moves the characters of a kind from the beginning of a text to the end of another. */
template <class Belongs>
void moveRun(std::string_view& from, std::string& to, Belongs const& belongs)
{
    auto const end = std::find_if_not(from.begin(), from.end(), belongs);
    auto const length = static_cast<std::size_t>(end - from.begin());
    to.append(from.substr(0, length));
    from.remove_prefix(length);
}

template <class MustEscape> std::string rewritten(std::string_view text, MustEscape mustEscape)
{
    std::string result;
    result.reserve(text.size());
    for (moveRun(text, result, isPlain); !text.empty(); moveRun(text, result, isPlain)) {
        Utf8Piece const piece = firstPiece(text);
        if (!piece.valid)
            result += hexByte(static_cast<unsigned char>(text[0]));
        else if (mustEscape(piece.character))
            result += escape(piece.character);
        else
            result.append(text.substr(0, piece.length));
        text.remove_prefix(piece.length);
    }
    return result;
}

} // namespace

Utf8Piece firstPiece(std::string_view text)
{
    if (text.empty())
        return {0, 0, false};
    auto const first = static_cast<unsigned char>(text[0]);
    auto const lead = std::find_if(std::begin(leads), std::end(leads), [first](Lead const& row) {
        return (first & row.mask) == row.pattern;
    });
    if (lead == std::end(leads) || text.size() < lead->length)
        return {1, first, false};
    char32_t character = first & static_cast<unsigned char>(~lead->mask);
    for (std::size_t at = 1; at < lead->length; ++at) {
        auto const next = static_cast<unsigned char>(text[at]);
        if ((next & 0xC0) != 0x80)
            return {1, first, false};
        character = (character << 6) | (next & 0x3FU);
    }
    if (!isCharacter(character, lead->smallest))
        return {1, first, false};
    return {lead->length, character, true};
}

std::string hexByte(unsigned char byte)
{
    return {'\\', 'x', hexDigits[byte >> 4], hexDigits[byte & 0xF]};
}

std::string validUtf8(std::string_view text)
{
    return rewritten(text, [](char32_t) { return false; });
}

std::string printable(std::string_view text)
{
    return rewritten(text, isTreacherous);
}

std::string jsonString(std::string_view text)
{
    std::string quoted;
    appendJsonString(quoted, text);
    return quoted;
}

void appendJsonString(std::string& to, std::string_view text)
{
    bool const plain = std::all_of(text.begin(), text.end(), isPlain);
    std::string const valid = plain ? std::string() : validUtf8(text);
    std::string_view rest = plain ? text : valid;
    auto const standsAsItIs = [](char byte) {
        return byte != '"' && byte != '\\' && static_cast<unsigned char>(byte) >= 0x20;
    };
    to += '"';
    for (moveRun(rest, to, standsAsItIs); !rest.empty(); moveRun(rest, to, standsAsItIs)) {
        auto const code = static_cast<unsigned char>(rest.front());
        if (code >= 0x20) {
            to += '\\';
            to += rest.front();
        } else {
            to += "\\u00";
            to += hexDigits[code >> 4];
            to += hexDigits[code & 0xF];
        }
        rest.remove_prefix(1);
    }
    to += '"';
}

} // namespace mihost
