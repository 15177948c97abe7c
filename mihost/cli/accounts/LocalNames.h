#ifndef MIHOST_CLI_ACCOUNTS_LOCALNAMES_H
#define MIHOST_CLI_ACCOUNTS_LOCALNAMES_H

#include "mihost/cli/catalogue/Catalogue.h"

#include <string>
#include <vector>

namespace mihost
{

/**
 * The names of the nodes of a kind as the plug-in would show them, without the plug-in: from the
 * files that it reads, for shells that complete a word and must not wait. None for other kinds
 * than users, groups and drivers.
 */
std::vector<std::string> localNames(NodeKind const& kind);

} // namespace mihost

#endif
