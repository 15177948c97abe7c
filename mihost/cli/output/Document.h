#ifndef MIHOST_CLI_OUTPUT_DOCUMENT_H
#define MIHOST_CLI_OUTPUT_DOCUMENT_H

#include "mihost/cli/input/Format.h"
#include "mihost/cli/output/Json.h"

#include <string>

namespace mihost
{

/** The document with line ends, in one of the formats for which isDocument() holds. */
std::string documentText(Json const& document, Format format);

/** The document as YAML, from "---" on. */
std::string yamlText(Json const& document);

} // namespace mihost

#endif
