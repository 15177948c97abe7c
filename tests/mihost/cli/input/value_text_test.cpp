#include "mihost/cli/input/ValueText.h"
#include "tests/mihost/cli/Refusal.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

namespace value_text_test
{

using IC::PropertyValue;

mihost::Property const& property(unsigned int nodeType, unsigned int id)
{
    return *mihost::findProperty(*mihost::findKind(nodeType), id);
}

constexpr unsigned int os = 17;
constexpr unsigned int user = 46;
constexpr unsigned int group = 51;

PropertyValue parsed(unsigned int nodeType, unsigned int id, std::string const& text)
{
    return mihost::parseValue(property(nodeType, id), text);
}

std::string refusal(unsigned int nodeType, unsigned int id, std::string const& text)
{
    return ::refusal([&] { parsed(nodeType, id, text); });
}

TEST(ValueText, BecomesAValueOfThePropertysKind)
{
    EXPECT_EQ(parsed(os, 108, "Linux").getKind(), PropertyValue::TextKind);
    EXPECT_EQ(parsed(os, 75, "0").getKind(), PropertyValue::NumberKind);
    EXPECT_EQ(parsed(os, 123, "9").getKind(), PropertyValue::EnumerationKind);
    EXPECT_EQ(parsed(user, 138, "true").getKind(), PropertyValue::BooleanKind);
    EXPECT_EQ(parsed(user, 118, "2030-01-01").getKind(), PropertyValue::DateKind);
    EXPECT_EQ(parsed(os, 125, "0,1,24").getKind(), PropertyValue::NumbersKind);
    EXPECT_EQ(parsed(group, 165, "anna,ben").getKind(), PropertyValue::TextsKind);
    EXPECT_TRUE(parsed(os, 75, "0").getFlag());
}

TEST(ValueText, ReadsBackFromTheValue)
{
    EXPECT_EQ(static_cast<std::string>(parsed(os, 125, "0,1,24")), "0,1,24");
    EXPECT_EQ(static_cast<std::string>(parsed(group, 165, "anna,ben")), "anna,ben");
    EXPECT_EQ(static_cast<std::string>(parsed(group, 165, "")), "");
    EXPECT_EQ(static_cast<std::string>(parsed(os, 75, "4294967295")), "4294967295");
}

TEST(ValueText, OfADayIsItsLocalMidnight)
{
    useZone("Europe/Berlin");
    EXPECT_EQ(static_cast<std::string>(parsed(user, 118, "2030-07-01")), "2030-07-01 00:00:00");
    EXPECT_EQ(static_cast<std::string>(parsed(user, 91, "2030-07-01 12:30:00")),
              "2030-07-01 12:30:00");
    EXPECT_EQ(parsed(user, 118, "2030-07-01").getNumber(), 1909087200);
}

TEST(ValueText, OfADateIsRefusedWithTheRightForm)
{
    for (char const* wrong : {"tomorrow", "2030-02-30", "1.7.2030", "2030-07-01 24:00:00", "",
                              "2030-07-01T12:30:00", "2030-07-01 12:30"})
        EXPECT_EQ(refusal(user, 118, wrong),
                  "inactive-time is a date: write YYYY-MM-DD or \"YYYY-MM-DD HH:MM:SS\", in local "
                  "time")
            << wrong;
}

TEST(ValueText, OfANumberIsRefusedIfItIsNotOneOrTooLarge)
{
    for (char const* wrong : {"", "-1", "x", "4294967296", "1.0", " 1"})
        EXPECT_EQ(refusal(os, 75, wrong),
                  "refresh is a number: write decimal digits, at most 4294967295")
            << wrong;
    EXPECT_NE(refusal(os, 123, "restart"), "accepted");
    EXPECT_NE(refusal(os, 125, "0,,1"), "accepted");
}

TEST(ValueText, OfATruthValueIsAFewWords)
{
    for (char const* yes : {"true", "yes", "1"})
        EXPECT_EQ(parsed(user, 138, yes).getNumber(), 1) << yes;
    for (char const* no : {"false", "no", "0"})
        EXPECT_EQ(parsed(user, 138, no).getNumber(), 0) << no;
    EXPECT_EQ(refusal(user, 138, "2"), "delete is a boolean: write true or false");
}

TEST(ValueText, OfAnAccountsNameIsRefusedIfUnsafeInAShell)
{
    EXPECT_EQ(refusal(user, 108, "a;reboot"), "user-name: contains the shell metacharacter ';'");
    EXPECT_NE(refusal(user, 89, "0 -f"), "accepted");
    EXPECT_EQ(refusal(user, 108, "jdoe"), "accepted");
}

TEST(ValueText, OfAPasswordIsAHash)
{
    EXPECT_EQ(static_cast<std::string>(parsed(user, 117, "$6$salt$hash")), "$6$salt$hash");
    EXPECT_NE(refusal(user, 117, "geheim"), "accepted");
    EXPECT_EQ(refusal(user, 117, "geheim").find("geheim"), std::string::npos);
}

TEST(ValueText, OfAMethodCallIsParsed)
{
    EXPECT_EQ(refusal(os, 74, "UserDel,UserName:CMPI_string:jdoe"), "accepted");
    EXPECT_EQ(refusal(os, 74, "UserDel,UserName:CMPI_string:a;b"),
              "UserName contains the shell metacharacter ';'");
    EXPECT_EQ(refusal(os, 74, ""), "accepted");
    EXPECT_EQ(refusal(os, 74, "dummy"), "accepted");
}

} // namespace value_text_test
