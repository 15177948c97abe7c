#include "mihost/cli/commands/Facts.h"

#include "mihost/cli/input/Suggestion.h"
#include "mihost/cli/system/Failure.h"
#include "mihost/runtime/Text.h"

#include <algorithm>
#include <fmt/format.h>

namespace mihost
{

void writeFacts(std::vector<Fact> const& facts, Output& out)
{
    std::size_t width = 0;
    for (Fact const& fact : facts)
        width = std::max(width, fact.label.size());
    for (Fact const& fact : facts)
        out.line(fmt::format("{:<{}}  {}", fact.label, width,
                             fact.value.empty() ? "-" : printable(fact.value)));
}

void failForNoAccount(char const* kind, std::string const& name,
                      std::vector<std::string> const& known)
{
    std::string const meant = nearest(name, known);
    throw Failure(NotFound,
                  fmt::format("no local {} '{}' ({})", kind, name,
                              meant.empty() ? fmt::format("'mihost list {}s' shows them", kind)
                                            : fmt::format("did you mean '{}'?", meant)));
}

} // namespace mihost
