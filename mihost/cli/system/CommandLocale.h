#ifndef MIHOST_CLI_SYSTEM_COMMANDLOCALE_H
#define MIHOST_CLI_SYSTEM_COMMANDLOCALE_H

#include <string>
#include <vector>

namespace mihost
{

/**
 * From now on commands speak English, which the plug-in scans. LANG, which it reads itself, stays.
 */
void useCommandLocale();

/** The environment, NAME=VALUE each, with the user's own locale. */
std::vector<std::string> userEnvironment();

} // namespace mihost

#endif
