#ifndef MIHOST_CLI_OUTPUT_PROPERTYTEXT_H
#define MIHOST_CLI_OUTPUT_PROPERTYTEXT_H

#include "mihost/cli/output/NodeView.h"
#include "mihost/cli/output/Output.h"

#include <string>

namespace mihost
{

/** Writes the properties in columns: id, name, value with its unit. */
void writeProperties(std::vector<PropertyView> const& properties, std::string const& indent,
                     Output& out);

} // namespace mihost

#endif
