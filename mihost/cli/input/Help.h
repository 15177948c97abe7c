#ifndef MIHOST_CLI_INPUT_HELP_H
#define MIHOST_CLI_INPUT_HELP_H

#include "mihost/cli/input/Command.h"

#include <string>
#include <vector>

/** The help texts beyond what CLI11 makes of options and arguments. */
namespace mihost
{

/** Sets the headings of the help for this command and all that are added later. */
void setHelpLabels(CLI::App& app);

/** Shows the examples at the end of the command's help. */
void setExamples(CLI::App& command, Example const (&examples)[2]);

/** The names of the commands that an application has. */
std::vector<std::string> commandNames(CLI::App const& app);

/** The command of that name; null if there is none. */
CLI::App* findCommand(CLI::App& app, std::string const& name);

/** The commands that were given, the application itself first. */
std::vector<CLI::App const*> givenCommands(CLI::App const& app);

/**
 * The help for a command.
 *
 * @param words  such as "user", "add"; none for the program
 * @throws Failure (BadUsage) if there is no such command
 */
std::string helpOn(CLI::App& app, std::vector<std::string> const& words);

} // namespace mihost

#endif
