#ifndef MIHOST_CLI_OUTPUT_JSON_H
#define MIHOST_CLI_OUTPUT_JSON_H

#include "host/PropertyValue.h"

#include <nlohmann/json.hpp>
#include <string>

namespace mihost
{

// Keys keep the order in which they are written.
using Json = nlohmann::ordered_json;

/** Bytes that are not UTF-8 become \xNN, so that the document is always valid. */
Json toJson(std::string const& text);

/** A value in its own type: dates are numbers, lists are lists, an empty value is null. */
Json valueToJson(IC::PropertyValue const& value);

} // namespace mihost

#endif
