#ifndef MIHOST_CLI_OUTPUT_NODEJSON_H
#define MIHOST_CLI_OUTPUT_NODEJSON_H

#include "mihost/cli/output/Json.h"
#include "mihost/cli/output/NodeView.h"

namespace mihost
{

Json toJson(PropertyView const& property);

/** The node with its properties by name, or by decimal id if the catalogue lacks them. */
Json toJson(NodeView const& view);

} // namespace mihost

#endif
