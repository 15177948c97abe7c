#include "mihost/cli/commands/CommandRows.h"

namespace mihost
{

CommandTable const& commandTable()
{
#define MIHOST_ADDRESS_OF_ROW(NAME) &commandRows::NAME,
    static CommandTable const rows = {MIHOST_COMMANDS(MIHOST_ADDRESS_OF_ROW)};
#undef MIHOST_ADDRESS_OF_ROW
    return rows;
}

} // namespace mihost
