#include "mihost/cli/system/CommandLocale.h"

#include <algorithm>
#include <cstdlib>
#include <optional>
#include <unistd.h>

namespace mihost
{

namespace
{

constexpr char localeVariable[] = "LC_ALL";

/** What useCommandLocale() replaced. */
struct Replaced {
    bool isReplaced = false;
    std::optional<std::string> value; // nothing if it was not set
};

Replaced& replaced()
{
    static Replaced state;
    return state;
}

} // namespace

void useCommandLocale()
{
    if (!replaced().isReplaced) {
        char const* const value = std::getenv(localeVariable);
        replaced() = {true, value ? std::optional<std::string>(value) : std::nullopt};
    }
    setenv(localeVariable, "C", 1);
}

std::vector<std::string> userEnvironment()
{
    std::vector<std::string> variables;
    for (char const* const* each = environ; *each; ++each)
        variables.emplace_back(*each);
    if (!replaced().isReplaced)
        return variables;
    std::string const start = std::string(localeVariable) + '=';
    variables.erase(std::remove_if(variables.begin(), variables.end(),
                                   [&start](std::string const& each) {
                                       return each.compare(0, start.size(), start) == 0;
                                   }),
                    variables.end());
    if (replaced().value)
        variables.push_back(start + *replaced().value);
    return variables;
}

} // namespace mihost
