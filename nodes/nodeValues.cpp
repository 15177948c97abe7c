#include "nodes/nodeValues.h"

#include "host/make_string.h"

namespace IC::values
{

PropertyValue text(std::string const& value)
{
    return {value, true};
}

PropertyValue texts(std::vector<std::string> const& values)
{
    return {values, true};
}

PropertyValue number(unsigned int value)
{
    return {Number(value), true};
}

PropertyValue truth(bool value)
{
    return {Number(value), true};
}

PropertyValue enumeration(unsigned int value)
{
    return {EnumValue(value), true};
}

PropertyValue date(long seconds)
{
    return {Number(seconds, 0), true};
}

PropertyValue fixedNumberList()
{
    return {std::vector<Number>{Number(0U), Number(1U), Number(24U)}, true};
}

PropertyValue emptyValue()
{
    return {PropertyValue::EmptyKind, true};
}

std::string textOf(PropertyValue const& value)
{
    return NQ::make_string(NQ::make_wstring(value));
}

Error success()
{
    return {0, Number(Number::EmptyKind), ""};
}

Error failure()
{
    return {1, Number(Number::EmptyKind), ""};
}

void setProperties(MutableNode& node, std::initializer_list<Property> properties)
{
    for (Property const& property : properties)
        node.setProperty(property.id, property.value);
}

} // namespace IC::values
