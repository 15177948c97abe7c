#include "mihost/cli/accounts/LoginDefs.h"

#include "mihost/cli/system/TextFile.h"

#include <algorithm>
#include <cstdio>
#include <fmt/format.h>
#include <iterator>
#include <sstream>

namespace mihost
{

namespace
{

struct Bound {
    std::string key;
    std::optional<unsigned int>& value;
    bool isFound;
};

/** Contract: a line without a number keeps the earlier one; nothing counts after the last key. */
void readBounds(std::vector<std::string> const& lines, std::vector<Bound> bounds)
{
    for (std::string const& line : lines) {
        for (Bound& bound : bounds) {
            if (line.compare(0, bound.key.size(), bound.key) != 0)
                continue;
            bound.isFound = true;
            unsigned int number = 0;
            if (line.size() > bound.key.size() &&
                std::sscanf(line.c_str() + bound.key.size() + 1, "%u", &number) == 1)
                bound.value = number;
        }
        if (std::all_of(bounds.begin(), bounds.end(),
                        [](Bound const& bound) { return bound.isFound; }))
            return;
    }
}

/** The word after the key; the last line that has one counts. */
std::string wordOf(std::vector<std::string> const& lines, std::string const& wanted)
{
    std::string found;
    for (std::string const& line : lines) {
        std::istringstream words(line);
        std::string key;
        std::string word;
        if (words >> key >> word && key == wanted)
            found = word;
    }
    return found;
}

} // namespace

bool IdRange::holds(unsigned int id) const
{
    return id == 0 || (lowest.value_or(0) <= id && id <= highest.value_or(0));
}

std::string IdRange::objectionTo(char const* what, unsigned int id) const
{
    if (holds(id))
        return "";
    if (id < lowest.value_or(0))
        return fmt::format("{} {} is below {} {}", what, id, lowestKey, *lowest);
    if (!highest)
        return fmt::format("{} is not set in {}", highestKey, loginDefsFile);
    return fmt::format("{} {} is above {} {}", what, id, highestKey, *highest);
}

LoginDefs::LoginDefs(std::string const& text)
{
    std::vector<std::string> const lines = linesOf(text);
    readBounds(lines, {{users_.lowestKey, users_.lowest, false},
                       {users_.highestKey, users_.highest, false},
                       {groups_.lowestKey, groups_.lowest, false},
                       {groups_.highestKey, groups_.highest, false}});
    encryptMethod_ = wordOf(lines, "ENCRYPT_METHOD");
}

std::vector<std::string> LoginDefs::missingKeys() const
{
    std::vector<std::string> missing;
    for (IdRange const* range : {&users_, &groups_}) {
        if (!range->lowest)
            missing.emplace_back(range->lowestKey);
        if (!range->highest)
            missing.emplace_back(range->highestKey);
    }
    return missing;
}

LoginDefs readLoginDefs()
{
    return LoginDefs(contentOf(loginDefsFile));
}

} // namespace mihost
