// The beginning of a host's own framework: definitions for one header.

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
