#ifndef MIHOST_CLI_SYSTEM_COMMANDLOCALE_H
#define MIHOST_CLI_SYSTEM_COMMANDLOCALE_H

#include <string>
#include <vector>

namespace mihost
{

/**
 * Makes commands print English from now on, which the plug-in scans. LANG, which the plug-in reads,
 * stays.
 */
void useCommandLocale();

/** The environment, NAME=VALUE each, with the user's own locale. */
std::vector<std::string> userEnvironment();

} // namespace mihost

#endif
