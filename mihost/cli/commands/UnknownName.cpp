#include "mihost/cli/commands/UnknownName.h"

#include "mihost/cli/accounts/AccountFiles.h"
#include "mihost/cli/input/Suggestion.h"
#include "mihost/cli/system/Failure.h"
#include "mihost/cli/system/TextFile.h"

#include <fmt/format.h>

namespace mihost
{

namespace
{

Failure unknown(char const* noun, char const* list, char const* file, std::string const& name)
{
    std::string const meant = nearest(name, recordNames(linesOf(contentOf(file))));
    return {NotFound, fmt::format("no {} '{}' ({})", noun, name,
                                  meant.empty() ? fmt::format("see 'mihost list {}'", list)
                                                : fmt::format("did you mean {}?", meant))};
}

} // namespace

void failForUnknownAccount(std::string const& name)
{
    throw unknown("account", "users", accountFile, name);
}

void failForUnknownGroup(std::string const& name)
{
    throw unknown("group", "groups", groupFile, name);
}

} // namespace mihost
