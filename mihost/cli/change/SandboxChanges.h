#ifndef MIHOST_CLI_CHANGE_SANDBOXCHANGES_H
#define MIHOST_CLI_CHANGE_SANDBOXCHANGES_H

#include "mihost/cli/change/FileChange.h"
#include "mihost/cli/output/NodeView.h"
#include "mihost/sandbox/Changes.h"

#include <string>
#include <vector>

namespace mihost
{

/**
 * The changes to show: without lock files and the program's own directory, with lines for texts. If
 * secrets are hidden, so are the hashes in account files, and all lines of other files that are not
 * world-readable.
 *
 * @param ownDirectory  where the plug-in works; empty for none
 */
std::vector<FileChange> shownChanges(std::vector<PathChange> const& changes,
                                     std::string const& ownDirectory, Secrets secrets);

} // namespace mihost

#endif
