#include "host/Alert.h"
#include "host/EnumValue.h"
#include "host/Error.h"
#include "host/PropertyValue.h"
#include "tests/hostcheck/other_host/Broken.h"

#include <ctime>
#include <iomanip>
#include <limits>
#include <sstream>

namespace IC
{

Number::Number(unsigned int const& value)
{
    kind_ = UnsignedKind;
    value_ = value;
    subSeconds_ = 0;
}

Number::Number(bool const& value)
{
    kind_ = broken(Way::BooleanIsANumber) ? UnsignedKind : BooleanKind;
    value_ = value;
    subSeconds_ = 0;
}

Number::Number(long seconds, unsigned short subSeconds)
{
    kind_ = DateKind;
    value_ = seconds;
    subSeconds_ = subSeconds;
}

Number::Number(KindType const& kind)
{
    kind_ = kind;
    value_ = 0;
    subSeconds_ = 0;
}

Number::Number(Number const& other)
{
    *this = other;
}

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

EnumValue::EnumValue(unsigned int const& value)
{
    value_ = value;
}

EnumValue::EnumValue(unsigned short const& value)
{
    value_ = broken(Way::ShortEnumIsAByte) ? value % 256U : value;
}

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

Error::Error(Error const& other)
    : status_(other.status_), code_(other.code_),
      text_(broken(Way::ErrorCopyLosesText) ? "" : other.text_)
{
}

Error& Error::operator=(Error const& other) = default;

Error::~Error() = default;

unsigned char Error::getStatus() const
{
    return status_;
}

Error::operator StatusType() const
{
    return status_ == 0 ? Success : Failure;
}

Error::operator std::string() const
{
    return status_ == 0 ? "ok" : "failure " + std::to_string(status_) + " [" + text_ + "]";
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

// Property values: every form is written to a stream.

PropertyValue::PropertyValue(std::string const& text, bool const& flag)
    : kind_(TextKind), flag_(flag && !broken(Way::FlagIsForgotten)), content_(text)
{
}

PropertyValue::PropertyValue(char const* text, bool const& flag)
    : PropertyValue(std::string(text), flag)
{
}

PropertyValue::PropertyValue(Number const& number, bool const& flag)
    : kind_(EmptyKind), flag_(flag), content_(number)
{
    static constexpr KindType kinds[] = {EmptyKind, NumberKind, BooleanKind, DateKind};
    kind_ = kinds[number.getKind()];
}

PropertyValue::PropertyValue(EnumValue const& value, bool const& flag)
    : kind_(EnumerationKind), flag_(flag), content_(value)
{
}

PropertyValue::PropertyValue(std::vector<Number> const& numbers, bool const& flag)
    : kind_(NumbersKind), flag_(flag), content_(numbers)
{
}

PropertyValue::PropertyValue(std::vector<std::string> const& texts, bool const& flag)
    : kind_(TextsKind), flag_(flag), content_(texts)
{
}

PropertyValue::PropertyValue(KindType const& kind, bool const& flag) : kind_(kind), flag_(flag) {}

PropertyValue::PropertyValue(PropertyValue const& other) = default;

PropertyValue& PropertyValue::operator=(PropertyValue const& other) = default;

PropertyValue::~PropertyValue() = default;

namespace
{

void write(std::ostream& out, Number const& number)
{
    if (number.getKind() == Number::UnsignedKind) {
        out << number.getValue();
    } else if (number.getKind() == Number::BooleanKind) {
        out << (number.getValue() ? "true" : "false");
    } else if (number.getKind() == Number::DateKind) {
        auto const time = static_cast<std::time_t>(number.getValue());
        std::tm fields{};
        broken(Way::DatesAreUtc) ? gmtime_r(&time, &fields) : localtime_r(&time, &fields);
        out << std::put_time(&fields, "%Y-%m-%d %H:%M:%S");
    }
}

void write(std::ostream& out, std::string const& text)
{
    out << text;
}

template <class Element> void writeList(std::ostream& out, std::vector<Element> const& list)
{
    char const* separator = "";
    for (Element const& element : list) {
        out << separator;
        write(out, element);
        separator = ",";
    }
}

} // namespace

PropertyValue::operator std::string() const
{
    std::ostringstream out;
    if (auto const* text = std::get_if<std::string>(&content_))
        write(out, *text);
    else if (auto const* number = std::get_if<Number>(&content_))
        write(out, *number);
    else if (auto const* value = std::get_if<EnumValue>(&content_))
        out << value->getValue();
    writeList(out, getNumbers());
    writeList(out, getTexts());
    return out.str();
}

PropertyValue::operator unsigned int() const
{
    unsigned long long number = 0;
    constexpr auto most = std::numeric_limits<unsigned int>::max();
    if (auto const* text = std::get_if<std::string>(&content_)) {
        for (char const digit : *text) {
            if (digit < '0' || digit > '9')
                return broken(Way::NumberIsThePrefix) ? static_cast<unsigned int>(number) : 0;
            number = number * 10 + static_cast<unsigned int>(digit - '0');
            if (number > most)
                return 0;
        }
    } else if (getNumber() > 0) {
        number = static_cast<unsigned long long>(getNumber());
    }
    return number > most ? 0 : static_cast<unsigned int>(number);
}

PropertyValue::KindType PropertyValue::getKind() const
{
    return kind_;
}

bool PropertyValue::getFlag() const
{
    return flag_;
}

long long PropertyValue::getNumber() const
{
    if (kind_ == EnumerationKind && std::holds_alternative<EnumValue>(content_))
        return std::get<EnumValue>(content_).getValue();
    return std::holds_alternative<Number>(content_) ? std::get<Number>(content_).getValue() : 0;
}

std::vector<Number> PropertyValue::getNumbers() const
{
    if (std::holds_alternative<std::vector<Number>>(content_))
        return std::get<std::vector<Number>>(content_);
    return {};
}

std::vector<std::string> PropertyValue::getTexts() const
{
    if (std::holds_alternative<std::vector<std::string>>(content_))
        return std::get<std::vector<std::string>>(content_);
    return {};
}

std::ostream& operator<<(std::ostream& out, PropertyValue const& value)
{
    return out << static_cast<std::string>(value);
}

} // namespace IC
