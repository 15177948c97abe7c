#ifndef MIHOST_CLI_OUTPUT_NODETREE_H
#define MIHOST_CLI_OUTPUT_NODETREE_H

#include "mihost/cli/output/NodeView.h"
#include "mihost/cli/output/Output.h"

#include <vector>

namespace mihost
{

struct TreeStyle {
    bool properties; // each node's properties below it
    Secrets secrets;
};

/**
 * Writes the nodes in the user's format: as a tree, children below their parents, as documents, or
 * as rows of what the tree shows.
 */
void writeTree(std::vector<IC::MutableNode*> const& nodes, TreeStyle const& style, Output& out);

} // namespace mihost

#endif
