#ifndef MIHOST_CLI_COMMANDS_MAKERS_H
#define MIHOST_CLI_COMMANDS_MAKERS_H

#include "mihost/cli/input/Command.h"

namespace mihost
{

/** All of the program's commands. */
CommandTable const& commandTable();

} // namespace mihost

/** One maker for each command, defined in the command's own file. */
namespace mihost::commandMakers
{

std::unique_ptr<Command> tree();
std::unique_ptr<Command> list();
std::unique_ptr<Command> get();
std::unique_ptr<Command> set();
std::unique_ptr<Command> call();
std::unique_ptr<Command> refresh();
std::unique_ptr<Command> clearLog();
std::unique_ptr<Command> power();
std::unique_ptr<Command> watch();
std::unique_ptr<Command> shell();
std::unique_ptr<Command> doctor();
std::unique_ptr<Command> metrics();
std::unique_ptr<Command> check();
std::unique_ptr<Command> version();
std::unique_ptr<Command> properties();
std::unique_ptr<Command> methods();

} // namespace mihost::commandMakers

#endif
