#include "mihost/cli/shell/BashCompletion.h"

#include "mihost/cli/input/ShellWords.h"

namespace mihost
{

namespace
{

constexpr std::string_view plain =
    "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789_@%+=:,./-";
constexpr std::string_view specialInQuotes = "$`\"\\";

bool isPlain(char byte)
{
    return static_cast<unsigned char>(byte) >= 0x80 || plain.find(byte) != std::string_view::npos;
}

/** One byte of a text. */
std::string quotedByte(char byte, char quote)
{
    std::string const itself(1, byte);
    if (quote == '\'')
        return byte == '\'' ? "'\\''" : itself;
    if (quote == '"' && byte == '!')
        return "\"\\!\""; // within double quotes the history would be searched
    bool const isSpecial =
        quote == '"' ? specialInQuotes.find(byte) != std::string_view::npos : !isPlain(byte);
    return isSpecial ? "\\" + itself : itself;
}

} // namespace

std::string quotedForBash(std::string_view text, char quote)
{
    std::string quoted;
    for (char const byte : text)
        quoted += quotedByte(byte, quote);
    return quoted;
}

std::string bashCompletionText(std::string const& line, std::string const& breaks,
                               NodeNames const& names, CommandTable const& table)
{
    TypedLine typed = typedLine(line, breaks);
    if (typed.words.size() < 2)
        return completionText({}); // the cursor is in the program's name
    typed.words.erase(typed.words.begin());
    Completion completion = complete(typed.words, names, table);
    for (Candidate& candidate : completion.candidates)
        candidate = {quotedForBash(candidate.word.substr(typed.kept), typed.quote), ""};
    return completionText(completion);
}

} // namespace mihost
