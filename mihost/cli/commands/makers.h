#ifndef MIHOST_CLI_COMMANDS_MAKERS_H
#define MIHOST_CLI_COMMANDS_MAKERS_H

#include "mihost/cli/Command.h"

/** One maker for each command, defined in the command's own file. */
namespace mihost::commandMakers
{

std::unique_ptr<Command> tree();
std::unique_ptr<Command> get();

} // namespace mihost::commandMakers

#endif
