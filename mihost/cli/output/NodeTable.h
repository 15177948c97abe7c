#ifndef MIHOST_CLI_OUTPUT_NODETABLE_H
#define MIHOST_CLI_OUTPUT_NODETABLE_H

#include "mihost/cli/output/NodeView.h"
#include "mihost/cli/output/Output.h"

#include <functional>
#include <string>
#include <vector>

namespace mihost
{

/** How properties are shown. */
struct PropertyStyle {
    Secrets secrets;
    std::function<std::string(PropertyView const& property)> text = valueText; // of a cell
};

/**
 * Writes the stored values of nodes of one kind: as a table, or as documents like
 * those of the tree, with the selected properties only if columns are selected. Columns are
 * properties by name or id, and the attributes id, index, status and description.
 *
 * @throws Failure (NotFound) for a column that the kind does not have
 */
void writeNodes(NodeKind const& kind, std::vector<IC::MutableNode*> const& nodes,
                PropertyStyle const& style, Selection const& selection, Output& out);

} // namespace mihost

#endif
