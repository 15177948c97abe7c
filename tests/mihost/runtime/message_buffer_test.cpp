// The reference runtime's text conversion and message builder.

#include "host/VXMessageBuffer.h"
#include "host/make_string.h"

#include <gtest/gtest.h>

#include <climits>
#include <locale>
#include <random>
#include <string>

namespace message_buffer_test
{

using NQ::make_string;
using NQ::make_wstring;

std::string thereAndBack(std::string const& text)
{
    return make_string(make_wstring(text));
}

/** @return the UTF-8 of the code point, after its definition */
std::string utf8(char32_t code)
{
    auto const byte = [](char32_t bits) { return static_cast<char>(bits); };
    if (code < 0x80)
        return {byte(code)};
    if (code < 0x800)
        return {byte(0xC0 + code / 0x40), byte(0x80 + code % 0x40)};
    if (code < 0x10000)
        return {byte(0xE0 + code / 0x1000), byte(0x80 + code / 0x40 % 0x40),
                byte(0x80 + code % 0x40)};
    return {byte(0xF0 + code / 0x40000), byte(0x80 + code / 0x1000 % 0x40),
            byte(0x80 + code / 0x40 % 0x40), byte(0x80 + code % 0x40)};
}

bool isSurrogate(char32_t code)
{
    return code >= 0xD800 && code <= 0xDFFF;
}

TEST(MakeString, CopiesANarrowTextAndReadsNullAsEmpty)
{
    EXPECT_EQ(make_string("text"), "text");
    EXPECT_EQ(make_string(""), "");
    EXPECT_EQ(make_string(static_cast<char const*>(nullptr)), "");
}

TEST(MakeWstring, DecodesUtf8AndContinuesAfterOtherBytes)
{
    EXPECT_EQ(make_wstring("jdoe"), L"jdoe");
    EXPECT_EQ(make_wstring("J\xC3\xB6rg \xE2\x82\xAC \xF0\x9F\x98\x80"),
              L"J\u00F6rg \u20AC \U0001F600");
    EXPECT_EQ(make_wstring(""), L"");
    EXPECT_EQ(make_wstring("\xC3(\xC3\xB6"), (std::wstring{0xDCC3, L'(', 0xF6}));
}

TEST(MakeWstring, DecodesAndEncodesEveryCodePoint)
{
    std::string narrow;
    std::wstring wide;
    for (char32_t code = 0; code <= 0x10FFFF; ++code) {
        if (isSurrogate(code))
            continue;
        narrow += utf8(code);
        wide.push_back(static_cast<wchar_t>(code));
    }
    EXPECT_TRUE(make_wstring(narrow) == wide);
    EXPECT_TRUE(make_string(wide) == narrow);
}

TEST(MakeWstring, KeepsEveryByteThereAndBack)
{
    for (int first = 0; first <= 0xFF; ++first) {
        std::string const one(1, static_cast<char>(first));
        EXPECT_EQ(thereAndBack(one), one) << first;
        for (int second = 0; second <= 0xFF; ++second) {
            std::string const two = one + static_cast<char>(second);
            ASSERT_EQ(thereAndBack(two), two) << first << ' ' << second;
        }
    }
}

TEST(MakeWstring, KeepsAnyBytesThereAndBack)
{
    std::mt19937 random(20100512);
    // Mostly bytes that begin or continue a sequence, so that incomplete sequences occur.
    std::string const alphabet = "a\x80\xBF\xC2\xDF\xE0\xED\xEF\xF0\xF4\xF8\xFF";
    for (int round = 0; round < 20000; ++round) {
        std::string text(random() % 24, ' ');
        for (char& byte : text)
            byte = random() % 2 != 0 ? alphabet[random() % alphabet.size()]
                                     : static_cast<char>(random() % 256);
        ASSERT_EQ(thereAndBack(text), text);
    }
}

TEST(MakeWstring, DecodesBytesThatAreNotUtf8OneByOne)
{
    struct {
        char const* what;
        std::string bytes;
    } const cases[] = {{"lone continuation", "\x80"},
                       {"overlong NUL", "\xC0\x80"},
                       {"overlong in two", "\xC1\xBF"},
                       {"overlong in three", "\xE0\x9F\xBF"},
                       {"overlong in four", "\xF0\x8F\xBF\xBF"},
                       {"first surrogate", "\xED\xA0\x80"},
                       {"last surrogate", "\xED\xBF\xBF"},
                       {"beyond the last code point", "\xF4\x90\x80\x80"},
                       {"five byte form", "\xF8\x88\x80\x80\x80"},
                       {"cut off in two", "\xC3"},
                       {"cut off in three", "\xE2\x82"},
                       {"cut off in four", "\xF0\x9F\x98"}};
    for (auto const& test : cases) {
        std::wstring const wide = make_wstring(test.bytes);
        ASSERT_EQ(wide.size(), test.bytes.size()) << test.what;
        for (std::size_t i = 0; i < wide.size(); ++i)
            EXPECT_EQ(static_cast<unsigned int>(wide[i]),
                      0xDC00U + static_cast<unsigned char>(test.bytes[i]))
                << test.what;
    }
}

using VXLog::VXMessageBuffer;

TEST(MessageBuffer, IsEmptyAtFirst)
{
    VXMessageBuffer buffer;
    EXPECT_EQ(buffer.str(buffer), "");
}

TEST(MessageBuffer, JoinsTextsOfEveryKind)
{
    VXMessageBuffer buffer;
    char writable[] = "c";
    EXPECT_EQ(buffer.str(buffer << "a" << std::string("b\0b", 3) << writable),
              std::string("ab\0bc", 5));
}

TEST(MessageBuffer, WritesNumbersInDecimal)
{
    VXMessageBuffer buffer;
    EXPECT_EQ(buffer.str(buffer << INT_MIN), "-2147483648");
    VXMessageBuffer other;
    EXPECT_EQ(other.str(other << UINT_MAX), "4294967295");
}

TEST(MessageBuffer, AcceptsAfterANumberAllThatAStreamAccepts)
{
    VXMessageBuffer buffer;
    EXPECT_EQ(buffer.str(buffer << "YY = " << 1900 << ", " << 7U << std::string(" end") << 'x'),
              "YY = 1900, 7 endx");
}

TEST(MessageBuffer, AcceptsTextsAfterAStreamWasUsed)
{
    VXMessageBuffer buffer;
    buffer << "a" << 1 << "b";
    EXPECT_EQ(buffer.str(buffer << "c" << 2), "a1bc2");
}

TEST(MessageBuffer, WritesPlainDigitsInAnyLocale)
{
    struct Grouped : std::numpunct<char> {
        std::string do_grouping() const override
        {
            return "\3";
        }
    };
    std::locale const before =
        std::locale::global(std::locale(std::locale::classic(), new Grouped));
    VXMessageBuffer buffer;
    std::string const text = buffer.str(buffer << 1234567);
    std::locale::global(before);
    EXPECT_EQ(text, "1234567");
}

} // namespace message_buffer_test
