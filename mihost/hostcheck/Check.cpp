#include "mihost/hostcheck/Check.h"

#include <algorithm>

namespace hostcheck
{

namespace
{

/** The text in quotes, cut to what fits a line; bytes other than printable ASCII as \xNN. */
std::string shown(std::string const& text)
{
    constexpr std::size_t most = 60;
    constexpr char digits[] = "0123456789abcdef";
    std::string line = "'";
    for (char const character : text.substr(0, most)) {
        auto const byte = static_cast<unsigned char>(character);
        if (byte >= 0x20 && byte < 0x7F)
            line += character;
        else
            line += {'\\', 'x', digits[byte >> 4], digits[byte & 0xF]};
    }
    line += '\'';
    if (text.size() > most)
        line += "... (" + std::to_string(text.size()) + " bytes)";
    return line;
}

std::string everyByte()
{
    std::string text;
    for (int byte = 0; byte <= 0xFF; ++byte)
        text += static_cast<char>(byte);
    return text;
}

} // namespace

std::string firstOf(std::initializer_list<std::string> explanations)
{
    auto const found =
        std::find_if(explanations.begin(), explanations.end(),
                     [](std::string const& explanation) { return !explanation.empty(); });
    return found == explanations.end() ? "" : *found;
}

std::string equal(char const* what, long long found, long long expected)
{
    return holds(found == expected, std::string(what) + " is " + std::to_string(found) + ", not " +
                                        std::to_string(expected));
}

std::string equal(char const* what, std::string const& found, std::string const& expected)
{
    return found == expected
               ? ""
               : std::string(what) + " is " + shown(found) + ", not " + shown(expected);
}

std::string holds(bool right, std::string const& explanation)
{
    return right ? "" : explanation;
}

std::vector<std::string> const& oddTexts()
{
    constexpr std::size_t longSize = 1U << 16;
    static std::vector<std::string> const texts = {"", std::string(longSize, 'x'), everyByte(),
                                                   "100%s %d %n %%"};
    return texts;
}

} // namespace hostcheck
