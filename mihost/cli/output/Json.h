#ifndef MIHOST_CLI_OUTPUT_JSON_H
#define MIHOST_CLI_OUTPUT_JSON_H

#include "mihost/cli/output/NodeView.h"

#include <nlohmann/json.hpp>

namespace mihost
{

// Keys stand in the order in which they are written.
using Json = nlohmann::ordered_json;

/** Bytes that are no UTF-8 become \xNN, so that the document is always valid. */
Json toJson(std::string const& text);

Json toJson(PropertyView const& property);
Json toJson(NodeView const& node);

} // namespace mihost

#endif
