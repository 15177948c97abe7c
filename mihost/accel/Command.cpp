#include "mihost/accel/Command.h"

#include <algorithm>
#include <vector>

namespace miaccel
{

namespace
{

using Words = std::vector<std::string>;

bool isDigit(char c)
{
    return c >= '0' && c <= '9';
}

/** Characters that every shell leaves alone, wherever in a word they stand. */
bool isPlain(char c)
{
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || isDigit(c) || c == '/' || c == '.' ||
           c == '_' || c == '-' || c == '+' || c == ',' || c == ':' || c == '@';
}

bool isBlank(char c)
{
    return c == ' ' || c == '\t';
}

/** Nothing where the line holds anything else than plain words, bare or wholly in quotes. */
std::optional<Words> wordsOf(std::string_view line)
{
    Words words;
    auto at = line.begin();
    while ((at = std::find_if_not(at, line.end(), isBlank)) != line.end()) {
        bool const quoted = *at == '\'';
        if (quoted)
            ++at;
        auto const end = std::find_if_not(at, line.end(), isPlain);
        if (end == at)
            return std::nullopt;
        words.emplace_back(at, end);
        at = end;
        if (quoted && (at == line.end() || *at++ != '\''))
            return std::nullopt;
        if (at != line.end() && !isBlank(*at))
            return std::nullopt;
    }
    return words;
}

/** The number of a "Np" script; 0, which sed refuses, where it is none. */
std::uint64_t lineOfScript(std::string const& script)
{
    constexpr std::size_t maxDigits = 18; // whatever they are, they fit
    std::size_t const digits = script.size() - 1;
    if (digits < 1 || digits > maxDigits || script.back() != 'p' || script.front() == '0' ||
        !std::all_of(script.begin(), script.end() - 1, isDigit))
        return 0;
    return std::stoull(script);
}

bool isOperand(std::string const& word)
{
    return word.front() != '-';
}

bool isModuleName(std::string const& word)
{
    return isOperand(word) && word.find_first_of("/.+,:@") == std::string::npos;
}

std::optional<Command> wc(Words const& words)
{
    if (words.size() != 3 || words[1] != "-l" || !isOperand(words[2]))
        return std::nullopt;
    return Command{Kind::Wc, words[2]};
}

std::optional<Command> sed(Words const& words)
{
    if (words.size() != 4 || words[1] != "-n" || !isOperand(words[3]))
        return std::nullopt;
    std::uint64_t const line = lineOfScript(words[2]);
    if (line == 0)
        return std::nullopt;
    return Command{Kind::Sed, words[3], line};
}

std::optional<Command> date(Words const& words)
{
    if (words.size() != 1)
        return std::nullopt;
    return Command{Kind::Date, {}};
}

std::optional<Command> lsmod(Words const& words)
{
    if (words.size() != 1)
        return std::nullopt;
    return Command{Kind::Lsmod, {}};
}

std::optional<Command> modinfo(Words const& words)
{
    if (words.size() != 2 || !isModuleName(words[1]))
        return std::nullopt;
    return Command{Kind::Modinfo, words[1]};
}

constexpr struct {
    char const* name;
    std::optional<Command> (*parse)(Words const&);
} grammar[] = {
    {"wc", wc}, {"sed", sed}, {"date", date}, {"lsmod", lsmod}, {"modinfo", modinfo},
};

} // namespace

std::optional<Command> recognise(std::string_view line)
{
    std::optional<Words> const words = wordsOf(line);
    if (!words || words->empty())
        return std::nullopt;
    for (auto const& command : grammar)
        if (words->front() == command.name)
            return command.parse(*words);
    return std::nullopt;
}

} // namespace miaccel
