#ifndef MIHOST_CLI_PROPERTYTEXT_H
#define MIHOST_CLI_PROPERTYTEXT_H

#include "mihost/cli/NodeView.h"
#include "mihost/cli/Output.h"

#include <string>

namespace mihost
{

/** Writes the properties in columns: id, name, value with its unit. */
void writeProperties(std::vector<PropertyView> const& properties, std::string const& indent,
                     Output& out);

} // namespace mihost

#endif
