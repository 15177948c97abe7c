#ifndef MIHOST_CLI_CHECK_TREERULES_H
#define MIHOST_CLI_CHECK_TREERULES_H

#include "host/MutableNode.h"
#include "mihost/cli/check/Verdict.h"

#include <vector>

/** What holds for every tree of nodes, in the order of the host's list. */
namespace mihost::checks
{

using Nodes = std::vector<IC::MutableNode*>;

/** One node of each single kind; kinds in the order in which they are built. */
Findings wrongTypeOrder(Nodes const& nodes);

/** One node of each single kind, and no unknown kind, in any order. */
Findings wrongTypes(Nodes const& nodes);

/** The interface's own id for the first node; ids that count on from there for the others. */
Findings wrongIds(Nodes const& nodes, unsigned int ownId);

Findings wrongParents(Nodes const& nodes);

/** 0 for single nodes, 1 to n for the others. */
Findings wrongIndexes(Nodes const& nodes);

Findings wrongStatuses(Nodes const& nodes);
Findings wrongDescriptions(Nodes const& nodes);
Findings wrongMiIds(Nodes const& nodes, unsigned int ownId);

/** How a finding names a node: its address and id, "os #4". */
std::string nameOf(IC::MutableNode const& node);

} // namespace mihost::checks

#endif
