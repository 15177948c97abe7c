#include "mihost/cli/Command.h"
#include "mihost/cli/commands/makers.h"

namespace mihost
{

std::vector<CommandRow> const& commands()
{
    static std::vector<CommandRow> const rows = {
        {"tree", "show the tree, one line a node", commandMakers::tree},
        {"get", "read properties of a node, live", commandMakers::get},
    };
    return rows;
}

} // namespace mihost
