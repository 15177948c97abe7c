#ifndef MIHOST_CLI_TREETEXT_H
#define MIHOST_CLI_TREETEXT_H

#include "mihost/cli/NodeView.h"
#include "mihost/cli/Output.h"

namespace mihost
{

struct TreeStyle {
    bool properties; // each node's properties below it
    Secrets secrets;
};

/** Draws the nodes, one line each, children below their parents. */
void writeTree(std::vector<IC::MutableNode*> const& nodes, TreeStyle const& style, Output& out);

} // namespace mihost

#endif
