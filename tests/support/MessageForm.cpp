#include "tests/support/MessageForm.h"

#include "tests/support/Lines.h"

#include <algorithm>
#include <cctype>
#include <regex>
#include <string_view>

namespace
{

/** Names such as UserSetAttrib, LANG or $6$ keep their capital letters. */
bool isName(std::string const& word)
{
    return std::any_of(word.begin() + 1, word.end(), [](unsigned char each) {
        return std::isupper(each) || std::isdigit(each) || each == '_';
    });
}

/** Without texts of the plug-in and of commands, which have any form. */
std::string ownWords(std::string const& message)
{
    // From the first mark to the last, since a text may have marks itself.
    std::string text = std::regex_replace(message, std::regex("'.*'"), "''");
    for (char const* const before : {"a command printed: ", "the plug-in returned "})
        if (std::size_t const at = text.find(before); at != std::string::npos)
            text.resize(at);
    return text;
}

} // namespace

std::optional<std::string> flawOf(std::string const& message)
{
    constexpr std::size_t longest = 160; // characters
    std::string const text = ownWords(message);
    if (text.size() > longest)
        return "is too long";
    if (text.find('\n') != std::string::npos || text.find("\\n") != std::string::npos)
        return "has more than one line";
    if (text.size() > 1 && text.back() == '.' && text[text.size() - 2] != '.')
        return "ends with a full stop";
    std::string const first = text.substr(0, text.find_first_of(" :="));
    bool const isPrefix = text.compare(first.size(), 2, ": ") == 0; // of a property or parameter
    if (!first.empty() && std::isupper(static_cast<unsigned char>(first[0])) && !isName(first) &&
        !isPrefix)
        return "begins with a capital letter";
    std::string const said = std::regex_replace(text, std::regex("\\(.*\\)"), "");
    if (said.find("; see ") != std::string::npos || said.find("; use ") != std::string::npos ||
        said.find("; did you") != std::string::npos)
        return "has what to do outside of parentheses";
    return std::nullopt;
}

std::optional<std::string> flawOfMessages(std::string const& standardError)
{
    constexpr std::string_view start = "mihost: ";
    for (std::string const& line : linesOf(standardError))
        if (line.compare(0, start.size(), start) == 0)
            if (auto const flaw = flawOf(line.substr(start.size())))
                return "'" + line + "' " + *flaw;
    return std::nullopt;
}
