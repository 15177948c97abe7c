#ifndef MIHOST_CLI_COMMANDS_GROUPVIEW_H
#define MIHOST_CLI_COMMANDS_GROUPVIEW_H

#include <string>

namespace mihost
{

class Session;

/**
 * Shows one local group in words, even if the plug-in has no node for it.
 *
 * @throws Failure (NotFound) if there is none of this name
 */
void showGroup(Session& session, std::string const& name);

} // namespace mihost

#endif
