#include "tests/support/Shown.h"

std::string shown(IC::PropertyValue const& value)
{
    static constexpr char const* kinds[] = {"empty", "text",        "number",  "boolean",
                                            "date",  "enumeration", "numbers", "texts"};
    std::string const content = value.getKind() == IC::PropertyValue::DateKind
                                    ? std::to_string(value.getNumber())
                                    : static_cast<std::string>(value);
    return std::string(kinds[value.getKind()]) + " " + content +
           (value.getFlag() ? " true" : " false");
}
