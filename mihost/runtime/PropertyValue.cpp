#include "host/PropertyValue.h"

#include <charconv>
#include <climits>
#include <ctime>
#include <ostream>

namespace IC
{

namespace
{

PropertyValue::KindType kindOf(Number const& number)
{
    switch (number.getKind()) {
    case Number::UnsignedKind:
        return PropertyValue::NumberKind;
    case Number::BooleanKind:
        return PropertyValue::BooleanKind;
    case Number::DateKind:
        return PropertyValue::DateKind;
    case Number::EmptyKind:
        break;
    }
    return PropertyValue::EmptyKind;
}

std::string localDate(long long seconds)
{
    auto const time = static_cast<std::time_t>(seconds);
    std::tm fields{};
    char text[64];
    if (!localtime_r(&time, &fields) ||
        std::strftime(text, sizeof text, "%Y-%m-%d %H:%M:%S", &fields) == 0)
        return std::to_string(seconds);
    return text;
}

std::string toText(Number const& number)
{
    switch (number.getKind()) {
    case Number::UnsignedKind:
        return std::to_string(number.getValue());
    case Number::BooleanKind:
        return number.getValue() != 0 ? "true" : "false";
    case Number::DateKind:
        return localDate(number.getValue());
    case Number::EmptyKind:
        break;
    }
    return "";
}

std::string toText(std::string const& text)
{
    return text;
}

std::string toText(EnumValue const& value)
{
    return std::to_string(value.getValue());
}

std::string toText(std::monostate)
{
    return "";
}

template <class Element> std::string toText(std::vector<Element> const& list)
{
    std::string joined;
    for (Element const& element : list) {
        if (&element != &list.front())
            joined += ',';
        joined += toText(element);
    }
    return joined;
}

unsigned int decimal(std::string const& text)
{
    unsigned int number = 0;
    char const* const end = text.data() + text.size();
    auto const [stop, problem] = std::from_chars(text.data(), end, number);
    return problem == std::errc() && stop == end ? number : 0;
}

} // namespace

PropertyValue::PropertyValue(std::string const& text, bool const& flag)
    : kind_(TextKind), flag_(flag), content_(text)
{
}

PropertyValue::PropertyValue(char const* text, bool const& flag)
    : kind_(TextKind), flag_(flag), content_(std::string(text))
{
}

PropertyValue::PropertyValue(Number const& number, bool const& flag)
    : kind_(kindOf(number)), flag_(flag), content_(number)
{
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

PropertyValue::operator std::string() const
{
    return std::visit([](auto const& content) { return toText(content); }, content_);
}

PropertyValue::operator unsigned int() const
{
    if (auto const* text = std::get_if<std::string>(&content_))
        return decimal(*text);
    long long const number = getNumber();
    return number >= 0 && number <= UINT_MAX ? static_cast<unsigned int>(number) : 0;
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
    if (auto const* number = std::get_if<Number>(&content_))
        return number->getValue();
    if (auto const* value = std::get_if<EnumValue>(&content_))
        return value->getValue();
    return 0;
}

std::vector<Number> PropertyValue::getNumbers() const
{
    auto const* numbers = std::get_if<std::vector<Number>>(&content_);
    return numbers ? *numbers : std::vector<Number>();
}

std::vector<std::string> PropertyValue::getTexts() const
{
    auto const* texts = std::get_if<std::vector<std::string>>(&content_);
    return texts ? *texts : std::vector<std::string>();
}

std::ostream& operator<<(std::ostream& out, PropertyValue const& value)
{
    return out << static_cast<std::string>(value);
}

} // namespace IC
