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
 * The changes as they are shown: without lock files and without what is in the program's own
 * directory; with lines for texts. Where secrets are to be hidden, so are the hashes in account
 * files, and all lines of other files that not everybody may read.
 *
 * @param ownDirectory  where the plug-in works; empty for none
 */
std::vector<FileChange> shownChanges(std::vector<PathChange> const& changes,
                                     std::string const& ownDirectory, Secrets secrets);

} // namespace mihost

#endif
