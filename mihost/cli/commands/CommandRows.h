#ifndef MIHOST_CLI_COMMANDS_COMMANDROWS_H
#define MIHOST_CLI_COMMANDS_COMMANDROWS_H

#include "mihost/cli/input/Command.h"

/** Every command, in the order of the help text. Each has its row in its own file. */
#define MIHOST_COMMANDS(COMMAND)                                                                   \
    COMMAND(tree)                                                                                  \
    COMMAND(list)                                                                                  \
    COMMAND(get)                                                                                   \
    COMMAND(user)                                                                                  \
    COMMAND(group)                                                                                 \
    COMMAND(set)                                                                                   \
    COMMAND(call)                                                                                  \
    COMMAND(refresh)                                                                               \
    COMMAND(clearLog)                                                                              \
    COMMAND(power)                                                                                 \
    COMMAND(watch)                                                                                 \
    COMMAND(shell)                                                                                 \
    COMMAND(doctor)                                                                                \
    COMMAND(metrics)                                                                               \
    COMMAND(check)                                                                                 \
    COMMAND(version)                                                                               \
    COMMAND(properties)                                                                            \
    COMMAND(methods)

namespace mihost
{

/** All of the program's commands. */
CommandTable const& commandTable();

} // namespace mihost

namespace mihost::commandRows
{

#define MIHOST_DECLARE_ROW(NAME) extern CommandRow const NAME;
MIHOST_COMMANDS(MIHOST_DECLARE_ROW)
#undef MIHOST_DECLARE_ROW

} // namespace mihost::commandRows

#endif
