#include "mihost/cli/input/Suggestion.h"

#include <algorithm>
#include <fmt/format.h>

namespace mihost
{

namespace
{

std::string inLowerCase(std::string_view text)
{
    std::string lower(text);
    for (char& letter : lower)
        if (letter >= 'A' && letter <= 'Z')
            letter = static_cast<char>(letter - 'A' + 'a');
    return lower;
}

/** The names, as many as fit into a message. */
std::string listed(std::vector<std::string> const& names)
{
    constexpr std::size_t longestList = 90; // characters
    std::string list;
    for (std::string const& name : names) {
        if (!list.empty() && list.size() + name.size() > longestList)
            return list + ", ...";
        list += (list.empty() ? "" : ", ") + name;
    }
    return list;
}

/** @return how many letters to add, remove, replace or swap to turn one into the other */
std::size_t slipsBetween(std::string_view one, std::string_view other)
{
    std::vector<std::vector<std::size_t>> slips(one.size() + 1,
                                                std::vector<std::size_t>(other.size() + 1));
    for (std::size_t i = 0; i <= one.size(); ++i)
        for (std::size_t j = 0; j <= other.size(); ++j) {
            if (i == 0 || j == 0) {
                slips[i][j] = i + j;
                continue;
            }
            bool const same = one[i - 1] == other[j - 1];
            slips[i][j] = std::min(
                {slips[i - 1][j] + 1, slips[i][j - 1] + 1, slips[i - 1][j - 1] + (same ? 0 : 1)});
            if (i > 1 && j > 1 && one[i - 1] == other[j - 2] && one[i - 2] == other[j - 1])
                slips[i][j] = std::min(slips[i][j], slips[i - 2][j - 2] + 1);
        }
    return slips[one.size()][other.size()];
}

} // namespace

std::string nearest(std::string_view word, std::vector<std::string> const& names)
{
    constexpr std::size_t longest = 64; // longer words are not typing errors
    if (word.size() < 2 || word.size() > longest)
        return "";
    std::string const wanted = inLowerCase(word);
    std::size_t const maxCorrections = word.size() < 6 ? 1 : 2;
    std::size_t fewest = maxCorrections + 1;
    std::string best;
    for (std::string const& name : names) {
        if (name.size() > longest)
            continue;
        std::size_t const slips = slipsBetween(wanted, inLowerCase(name));
        if (slips >= fewest)
            continue;
        fewest = slips;
        best = name;
    }
    return best;
}

std::string suggestion(std::string_view word, std::vector<std::string> const& names,
                       std::string_view lead)
{
    if (std::string const meant = nearest(word, names); !meant.empty())
        return fmt::format("did you mean {}?", meant);
    return fmt::format("{} {}", lead, names.empty() ? "none" : listed(names));
}

} // namespace mihost
