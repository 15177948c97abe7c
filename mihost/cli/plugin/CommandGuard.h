#ifndef MIHOST_CLI_PLUGIN_COMMANDGUARD_H
#define MIHOST_CLI_PLUGIN_COMMANDGUARD_H

#include <optional>
#include <string>
#include <string_view>

/**
 * The last check before a command line of the plug-in reaches the shell. It finds what no earlier
 * check can see, such as the names of modules, which the plug-in reads and uses at once.
 */
namespace mihost
{

/**
 * Why a shell would do more with a command line than run the plug-in's command with its arguments;
 * nothing if it would not. The reason repeats nothing of the line but the name of a module.
 */
std::optional<std::string> objectionToCommand(std::string_view line);

/** Whether a command line may run; if not, standard error says why. For commandTap. */
bool mayRun(char const* line);

} // namespace mihost

#endif
