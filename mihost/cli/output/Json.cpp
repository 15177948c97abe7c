#include "mihost/cli/output/Json.h"

#include "mihost/runtime/Text.h"

namespace mihost
{

Json valueToJson(IC::PropertyValue const& value)
{
    switch (value.getKind()) {
    case IC::PropertyValue::TextKind:
        return toJson(static_cast<std::string>(value));
    case IC::PropertyValue::BooleanKind:
        return value.getNumber() != 0;
    case IC::PropertyValue::NumberKind:
    case IC::PropertyValue::DateKind:
    case IC::PropertyValue::EnumerationKind:
        return value.getNumber();
    case IC::PropertyValue::NumbersKind: {
        Json list = Json::array();
        for (IC::Number const& number : value.getNumbers())
            list.push_back(number.getValue());
        return list;
    }
    case IC::PropertyValue::TextsKind:
        return listToJson(value.getTexts());
    case IC::PropertyValue::EmptyKind:
        break;
    }
    return nullptr;
}

Json toJson(std::string const& text)
{
    return validUtf8(text);
}

} // namespace mihost
