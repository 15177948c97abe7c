#ifndef MIHOST_CLI_OUTPUT_NODETABLE_H
#define MIHOST_CLI_OUTPUT_NODETABLE_H

#include "mihost/cli/output/Json.h"
#include "mihost/cli/output/Output.h"

#include <functional>
#include <string>
#include <vector>

namespace mihost
{

/** A property's text in a table, such as valueText(). */
using ShownText = std::function<std::string(PropertyView const& property)>;

/** Nodes of one kind, a row each, as far as they are stored. */
class NodeTable
{
public:
    /**
     * @param columns  property names or ids, or attributes of nodes; empty for the usual ones
     * @throws Failure (NotFound) for a column that the kind does not have
     */
    NodeTable(NodeKind const& kind, std::vector<std::string> const& columns);

    void write(std::vector<IC::MutableNode*> const& nodes, Secrets secrets, Output& out,
               ShownText const& shownText = valueText) const;

    /** As in the tree, with the chosen properties only where some were chosen. */
    Json json(std::vector<IC::MutableNode*> const& nodes, Secrets secrets) const;

private:
    struct Column {
        std::string heading;
        std::string (*attribute)(IC::MutableNode const& node); // null for a property
        unsigned int property;
    };

    static Column columnOf(NodeKind const& kind, std::string const& name);
    static std::string cell(Column const& column, NodeView const& view, ShownText const& shownText);

    std::vector<Column> columns_;
    bool chosen_;
};

} // namespace mihost

#endif
