#include "mihost/cli/commands/Facts.h"

#include "mihost/runtime/Text.h"

namespace mihost
{

void writeFacts(std::vector<Fact> const& facts, Output& out)
{
    Grid grid{{Column(""), Column("")}, {}};
    for (Fact const& fact : facts)
        grid.rows.push_back({fact.label, fact.value.empty() ? "-" : printable(fact.value)});
    out.lines(layOut(grid, out.room()));
}

} // namespace mihost
