// The beginning of a framework of one's own: bodies for what a header declares.

#include "host/EnumValue.h"

namespace IC
{

EnumValue::EnumValue(unsigned int const& value) : value_(value) {}
EnumValue::EnumValue(unsigned short const& value) : value_(value) {}
EnumValue::EnumValue(EnumValue const& other) = default;
EnumValue& EnumValue::operator=(EnumValue const& other) = default;
EnumValue::~EnumValue() = default;

unsigned int EnumValue::getValue() const
{
    return value_;
}

} // namespace IC
