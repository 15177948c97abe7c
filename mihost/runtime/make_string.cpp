#include "host/make_string.h"

namespace NQ
{

namespace
{

// A byte that starts no valid sequence travels as U+DC80 to U+DCFF, which UTF-8 itself never
// yields.
constexpr char32_t strayBase = 0xDC00;

unsigned char byteAt(std::string const& text, std::size_t at)
{
    return static_cast<unsigned char>(text[at]);
}

struct Sequence {
    char32_t code;
    std::size_t length;
};

Sequence stray(unsigned char byte)
{
    return {strayBase + byte, 1};
}

Sequence decode(std::string const& text, std::size_t at)
{
    struct Form {
        unsigned char mask, lead;
        std::size_t length;
        char32_t lowest;
    };
    static constexpr Form forms[] = {{0x80, 0x00, 1, 0},
                                     {0xE0, 0xC0, 2, 0x80},
                                     {0xF0, 0xE0, 3, 0x800},
                                     {0xF8, 0xF0, 4, 0x10000}};

    unsigned char const first = byteAt(text, at);
    for (Form const& form : forms) {
        if ((first & form.mask) != form.lead)
            continue;
        if (text.size() - at < form.length)
            return stray(first);
        char32_t code = first & static_cast<unsigned char>(~form.mask);
        for (std::size_t i = 1; i < form.length; ++i) {
            unsigned char const next = byteAt(text, at + i);
            if ((next & 0xC0) != 0x80)
                return stray(first);
            code = (code << 6) | (next & 0x3FU);
        }
        bool const surrogate = code >= 0xD800 && code <= 0xDFFF;
        if (code < form.lowest || code > 0x10FFFF || surrogate)
            return stray(first);
        return {code, form.length};
    }
    return stray(first);
}

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
    for (std::size_t at = 0; at < text.size();) {
        Sequence const sequence = decode(text, at);
        wide.push_back(static_cast<wchar_t>(sequence.code));
        at += sequence.length;
    }
    return wide;
}

} // namespace NQ
