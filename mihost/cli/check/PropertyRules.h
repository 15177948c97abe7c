#ifndef MIHOST_CLI_CHECK_PROPERTYRULES_H
#define MIHOST_CLI_CHECK_PROPERTYRULES_H

#include "mihost/cli/check/TreeRules.h"

/** What holds for the properties of every node, measured against the catalogue. */
namespace mihost::checks
{

/** Every property that cannot fail to be read is stored, and none that the catalogue lacks. */
Findings wrongPropertyIds(Nodes const& nodes);

Findings wrongKinds(Nodes const& nodes);

/** True for every value but the requested state of the operating system. */
Findings wrongFlags(Nodes const& nodes);

/** Values that are fixed, or that follow from other properties. For a tree nothing wrote to. */
Findings wrongValues(Nodes const& nodes);

/** The first node of each kind answers every property that it stores, and refuses unknown ids. */
Findings wrongReads(Nodes const& nodes);

} // namespace mihost::checks

#endif
