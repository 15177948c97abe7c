#ifndef TESTS_SUPPORT_SHOWN_H
#define TESTS_SUPPORT_SHOWN_H

#include "host/PropertyValue.h"

#include <string>

/** @return kind, value and flag, such as "text abc true" or "numbers 0,1,24 true" */
inline std::string shown(IC::PropertyValue const& value)
{
    static constexpr char const* kinds[] = {"empty", "text",        "number",  "boolean",
                                            "date",  "enumeration", "numbers", "texts"};
    std::string const content = value.getKind() == IC::PropertyValue::DateKind
                                    ? std::to_string(value.getNumber())
                                    : static_cast<std::string>(value);
    return std::string(kinds[value.getKind()]) + " " + content +
           (value.getFlag() ? " true" : " false");
}

#endif
