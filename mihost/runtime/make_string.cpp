#include "host/make_string.h"

#include "mihost/runtime/Text.h"

namespace NQ
{

namespace
{

// A byte that starts no valid sequence travels as U+DC80 to U+DCFF, which UTF-8 itself never
// yields.
constexpr char32_t strayBase = 0xDC00;

void encode(char32_t code, std::string& text)
{
    auto const put = [&text](char32_t byte) { text.push_back(static_cast<char>(byte)); };
    if (code >= strayBase + 0x80 && code <= strayBase + 0xFF) {
        put(code - strayBase);
    } else if (code < 0x80) {
        put(code);
    } else if (code < 0x800) {
        put(0xC0 | (code >> 6));
        put(0x80 | (code & 0x3F));
    } else if (code < 0x10000) {
        put(0xE0 | (code >> 12));
        put(0x80 | ((code >> 6) & 0x3F));
        put(0x80 | (code & 0x3F));
    } else {
        put(0xF0 | (code >> 18));
        put(0x80 | ((code >> 12) & 0x3F));
        put(0x80 | ((code >> 6) & 0x3F));
        put(0x80 | (code & 0x3F));
    }
}

} // namespace

std::string make_string(char const* text)
{
    return text ? text : "";
}

std::string make_string(std::wstring const& text)
{
    std::string narrow;
    narrow.reserve(text.size());
    for (wchar_t const character : text)
        encode(static_cast<char32_t>(character), narrow);
    return narrow;
}

std::wstring make_wstring(std::string const& text)
{
    std::wstring wide;
    wide.reserve(text.size());
    for (std::string_view rest = text; !rest.empty();) {
        mihost::Utf8Piece const piece = mihost::firstPiece(rest);
        char32_t const code = piece.valid ? piece.character : strayBase + piece.character;
        wide.push_back(static_cast<wchar_t>(code));
        rest.remove_prefix(piece.length);
    }
    return wide;
}

} // namespace NQ
