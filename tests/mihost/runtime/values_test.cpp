// The reference runtime's value types.

#include "host/Alert.h"
#include "host/Error.h"
#include "host/PropertyValue.h"
#include "tests/support/TimeZone.h"
#include "util/MyProcess.h"

#include <gtest/gtest.h>

#include <climits>
#include <sstream>
#include <string>
#include <vector>

namespace values_test
{

using IC::EnumValue;
using IC::Error;
using IC::Number;
using IC::PropertyValue;

std::string asText(PropertyValue const& value)
{
    return value;
}

unsigned int asUnsigned(PropertyValue const& value)
{
    return value;
}

PropertyValue date(long seconds)
{
    return {Number(seconds, 0), true};
}

TEST(Number, KnowsItsKindAndItsValue)
{
    Number const number(4294967295U);
    EXPECT_EQ(number.getKind(), Number::UnsignedKind);
    EXPECT_EQ(number.getValue(), 4294967295);

    Number const truth(true);
    EXPECT_EQ(truth.getKind(), Number::BooleanKind);
    EXPECT_EQ(truth.getValue(), 1);
    EXPECT_EQ(Number(false).getValue(), 0);

    Number const time(-86400L, 250);
    EXPECT_EQ(time.getKind(), Number::DateKind);
    EXPECT_EQ(time.getValue(), -86400);
    EXPECT_EQ(time.getSubSeconds(), 250);

    Number const empty(Number::EmptyKind);
    EXPECT_EQ(empty.getKind(), Number::EmptyKind);
    EXPECT_EQ(empty.getValue(), 0);
    EXPECT_EQ(empty.getSubSeconds(), 0);
}

TEST(Number, ReadsAsZeroWhenItHasAKindButNoValue)
{
    Number const number(Number::DateKind);
    EXPECT_EQ(number.getKind(), Number::DateKind);
    EXPECT_EQ(number.getValue(), 0);
}

TEST(Number, IsCopiedWhole)
{
    Number copy(Number::EmptyKind);
    copy = Number(77L, 5);
    Number const again(copy);
    EXPECT_EQ(again.getKind(), Number::DateKind);
    EXPECT_EQ(again.getValue(), 77);
    EXPECT_EQ(again.getSubSeconds(), 5);
}

TEST(EnumValue, TakesWideAndShortNumbers)
{
    EXPECT_EQ(EnumValue(4294967295U).getValue(), 4294967295U);
    EXPECT_EQ(EnumValue(static_cast<unsigned short>(65535)).getValue(), 65535U);
    EnumValue copy(1U);
    copy = EnumValue(35U);
    EXPECT_EQ(copy.getValue(), 35U);
}

TEST(Error, GivesItsStatusAsANumberAndAsAnEnumeration)
{
    Error const success(0, Number(0U), "");
    EXPECT_EQ(success.getStatus(), 0U);
    EXPECT_EQ(static_cast<Error::StatusType>(success), Error::Success);

    Error const failure(1, Number(Number::EmptyKind), "");
    EXPECT_EQ(failure.getStatus(), 1U);
    EXPECT_EQ(static_cast<Error::StatusType>(failure), Error::Failure);

    EXPECT_EQ(static_cast<unsigned int>(static_cast<Error::StatusType>(Error(255, Number(0U), ""))),
              255U);
}

TEST(Error, PrintsItsStatusAndTextAndIsCopiedWhole)
{
    EXPECT_EQ(static_cast<std::string>(Error(0, Number(0U), "")), "status 0");
    EXPECT_EQ(static_cast<std::string>(Error(200, Number(0U), "no room")), "status 200: no room");
    Error copy(0, Number(0U), "");
    copy = Error(3, Number(1U), "reason");
    EXPECT_EQ(static_cast<std::string>(Error(copy)), "status 3: reason");
}

TEST(Alert, CarriesANodeAndAText)
{
    IC::Alert copy(1, "");
    copy = IC::Alert(17, "full");
    EXPECT_EQ(copy.getNodeId(), 17U);
    EXPECT_EQ(IC::Alert(copy).getText(), "full");
}

PropertyValue numbers(std::vector<Number> const& list)
{
    return {list, true};
}

PropertyValue texts(std::vector<std::string> const& list)
{
    return {list, true};
}

struct ValueCase {
    PropertyValue value;
    PropertyValue::KindType kind;
    std::string text;
    unsigned int asUnsigned = 0;
    long long number = 0;
};

std::vector<ValueCase> valueCases()
{
    using Kind = PropertyValue;
    std::string const withNul("a\0b", 3);
    return {{{"jdoe", true}, Kind::TextKind, "jdoe"},
            {{withNul, true}, Kind::TextKind, withNul},
            {{"", true}, Kind::TextKind, ""},
            {{"0009", true}, Kind::TextKind, "0009", 9},
            {{Number(42U), true}, Kind::NumberKind, "42", 42, 42},
            {{Number(4294967295U), true}, Kind::NumberKind, "4294967295", 4294967295U, 4294967295},
            {{Number(true), true}, Kind::BooleanKind, "true", 1, 1},
            {{Number(false), true}, Kind::BooleanKind, "false"},
            {{EnumValue(35U), true}, Kind::EnumerationKind, "35", 35, 35},
            {{Number(Number::EmptyKind), true}, Kind::EmptyKind, ""},
            {{PropertyValue::EmptyKind, true}, Kind::EmptyKind, ""},
            {{PropertyValue::NumbersKind, true}, Kind::NumbersKind, ""},
            {numbers({Number(0U), Number(1U), Number(24U)}), Kind::NumbersKind, "0,1,24"},
            {numbers({Number(9U)}), Kind::NumbersKind, "9"},
            {numbers({Number(true), Number(Number::EmptyKind), Number(2U)}), Kind::NumbersKind,
             "true,,2"},
            {numbers({}), Kind::NumbersKind, ""},
            {texts({"jdoe", "", "a,b"}), Kind::TextsKind, "jdoe,,a,b"},
            {texts({}), Kind::TextsKind, ""}};
}

TEST(PropertyValue, KnowsItsKindItsTextAndItsNumber)
{
    for (auto const& [value, kind, text, asNumber, number] : valueCases()) {
        EXPECT_EQ(value.getKind(), kind) << text;
        EXPECT_EQ(asText(value), text);
        EXPECT_EQ(asUnsigned(value), asNumber) << text;
        EXPECT_EQ(value.getNumber(), number) << text;
        std::ostringstream out;
        out << "[" << value << "]";
        EXPECT_EQ(out.str(), "[" + text + "]");
    }
}

TEST(PropertyValue, SurvivesCopyAndAssignment)
{
    for (ValueCase const& each : valueCases()) {
        PropertyValue copy("before", !each.value.getFlag());
        copy = each.value;
        PropertyValue const again(copy);
        copy = PropertyValue("after", false);
        EXPECT_EQ(again.getKind(), each.kind) << each.text;
        EXPECT_EQ(again.getFlag(), each.value.getFlag()) << each.text;
        EXPECT_EQ(asText(again), each.text);
    }
}

TEST(PropertyValue, BecomesTheNumberOfATextOfDigitsThatFits)
{
    struct Row {
        char const* text;
        unsigned int number;
    };
    for (Row const& row :
         {Row{"9", 9}, Row{"4294967295", 4294967295U}, Row{"4294967296", 0}, Row{"4294967305", 0},
          Row{" 9", 0}, Row{"9 ", 0}, Row{"+9", 0}, Row{"-9", 0}, Row{"0x9", 0}, Row{"9.0", 0}})
        EXPECT_EQ(asUnsigned({row.text, true}), row.number) << row.text;
}

TEST(PropertyValue, KeepsItsFlag)
{
    for (bool const flag : {true, false}) {
        EXPECT_EQ(PropertyValue("", flag).getFlag(), flag);
        EXPECT_EQ(PropertyValue(std::string(), flag).getFlag(), flag);
        EXPECT_EQ(PropertyValue(Number(1U), flag).getFlag(), flag);
        EXPECT_EQ(PropertyValue(EnumValue(1U), flag).getFlag(), flag);
        EXPECT_EQ(PropertyValue(std::vector<Number>(), flag).getFlag(), flag);
        EXPECT_EQ(PropertyValue(std::vector<std::string>(), flag).getFlag(), flag);
        EXPECT_EQ(PropertyValue(PropertyValue::EmptyKind, flag).getFlag(), flag);
    }
}

TEST(PropertyValue, BecomesANumberOfADatesSecondsIfTheyFit)
{
    EXPECT_EQ(asUnsigned(date(86400)), 86400U);
    EXPECT_EQ(date(86400).getKind(), PropertyValue::DateKind);
    EXPECT_EQ(date(-86400).getNumber(), -86400);
    EXPECT_EQ(asUnsigned(date(-86400)), 0U);
    // One that does not fit must not turn into a command, such as 9, by wrapping.
    if constexpr (sizeof(long) > 4) {
        EXPECT_EQ(asUnsigned(date(0xFFFFFFFF)), 0xFFFFFFFFU);
        EXPECT_EQ(asUnsigned(date(0x100000009)), 0U);
    }
}

TEST(PropertyValue, YieldsTheListsItHoldsAndEmptyOthers)
{
    std::vector<Number> const list = numbers({Number(0U), Number(24U)}).getNumbers();
    ASSERT_EQ(list.size(), 2U);
    EXPECT_EQ(list[1].getValue(), 24);
    EXPECT_EQ(texts({"a", "b"}).getTexts(), (std::vector<std::string>{"a", "b"}));
    EXPECT_TRUE(texts({"a"}).getNumbers().empty());
    EXPECT_TRUE(numbers({Number(1U)}).getTexts().empty());
    EXPECT_TRUE(PropertyValue("a", true).getTexts().empty());
}

TEST(PropertyValue, GivesADateInLocalTime)
{
    useZone("UTC0");
    EXPECT_EQ(asText(date(1273659825)), "2010-05-12 10:23:45");
    EXPECT_EQ(asText(date(0)), "1970-01-01 00:00:00");
    EXPECT_EQ(asText(date(-1)), "1969-12-31 23:59:59");
    useZone("CET-1CEST,M3.5.0,M10.5.0/3");
    EXPECT_EQ(asText(date(1273659825)), "2010-05-12 12:23:45");
    EXPECT_EQ(asText(date(1263291825)), "2010-01-12 11:23:45");
}

TEST(PropertyValue, WritesADateInTheFormThatIsScannedForADay)
{
    useZone("CET-1CEST,M3.5.0,M10.5.0/3");
    for (int month = 1; month <= 12; ++month) {
        time_t const midnight = NQ::ito_time_t(2026, month, 28, 0, 0, 0, 0, -1);
        int year = 0, readMonth = 0, day = 0;
        std::string const text = asText(date(midnight));
        EXPECT_EQ(std::sscanf(text.c_str(), "%4d-%2d-%2d 00:00:00", &year, &readMonth, &day), 3);
        EXPECT_EQ(text.substr(10), " 00:00:00");
        EXPECT_EQ(year, 2026);
        EXPECT_EQ(readMonth, month);
        EXPECT_EQ(day, 28);
    }
}

TEST(PropertyValue, GivesADateBeyondTheCalendarAsItsSeconds)
{
    useZone("UTC0");
    EXPECT_EQ(asText(date(LONG_MAX)),
              sizeof(long) == 4 ? "2038-01-19 03:14:07" : std::to_string(LONG_MAX));
}

TEST(PropertyValue, JoinsDatesLikeOtherNumbers)
{
    useZone("UTC0");
    EXPECT_EQ(asText(numbers({Number(0L, 0), Number(7U)})), "1970-01-01 00:00:00,7");
}

} // namespace values_test
