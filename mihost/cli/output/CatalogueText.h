#ifndef MIHOST_CLI_OUTPUT_CATALOGUETEXT_H
#define MIHOST_CLI_OUTPUT_CATALOGUETEXT_H

#include "mihost/cli/catalogue/Catalogue.h"
#include "mihost/cli/output/Layout.h"

#include <string>
#include <vector>

/** The catalogue as text for people, as JSON, and as the reference documents. */
namespace mihost
{

std::vector<std::string> kindLines(NodeKind const& kind, Room const& room);
std::vector<std::string> methodLines(Method const& method, Room const& room);

/** All properties of the kinds, all methods, and the parameters of one, as rows. */
Table propertiesTable(std::vector<NodeKind const*> const& kinds);
Table methodsTable();
Table parametersTable(Method const& method);

Json toJson(NodeKind const& kind);
Json toJson(Method const& method);

/** docs/properties.md and docs/methods.md, word for word. */
std::string propertiesDocument();
std::string methodsDocument();

/** A property's kind with its unit, such as "number, KiB". */
std::string typeText(Property const& property);

/** The traits of a property beyond its kind: "live, acts". */
std::string traitsText(Property const& property);

/** How a value of this form is written. */
char const* formName(Form form);

} // namespace mihost

#endif
