#ifndef MIHOST_CLI_CHECK_ACCOUNTS_H
#define MIHOST_CLI_CHECK_ACCOUNTS_H

#include "mihost/cli/check/Subject.h"

/** The nodes that a refresh replaces. */
namespace mihost::checks
{

bool isAccount(unsigned int nodeType);

/** The user and group nodes, in the order of the list. */
Nodes accountsOf(Nodes const& nodes);

/** Writes 0 to the operating-system node's refresh property. */
IC::Error refresh(Subject& subject);

} // namespace mihost::checks

#endif
