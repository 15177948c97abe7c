// The runtime's text functions, with which mihost prints; its JSON parser checks some of them.

#include "mihost/runtime/Text.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

namespace text_test
{

using mihost::jsonString;
using mihost::printable;
using mihost::validUtf8;

TEST(Printable, KeepsOrdinaryTextInAnyScript)
{
    EXPECT_EQ(printable("Jürgen 李 ~ \\ \""), "Jürgen 李 ~ \\ \"");
}

TEST(Printable, WritesControlAndInvisibleCharactersAsEscapes)
{
    EXPECT_EQ(printable("a\nb\tc\rd\x1b[31me\x7f"), "a\\nb\\tc\\rd\\x1b[31me\\x7f");
    EXPECT_EQ(printable(std::string("\0", 1)), "\\x00");
    EXPECT_EQ(printable("\xC2\x9B" // the one-character form of ESC [
                        "31m"),
              "\\u009b31m");
    EXPECT_EQ(printable("a\u202Eb\u2066c\u2028d\u200Ee"), "a\\u202eb\\u2066c\\u2028d\\u200ee");
    EXPECT_EQ(printable("\U000E0041"), "\\U000e0041");
    EXPECT_EQ(printable("r\u00ADo\u200Bo\uFEFFt"), "r\\u00ado\\u200bo\\ufefft");
}

TEST(Printable, WritesEachByteThatIsNotUtf8InHex)
{
    EXPECT_EQ(printable("J\xFCrgen\xFF"), "J\\xfcrgen\\xff");
}

TEST(ValidUtf8, KeepsControlCharacters)
{
    EXPECT_EQ(validUtf8("a\n\x1b"), "a\n\x1b");
}

TEST(ValidUtf8, RefusesOverlongOrIncompleteFormsAndSurrogates)
{
    EXPECT_EQ(validUtf8("\xC0\xAF"), "\\xc0\\xaf");
    EXPECT_EQ(validUtf8("\xE0\x80\xAF"), "\\xe0\\x80\\xaf");
    EXPECT_EQ(validUtf8("\xED\xA0\x80"), "\\xed\\xa0\\x80");
    EXPECT_EQ(validUtf8("\xF4\x90\x80\x80"), "\\xf4\\x90\\x80\\x80");
    EXPECT_EQ(validUtf8("\xF4\x8F\xBF\xBF"), "\xF4\x8F\xBF\xBF");
    EXPECT_EQ(validUtf8("\xE6\x9D"), "\\xe6\\x9d");
    EXPECT_EQ(validUtf8("\xE6\x9Dx"), "\\xe6\\x9dx");
}

TEST(JsonString, ReadsBackAsTheTextForAnyBytes)
{
    std::string all;
    for (int byte = 0; byte < 256; ++byte)
        all += static_cast<char>(byte);
    EXPECT_EQ(nlohmann::json::parse(jsonString(all)).get<std::string>(), validUtf8(all));
}

TEST(JsonString, EscapesBetweenPlainTextsAndAtBothEnds)
{
    EXPECT_EQ(jsonString(""), "\"\"");
    EXPECT_EQ(jsonString("plain ~"), "\"plain ~\"");
    EXPECT_EQ(jsonString("\"a\\b\nc\x1f"), "\"\\\"a\\\\b\\u000ac\\u001f\"");
    EXPECT_EQ(jsonString("\x7f\xC3\xA4\xFFz"), "\"\x7f\xC3\xA4\\\\xffz\"");
}

TEST(JsonString, IsAppendedToTheText)
{
    std::string text = "\"key\":";
    mihost::appendJsonString(text, "a\tb");
    EXPECT_EQ(text, "\"key\":\"a\\u0009b\"");
}

} // namespace text_test
