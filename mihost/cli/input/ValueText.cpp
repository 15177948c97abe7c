#include "mihost/cli/input/ValueText.h"

#include "mihost/cli/input/Day.h"
#include "mihost/cli/input/Decimal.h"
#include "mihost/cli/input/InputValidation.h"
#include "mihost/cli/input/MethodCall.h"
#include "mihost/cli/system/Failure.h"

#include <fmt/format.h>
#include <optional>
#include <vector>

namespace mihost
{

namespace
{

using IC::Number;
using IC::PropertyValue;

constexpr bool flag = true;

Failure wrongForm(Property const& property, std::string const& right)
{
    return {BadUsage, fmt::format("{} is a {}: write {}", property.name,
                                  valueKindName(property.kind), right)};
}

unsigned int numberFrom(Property const& property, std::string_view text)
{
    auto const number = parseDecimal(text);
    if (!number)
        throw wrongForm(property, "decimal digits, at most 4294967295");
    return *number;
}

std::vector<std::string> listFrom(std::string const& text)
{
    std::vector<std::string> items;
    std::size_t start = 0;
    while (!text.empty()) {
        std::size_t const comma = text.find(',', start);
        items.push_back(text.substr(start, comma - start));
        if (comma == std::string::npos)
            break;
        start = comma + 1;
    }
    return items;
}

void checkText(Property const& property, std::string const& text)
{
    std::optional<std::string> reason;
    if (property.form == Form::MethodCall) {
        if (!callsNothing(text))
            takeApart(text);
    } else if (property.form == Form::Hash) {
        reason = objectionToHash(text);
    } else if (property.form != Form::Free) {
        reason = objection(property.form, text);
    }
    if (reason)
        throw Failure(BadUsage, fmt::format("{}: {}", property.name, *reason));
}

bool truthFrom(Property const& property, std::string const& text)
{
    for (char const* yes : {"true", "yes", "1"})
        if (text == yes)
            return true;
    for (char const* no : {"false", "no", "0"})
        if (text == no)
            return false;
    throw wrongForm(property, "true or false");
}

} // namespace

PropertyValue parseValue(Property const& property, std::string const& text)
{
    switch (property.kind) {
    case PropertyValue::TextKind:
        checkText(property, text);
        break;
    case PropertyValue::NumberKind:
        return {Number(numberFrom(property, text)), flag};
    case PropertyValue::BooleanKind:
        return {Number(truthFrom(property, text)), flag};
    case PropertyValue::DateKind:
        if (auto const time = parseTime(text))
            return {Number(*time, 0), flag};
        throw wrongForm(property, timeForm);
    case PropertyValue::EnumerationKind:
        return {IC::EnumValue(numberFrom(property, text)), flag};
    case PropertyValue::NumbersKind: {
        std::vector<Number> numbers;
        for (std::string const& item : listFrom(text))
            numbers.emplace_back(numberFrom(property, item));
        return {numbers, flag};
    }
    case PropertyValue::TextsKind:
        return {listFrom(text), flag};
    case PropertyValue::EmptyKind:
        break;
    }
    return {text, flag};
}

} // namespace mihost
