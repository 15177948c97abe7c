#include "mihost/cli/input/ShellWords.h"

#include "mihost/cli/system/Failure.h"

#include <algorithm>
#include <fmt/format.h>
#include <iterator>
#include <string_view>
#include <utility>

namespace mihost
{

namespace
{

/** Splits byte by byte; says in the end whether a word or a quote was still open. */
class Splitter
{
public:
    explicit Splitter(std::string const& line, std::string breaks = "") : breaks_(std::move(breaks))
    {
        for (char const byte : line)
            take(byte);
    }

    std::vector<std::string> words;
    bool inWord = false;
    char quote = '\0';    // ' or " within one; \ if the next byte is taken literally
    char outer = '\0';    // the quote around a backslash
    std::size_t kept = 0; // bytes of the last word before the last break

private:
    void begin()
    {
        if (inWord)
            return;
        words.emplace_back();
        inWord = true;
        kept = 0;
    }

    void add(char byte)
    {
        begin();
        words.back() += byte;
    }

    void noteBreak(char byte)
    {
        if (breaks_.find(byte) != std::string::npos)
            kept = words.back().size();
    }

    void open(char sign)
    {
        begin();
        outer = quote;
        quote = sign;
        if (sign != '\\')
            kept = words.back().size();
    }

    void take(char byte)
    {
        if (inComment_)
            return;
        bool const escapes = byte == '\\' && quote != '\'';
        bool const quotes = quote == '\0' && (byte == '\'' || byte == '"');
        if (quote == '\\') {
            quote = outer;
            add(byte);
        } else if (escapes || quotes) {
            open(byte);
        } else if (quote != '\0') {
            if (byte == quote) {
                quote = '\0';
                noteBreak(byte);
            } else {
                add(byte);
            }
        } else if (byte == ' ' || byte == '\t') {
            inWord = false;
        } else if (byte == '#' && !inWord) {
            inComment_ = true;
        } else {
            add(byte);
            noteBreak(byte);
        }
    }

    std::string breaks_;
    bool inComment_ = false;
};

/** A word that a password may follow, correctly or not. */
struct PasswordMark {
    std::string_view word;
    std::ptrdiff_t wordsBetween;
};

constexpr PasswordMark passwordMarks[] = {
    {"password", 0},
    {"117", 0},
    {"--password", 0},
    {"set-password", 1},
};

bool hasWordAfter(std::vector<std::string> const& words, PasswordMark const& mark)
{
    auto const found = std::find(words.begin(), words.end(), mark.word);
    return words.end() - found > 1 + mark.wordsBetween;
}

} // namespace

std::vector<std::string> splitWords(std::string const& line)
{
    Splitter splitter(line);
    if (splitter.quote != '\0')
        throw Failure(BadUsage, fmt::format("nothing follows the last {}", splitter.quote));
    return splitter.words;
}

std::vector<std::string> wordsBeingTyped(std::string const& line)
{
    Splitter splitter(line);
    if (!splitter.inWord)
        splitter.words.emplace_back();
    return splitter.words;
}

TypedLine typedLine(std::string const& line, std::string const& breaks)
{
    Splitter splitter(line, breaks);
    if (!splitter.inWord) {
        splitter.words.emplace_back();
        splitter.kept = 0;
    }
    char const quote = splitter.quote == '\\' ? splitter.outer : splitter.quote;
    return {splitter.words, splitter.kept, quote};
}

bool holdsPassword(std::string const& line)
{
    std::vector<std::string> const words = Splitter(line).words;
    bool const inWord = std::any_of(words.begin(), words.end(), [](std::string const& word) {
        return word.find("Password") != std::string::npos || // in any form of the call
               word.rfind("--password=", 0) == 0;
    });
    return inWord ||
           std::any_of(std::begin(passwordMarks), std::end(passwordMarks),
                       [&words](PasswordMark const& mark) { return hasWordAfter(words, mark); });
}

std::string quotedForShell(std::string const& word)
{
    constexpr std::string_view plain = "abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ"
                                       "0123456789_-+./:,@";
    if (!word.empty() && word.find_first_not_of(plain) == std::string::npos)
        return word;
    std::string quoted = "'";
    for (char const byte : word) {
        bool const isAwkward = byte == '\'' || byte == '\\' || byte == '!';
        if (isAwkward)
            quoted += "'\\";
        quoted += byte;
        if (isAwkward)
            quoted += '\'';
    }
    return quoted + '\'';
}

} // namespace mihost
