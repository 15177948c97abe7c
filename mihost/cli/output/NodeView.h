#ifndef MIHOST_CLI_OUTPUT_NODEVIEW_H
#define MIHOST_CLI_OUTPUT_NODEVIEW_H

#include "host/MutableNode.h"
#include "mihost/cli/catalogue/Catalogue.h"
#include "mihost/cli/output/Table.h"

#include <string>
#include <vector>

namespace mihost
{

/** One property of a node and its catalogue row. */
struct PropertyView {
    unsigned int id;
    Property const* row; // null for a property that the catalogue does not know
    IC::PropertyValue value;
    bool hidden;         // a secret that is not to be shown
    std::string unknown; // why the plug-in could not read it; empty if it could
};

struct NodeView {
    IC::MutableNode const* node;
    std::vector<PropertyView> properties; // by id
};

/** Whether secrets are to be shown. */
enum class Secrets { Hide, Show };

/** Everything that is stored, and what answers only live. */
NodeView storedView(IC::MutableNode const& node, Secrets secrets);

/** Reads every property through the node; omits those that fail. */
NodeView liveView(IC::MutableNode const& node, Secrets secrets);

/**
 * Reads the named properties through the node.
 *
 * @param names  ids or catalogue names
 * @throws Failure for a property that the node does not have or that cannot be read
 */
NodeView liveView(IC::MutableNode const& node, std::vector<std::string> const& names,
                  Secrets secrets);

/** A property by id or catalogue name. @throws Failure (NotFound) listing the existing ones */
unsigned int propertyId(IC::MutableNode const& node, std::string const& name);

/** The value as a person reads it, "-" if it is unknown; not yet safe for a terminal. */
std::string valueText(PropertyView const& property);

/** The value for a table. */
Cell cellOf(PropertyView const& property);

/** The property's catalogue name, or its id if it has none. */
std::string nameOf(PropertyView const& property);

} // namespace mihost

#endif
