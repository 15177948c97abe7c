#include "mihost/cli/output/Document.h"
#include "mihost/runtime/Text.h"

#include <algorithm>
#include <cctype>
#include <fmt/format.h>
#include <string_view>

namespace mihost
{

namespace
{

/** Words that some version of YAML does not read as texts. */
bool isReserved(std::string word)
{
    static constexpr std::string_view reserved[] = {
        "y", "n", "yes", "no", "on", "off", "true", "false", "nan", "null", "infinity", "inf"};
    std::transform(word.begin(), word.end(), word.begin(),
                   [](char letter) { return static_cast<char>(std::tolower(letter)); });
    return std::find(std::begin(reserved), std::end(reserved), word) != std::end(reserved);
}

/** Texts that mean themselves without quotes: a letter, then letters, digits and single signs. */
bool isPlain(std::string const& text)
{
    auto const isOneOf = [](unsigned char byte, std::string_view more) {
        return byte < 0x80 &&
               (std::isalnum(byte) || more.find(static_cast<char>(byte)) != more.npos);
    };
    return !text.empty() && std::isalpha(static_cast<unsigned char>(text[0])) &&
           !isReserved(text) && std::all_of(text.begin(), text.end(), [&isOneOf](char byte) {
               return isOneOf(static_cast<unsigned char>(byte), "-_./+");
           });
}

/** @return the text in double quotes, with escapes for all characters that need one */
std::string inQuotes(std::string_view text)
{
    std::string result = "\"";
    while (!text.empty()) {
        Utf8Piece const piece = firstPiece(text);
        std::string_view const bytes = text.substr(0, piece.length);
        if (bytes == "\"" || bytes == "\\")
            result.append("\\").append(bytes);
        else if (printable(bytes) == bytes && (piece.character & 0xFFFE) != 0xFFFE)
            result += bytes;
        else
            result += fmt::format("\\U{:08x}", static_cast<unsigned int>(piece.character));
        text.remove_prefix(piece.length);
    }
    return result + '"';
}

std::string textOf(std::string const& text)
{
    return isPlain(text) ? text : inQuotes(text);
}

bool isNested(Json const& value)
{
    return value.is_structured() && !value.empty();
}

std::string scalar(Json const& value)
{
    if (value.is_string())
        return textOf(value.get<std::string>());
    std::string text = value.dump();
    // A number with an exponent has a point, too, for readers of YAML 1.1.
    if (std::size_t const exponent = text.find('e'); value.is_number_float() &&
                                                     text.find('.') == std::string::npos &&
                                                     exponent != std::string::npos)
        text.insert(exponent, ".0");
    return text;
}

void append(std::string& to, Json const& value, std::size_t indent);

/** The text after a key or a dash. */
void appendValue(std::string& to, Json const& value, std::size_t indent, bool isOnSameLine)
{
    if (!isNested(value)) {
        to += ' ' + scalar(value) + '\n';
        return;
    }
    if (isOnSameLine) { // the first key follows the dash
        std::string nested;
        append(nested, value, indent);
        to += ' ' + nested.substr(indent);
        return;
    }
    to += '\n';
    append(to, value, indent);
}

void append(std::string& to, Json const& value, std::size_t indent)
{
    constexpr std::size_t step = 2;
    if (value.is_object()) {
        for (auto const& [key, element] : value.items()) {
            to += std::string(indent, ' ') + textOf(key) + ':';
            appendValue(to, element, indent + step, false);
        }
        return;
    }
    for (Json const& element : value) {
        to += std::string(indent, ' ') + '-';
        appendValue(to, element, indent + step, true);
    }
}

} // namespace

std::string yamlText(Json const& document)
{
    std::string text = "---";
    if (!isNested(document))
        return text + ' ' + scalar(document) + '\n';
    text += '\n';
    append(text, document, 0);
    return text;
}

} // namespace mihost
