// Property values: every constructor, what it reads as, and the two conversions.

#include "host/PropertyValue.h"
#include "mihost/hostcheck/Check.h"

#include <climits>
#include <ctime>
#include <sstream>

namespace hostcheck
{

namespace
{

using IC::EnumValue;
using IC::Number;
using IC::PropertyValue;

constexpr long someTime = 1000000000;

PropertyValue textValue(std::string const& content)
{
    return {content, true};
}

PropertyValue date(long seconds)
{
    return {Number(seconds, 0), true};
}

std::string asText(PropertyValue const& value)
{
    return value;
}

unsigned int asNumber(PropertyValue const& value)
{
    return value;
}

/** Made with either flag by this constructor. */
template <class Content> std::string makes(Content const& content, PropertyValue::KindType kind)
{
    PropertyValue const flagged(content, true);
    PropertyValue const plain(content, false);
    return firstOf({equal("getKind", flagged.getKind(), kind),
                    equal("getFlag after true", flagged.getFlag(), 1),
                    equal("getFlag after false", plain.getFlag(), 0)});
}

std::string fromString()
{
    return makes(std::string("text"), PropertyValue::TextKind);
}

std::string fromLiteral()
{
    char const* const literal = "text";
    return firstOf({makes(literal, PropertyValue::TextKind),
                    equal("the text form", asText(PropertyValue(literal, true)), "text")});
}

std::string fromNumber()
{
    return firstOf({makes(Number(5U), PropertyValue::NumberKind),
                    makes(Number(true), PropertyValue::BooleanKind),
                    makes(Number(someTime, 0), PropertyValue::DateKind),
                    makes(Number(Number::EmptyKind), PropertyValue::EmptyKind)});
}

std::string fromEnumValue()
{
    return makes(EnumValue(5U), PropertyValue::EnumerationKind);
}

std::string fromNumbers()
{
    return makes(std::vector<Number>{Number(5U)}, PropertyValue::NumbersKind);
}

std::string fromTexts()
{
    return makes(std::vector<std::string>{"text"}, PropertyValue::TextsKind);
}

std::string fromKind()
{
    for (auto const kind :
         {PropertyValue::EmptyKind, PropertyValue::TextKind, PropertyValue::NumberKind,
          PropertyValue::BooleanKind, PropertyValue::DateKind, PropertyValue::EnumerationKind,
          PropertyValue::NumbersKind, PropertyValue::TextsKind}) {
        PropertyValue const value(kind, true);
        std::string problem = firstOf({makes(kind, kind), equal("the text form", asText(value), ""),
                                       equal("the unsigned form", asNumber(value), 0),
                                       equal("getNumber", value.getNumber(), 0)});
        if (!problem.empty())
            return "of kind " + std::to_string(kind) + ", " + problem;
    }
    return "";
}

std::string textOfTexts()
{
    for (std::string const& content : oddTexts())
        if (std::string problem =
                equal("the text form of a text", asText(textValue(content)), content);
            !problem.empty())
            return problem;
    return "";
}

std::string textOfNumbers()
{
    return firstOf(
        {equal("the text form of a number", asText({Number(UINT_MAX), true}), "4294967295"),
         equal("the text form of true", asText({Number(true), true}), "true"),
         equal("the text form of false", asText({Number(false), true}), "false"),
         equal("the text form of an enumeration", asText({EnumValue(12U), true}), "12")});
}

std::string textOfDates()
{
    for (std::time_t const seconds : {std::time_t{0}, std::time_t{-1}, std::time_t{someTime}}) {
        std::tm fields{};
        char expected[64] = "";
        if (localtime_r(&seconds, &fields))
            std::strftime(expected, sizeof expected, "%Y-%m-%d %H:%M:%S", &fields);
        std::string problem = equal("the text form of a date", asText(date(seconds)), expected);
        if (!problem.empty())
            return problem;
    }
    return "";
}

std::string textOfLists()
{
    std::vector<Number> const numbers = {Number(1U), Number(true), Number(UINT_MAX)};
    std::vector<std::string> const texts = {"a", "", "b"};
    return firstOf(
        {equal("the text form of numbers", asText({numbers, true}), "1,true,4294967295"),
         equal("the text form of texts", asText({texts, true}), "a,,b"),
         equal("the text form of no numbers", asText({std::vector<Number>(), true}), ""),
         equal("the text form of no texts", asText({std::vector<std::string>(), true}), "")});
}

std::string numberOfNumbers()
{
    return firstOf(
        {equal("the unsigned form of 0", asNumber({Number(0U), true}), 0),
         equal("the unsigned form of 4294967295", asNumber({Number(UINT_MAX), true}), UINT_MAX),
         equal("the unsigned form of enumeration value 12", asNumber({EnumValue(12U), true}), 12),
         equal("the unsigned form of a time before 1970", asNumber(date(-1)), 0)});
}

std::string numberOfTexts()
{
    struct Row {
        char const* text;
        unsigned int number;
    };
    for (Row const& row : {Row{"12", 12}, Row{"4294967295", UINT_MAX}, Row{"010", 10}, Row{"", 0},
                           Row{"12x", 0}, Row{" 12", 0}, Row{"-1", 0}, Row{"0x10", 0},
                           Row{"4294967296", 0}, Row{"18446744073709551621", 0}}) {
        std::string const what = std::string("the unsigned form of text '") + row.text + "'";
        std::string problem = equal(what.c_str(), asNumber(textValue(row.text)), row.number);
        if (!problem.empty())
            return problem;
    }
    return "";
}

std::string numberOfLists()
{
    return firstOf(
        {equal("the unsigned form of numbers", asNumber({std::vector<Number>{Number(5U)}, true}),
               0),
         equal("the unsigned form of texts", asNumber({std::vector<std::string>{"5"}, true}), 0)});
}

std::string getNumber()
{
    return firstOf(
        {equal("getNumber of a number", PropertyValue(Number(UINT_MAX), true).getNumber(),
               UINT_MAX),
         equal("getNumber of true", PropertyValue(Number(true), true).getNumber(), 1),
         equal("getNumber of a date", date(-someTime).getNumber(), -someTime),
         equal("getNumber of an enumeration", PropertyValue(EnumValue(5U), true).getNumber(), 5),
         equal("getNumber of a text", textValue("5").getNumber(), 0)});
}

std::string getNumbers()
{
    std::vector<Number> const list = {Number(1U), Number(-2L, 3)};
    std::vector<Number> const back = PropertyValue(list, true).getNumbers();
    if (back.size() != list.size())
        return equal("the length of the list", static_cast<long long>(back.size()), 2);
    return firstOf({equal("the first", back[0].getValue(), 1),
                    equal("the second", back[1].getValue(), -2),
                    equal("the second's kind", back[1].getKind(), Number::DateKind),
                    holds(textValue("5").getNumbers().empty(), "a text has numbers")});
}

std::string getTexts()
{
    std::vector<std::string> const& list = oddTexts();
    return firstOf({holds(PropertyValue(list, true).getTexts() == list, "the texts are others"),
                    holds(textValue("5").getTexts().empty(), "a single text has a list")});
}

std::string isA(PropertyValue const& value, PropertyValue::KindType kind, std::string const& form)
{
    return firstOf({equal("getKind of the copy", value.getKind(), kind),
                    equal("getFlag of the copy", value.getFlag(), 0),
                    equal("the text form of the copy", asText(value), form)});
}

std::string copies()
{
    PropertyValue original(std::vector<std::string>{"a", "b"}, false);
    PropertyValue const copy(original);
    original = textValue("other");
    return isA(copy, PropertyValue::TextsKind, "a,b");
}

std::string assigns()
{
    PropertyValue assigned = textValue("earlier");
    PropertyValue original(Number(5U), false);
    PropertyValue& result = assigned = original;
    PropertyValue const& itself = assigned;
    assigned = itself;
    original = textValue("other");
    return firstOf({isA(assigned, PropertyValue::NumberKind, "5"),
                    holds(&result == &assigned, "the result is another object")});
}

std::string writes()
{
    std::ostringstream out;
    out << text("100% ") << PropertyValue(Number(5U), true) << '.';
    return equal("what the stream holds", out.str(), "100% 5.");
}

} // namespace

Checks propertyValueChecks()
{
    constexpr char const* makes = "has its kind and keeps the flag";
    constexpr char const* textForm = "IC::PropertyValue::operator std::string";
    constexpr char const* unsignedForm = "IC::PropertyValue::operator unsigned int";
    return {
        {"IC::PropertyValue::PropertyValue(std::string const&, bool const&)", makes, fromString},
        {"IC::PropertyValue::PropertyValue(char const*, bool const&)", makes, fromLiteral},
        {"IC::PropertyValue::PropertyValue(Number const&, bool const&)", makes, fromNumber},
        {"IC::PropertyValue::PropertyValue(EnumValue const&, bool const&)", makes, fromEnumValue},
        {"IC::PropertyValue::PropertyValue(std::vector<Number> const&, bool const&)", makes,
         fromNumbers},
        {"IC::PropertyValue::PropertyValue(std::vector<std::string> const&, bool const&)", makes,
         fromTexts},
        {"IC::PropertyValue::PropertyValue(KindType const&, bool const&)",
         "makes an empty value of that kind", fromKind},
        {textForm, "returns a text, every byte of it", textOfTexts},
        {textForm, "writes numbers in decimal and truth values as words", textOfNumbers},
        {textForm, "writes dates as local time", textOfDates},
        {textForm, "joins lists by commas", textOfLists},
        {unsignedForm, "returns a number", numberOfNumbers},
        {unsignedForm, "reads a wholly decimal text", numberOfTexts},
        {unsignedForm, "is 0 for lists", numberOfLists},
        {"IC::PropertyValue::getNumber", "returns what a single value holds", getNumber},
        {"IC::PropertyValue::getNumbers", "returns the list", getNumbers},
        {"IC::PropertyValue::getTexts", "returns the list", getTexts},
        {"IC::PropertyValue::PropertyValue(PropertyValue const&)", "copies", copies},
        {"IC::PropertyValue::operator=", "copies", assigns},
        {"IC::operator<<(std::ostream&, PropertyValue const&)", "writes the text form", writes},
    };
}

} // namespace hostcheck
