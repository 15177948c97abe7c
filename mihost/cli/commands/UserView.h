#ifndef MIHOST_CLI_COMMANDS_USERVIEW_H
#define MIHOST_CLI_COMMANDS_USERVIEW_H

#include <string>

namespace mihost
{

class Session;

/**
 * Shows one local account in words, even if the plug-in has no node for it.
 *
 * @throws Failure (NotFound) if there is none of this name
 */
void showUser(Session& session, std::string const& name);

} // namespace mihost

#endif
