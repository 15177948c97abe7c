#ifndef MIHOST_CLI_COMMANDS_GROUPVIEW_H
#define MIHOST_CLI_COMMANDS_GROUPVIEW_H

#include <string>

namespace mihost
{

class Session;

/**
 * Shows one local group as its administrator reads it, whether the plug-in has a node for it or
 * not.
 *
 * @throws Failure (NotFound) if there is none of this name
 */
void showGroup(Session& session, std::string const& name);

} // namespace mihost

#endif
