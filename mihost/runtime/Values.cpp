#include "host/Alert.h"
#include "host/EnumValue.h"
#include "host/Error.h"
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

Error::Error(unsigned char status, Number const& code, std::string const& text)
    : status_(status), code_(code), text_(text)
{
}

Error::Error(Error const& other) = default;

Error& Error::operator=(Error const& other) = default;

Error::~Error() = default;

unsigned char Error::getStatus() const
{
    return status_;
}

Error::operator StatusType() const
{
    return static_cast<StatusType>(status_);
}

Error::operator std::string() const
{
    std::string form = "status " + std::to_string(static_cast<unsigned int>(status_));
    if (!text_.empty())
        form += ": " + text_;
    return form;
}

std::string Error::getText() const
{
    return text_;
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
