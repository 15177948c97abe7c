#ifndef MIHOST_CLI_OUTPUT_JSON_H
#define MIHOST_CLI_OUTPUT_JSON_H

#include "host/PropertyValue.h"

#include <nlohmann/json.hpp>
#include <string>
#include <vector>

namespace mihost
{

// Keys keep the order in which they are written.
using Json = nlohmann::ordered_json;

/** Bytes that are not UTF-8 become \xNN, so that the document is always valid. */
Json toJson(std::string const& text);

template <class Value> Json listToJson(std::vector<Value> const& values)
{
    Json list = Json::array();
    for (Value const& value : values)
        list.push_back(toJson(value));
    return list;
}

/** A value in its own type: dates are numbers, lists are lists, an empty value is null. */
Json valueToJson(IC::PropertyValue const& value);

} // namespace mihost

#endif
