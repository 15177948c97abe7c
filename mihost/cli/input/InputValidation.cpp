#include "mihost/cli/input/InputValidation.h"

#include "mihost/cli/input/Day.h"
#include "mihost/runtime/Text.h"

#include <algorithm>
#include <fmt/format.h>

namespace mihost
{

namespace
{

constexpr std::string_view separators = ",:";
constexpr std::size_t mostDigits = 9;

bool isControl(char32_t character)
{
    return character < 0x20 || (character >= 0x7F && character <= 0x9F);
}

/** Bytes that no value may contain. */
std::optional<std::string> objectionToCharacters(std::string_view text)
{
    while (!text.empty()) {
        Utf8Piece const piece = firstPiece(text);
        std::string_view const shown = text.substr(0, piece.length);
        if (!piece.valid)
            return fmt::format("contains the byte {}, which is not UTF-8",
                               hexByte(static_cast<unsigned char>(text[0])));
        if (isControl(piece.character))
            return fmt::format("contains the control character '{}'", printable(shown));
        if (shellMetacharacters.find(shown) != std::string_view::npos)
            return fmt::format("contains the shell metacharacter '{}'", shown);
        if (separators.find(shown) != std::string_view::npos)
            return fmt::format("contains the separator '{}'", shown);
        text.remove_prefix(piece.length);
    }
    return std::nullopt;
}

std::optional<std::string> objectionToWord(std::string_view text)
{
    if (text.find(' ') != std::string_view::npos)
        return "contains a blank";
    if (text[0] == '-')
        return "begins with '-', so a command would read it as an option";
    return std::nullopt;
}

std::optional<std::string> objectionToName(std::string_view text)
{
    if (auto reason = objectionToWord(text))
        return reason;
    if (text[0] == '+')
        return "begins with '+', so tools would read it as an id";
    return std::nullopt;
}

bool isDecimal(std::string_view text)
{
    return !text.empty() && text.find_first_not_of("0123456789") == std::string_view::npos;
}

/** Tools would read such a name as another account's id or as a path. */
std::optional<std::string> objectionToPlainName(std::string_view text)
{
    if (auto reason = objectionToName(text))
        return reason;
    if (isDecimal(text))
        return "consists of digits only, so tools would read it as an id";
    if (text.find('/') != std::string_view::npos || text == "." || text == "..")
        return "would be read as a path";
    return std::nullopt;
}

std::optional<std::string> objectionToForm(Form form, std::string_view text)
{
    switch (form) {
    case Form::AccountName:
        return objectionToName(text);
    case Form::PlainName:
        return objectionToPlainName(text);
    case Form::Password:
        return objectionToWord(text);
    case Form::Path:
        if (text[0] != '/')
            return "is not an absolute path (it must begin with '/')";
        return std::nullopt;
    case Form::Digits:
        if (!isDecimal(text) || text.size() > mostDigits)
            return fmt::format("is not a number (it must be 1 to {} decimal digits)", mostDigits);
        return std::nullopt;
    case Form::Day:
        if (!parseDay(text))
            return fmt::format("is not a day (use {})", dayForm);
        return std::nullopt;
    case Form::Free:
    case Form::Words:
    case Form::Hash:
    case Form::MethodCall:
        break;
    }
    return std::nullopt;
}

std::size_t lengthAsArgument(std::string_view text)
{
    return text.size() + static_cast<std::size_t>(std::count(text.begin(), text.end(), ' '));
}

} // namespace

std::optional<std::string> objection(Form form, std::string_view text)
{
    if (text.empty())
        return "is empty";
    if (auto reason = objectionToCharacters(text))
        return form == Form::Password
                   ? "contains a character that is not allowed (use letters, digits and "
                     "@ + - . / _)"
                   : reason;
    if (auto reason = objectionToForm(form, text))
        return reason;
    if (lengthAsArgument(text) > longestArgument)
        return fmt::format("is longer than {} bytes, each blank counting twice", longestArgument);
    return std::nullopt;
}

std::optional<std::string> objectionToHash(std::string_view text)
{
    static constexpr std::string_view alphabet =
        "./0123456789ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz";
    static constexpr std::string_view further = "$=,+-_";
    constexpr std::size_t traditionalLength = 13;
    constexpr char form[] = "it must be a password hash as the shadow file holds it, such as "
                            "$6$SALT$HASH, or * or ! for none";
    std::string_view hash = text;
    while (!hash.empty() && hash[0] == '!') // locked
        hash.remove_prefix(1);
    bool const none = (hash.empty() && !text.empty()) || text == "*";
    bool const traditional = hash.size() == traditionalLength &&
                             hash.find_first_not_of(alphabet) == std::string_view::npos;
    bool const modern = hash.size() > 3 && hash[0] == '$' &&
                        hash.find('$', 1) != std::string_view::npos &&
                        std::all_of(hash.begin(), hash.end(), [](char character) {
                            return alphabet.find(character) != std::string_view::npos ||
                                   further.find(character) != std::string_view::npos;
                        });
    if (none || traditional || modern)
        return std::nullopt;
    return form;
}

} // namespace mihost
