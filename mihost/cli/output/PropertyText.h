#ifndef MIHOST_CLI_OUTPUT_PROPERTYTEXT_H
#define MIHOST_CLI_OUTPUT_PROPERTYTEXT_H

#include "mihost/cli/output/NodeView.h"
#include "mihost/cli/output/Output.h"

namespace mihost
{

/** The properties for people: id and name, value with its unit. */
Grid propertyGrid(std::vector<PropertyView> const& properties);

/** The properties as rows with all that is known of them. */
Table propertyTable(std::vector<PropertyView> const& properties);

/** @param lead  what each line begins with */
void writeProperties(std::vector<PropertyView> const& properties, std::string const& lead,
                     Output& out);

} // namespace mihost

#endif
