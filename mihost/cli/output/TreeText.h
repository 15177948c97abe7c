#ifndef MIHOST_CLI_OUTPUT_TREETEXT_H
#define MIHOST_CLI_OUTPUT_TREETEXT_H

#include "mihost/cli/output/NodeView.h"
#include "mihost/cli/output/Output.h"

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
