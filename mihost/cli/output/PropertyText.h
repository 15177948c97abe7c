#ifndef MIHOST_CLI_OUTPUT_PROPERTYTEXT_H
#define MIHOST_CLI_OUTPUT_PROPERTYTEXT_H

#include "mihost/cli/output/NodeView.h"
#include "mihost/cli/output/Output.h"

namespace mihost
{

/** The properties for people: id and name, value with its unit. */
Grid propertyGrid(std::vector<PropertyView> const& properties);

/** @return the properties as rows with everything that is known about them */
Table propertyTable(std::vector<PropertyView> const& properties);

/** @param lead  what each line begins with */
void writeProperties(std::vector<PropertyView> const& properties, std::string const& lead,
                     Output& out);

} // namespace mihost

#endif
