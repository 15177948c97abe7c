#include "host/Alert.h"
#include "host/EnumValue.h"
#include "host/Number.h"

namespace IC
{

Number::Number(unsigned int const& value) : kind_(UnsignedKind), subSeconds_(0), value_(value) {}

Number::Number(bool const& value) : kind_(BooleanKind), subSeconds_(0), value_(value ? 1 : 0) {}

Number::Number(long seconds, unsigned short subSeconds)
    : kind_(DateKind), subSeconds_(subSeconds), value_(seconds)
{
}

Number::Number(KindType const& kind) : kind_(kind), subSeconds_(0), value_(0) {}

Number::Number(Number const& other) = default;

Number& Number::operator=(Number const& other) = default;

Number::~Number() = default;

Number::KindType Number::getKind() const
{
    return kind_;
}

long long Number::getValue() const
{
    return value_;
}

unsigned short Number::getSubSeconds() const
{
    return subSeconds_;
}

EnumValue::EnumValue(unsigned int const& value) : value_(value) {}

EnumValue::EnumValue(unsigned short const& value) : value_(value) {}

EnumValue::EnumValue(EnumValue const& other) = default;

EnumValue& EnumValue::operator=(EnumValue const& other) = default;

EnumValue::~EnumValue() = default;

unsigned int EnumValue::getValue() const
{
    return value_;
}

Alert::Alert(unsigned int nodeId, std::string const& text) : nodeId_(nodeId), text_(text) {}

Alert::Alert(Alert const& other) = default;

Alert& Alert::operator=(Alert const& other) = default;

Alert::~Alert() = default;

unsigned int Alert::getNodeId() const
{
    return nodeId_;
}

std::string Alert::getText() const
{
    return text_;
}

} // namespace IC
