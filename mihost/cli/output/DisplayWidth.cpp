#include "mihost/cli/output/DisplayWidth.h"

#include "mihost/runtime/Text.h"

#include <clocale>
#include <cwchar>

namespace mihost
{

namespace
{

/** Null if there is none. */
locale_t unicodeLocale()
{
    static locale_t const locale = newlocale(LC_CTYPE_MASK, "C.UTF-8", nullptr);
    return locale;
}

std::size_t widthOf(char32_t character)
{
    if (character < 0x80)
        return 1;
    int const width = wcwidth(static_cast<wchar_t>(character));
    return width < 0 ? 1 : static_cast<std::size_t>(width);
}

/** The bytes at the text's beginning that a line of this width holds; at least one character. */
std::size_t fitting(std::string_view text, std::size_t width)
{
    std::size_t taken = 0;
    std::size_t used = 0;
    while (taken < text.size()) {
        Utf8Piece const piece = firstPiece(text.substr(taken));
        used += widthOf(piece.character);
        if (used > width && taken != 0)
            break;
        taken += piece.length;
    }
    return taken;
}

} // namespace

UnicodeCharacters::UnicodeCharacters() : before_(uselocale(unicodeLocale())) {}

UnicodeCharacters::~UnicodeCharacters()
{
    uselocale(before_);
}

bool UnicodeCharacters::areAvailable()
{
    return unicodeLocale() != nullptr;
}

std::size_t displayWidth(std::string_view text)
{
    UnicodeCharacters const unicode;
    std::size_t width = 0;
    while (!text.empty()) {
        Utf8Piece const piece = firstPiece(text);
        width += widthOf(piece.character);
        text.remove_prefix(piece.length);
    }
    return width;
}

std::vector<std::string> wrapped(std::string_view text, std::size_t width)
{
    UnicodeCharacters const unicode;
    std::vector<std::string> lines;
    do {
        std::size_t const fits = fitting(text, width);
        std::size_t const blank = text.rfind(' ', fits);
        bool const isBroken = fits < text.size() && blank != std::string_view::npos && blank != 0;
        std::size_t const end = isBroken ? blank : fits;
        lines.emplace_back(text.substr(0, end));
        text.remove_prefix(isBroken ? end + 1 : end);
    } while (!text.empty());
    return lines;
}

} // namespace mihost
