#include "mihost/cli/commands/Facts.h"

#include "mihost/cli/input/Suggestion.h"
#include "mihost/cli/system/Failure.h"
#include "mihost/runtime/Text.h"

#include <fmt/format.h>

namespace mihost
{

void writeFacts(std::vector<Fact> const& facts, Output& out)
{
    Grid grid{{Column(""), Column("")}, {}};
    for (Fact const& fact : facts)
        grid.rows.push_back({fact.label, fact.value.empty() ? "-" : printable(fact.value)});
    out.lines(layOut(grid, out.room()));
}

void failForNoAccount(char const* kind, std::string const& name,
                      std::vector<std::string> const& known)
{
    std::string const meant = nearest(name, known);
    throw Failure(NotFound, fmt::format("no local {} '{}' ({})", kind, name,
                                        meant.empty() ? fmt::format("see 'mihost list {}s'", kind)
                                                      : fmt::format("did you mean '{}'?", meant)));
}

} // namespace mihost
