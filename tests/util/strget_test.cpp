#include "util/MyProcess.h"

#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <string>

namespace strget_test
{

/** The value part of a line, and the line's bytes afterwards. */
struct Value {
    Value(std::string line, char c) : bytes(std::move(line))
    {
        char* const start = bytes.data();
        char* const value = NQ::strget(start, c);
        text = value;
        offset = value - start;
    }

    std::string bytes;
    std::string text;
    std::ptrdiff_t offset;
};

TEST(Strget, SkipsLeadingBlanksAndCutsTheLineEnd)
{
    Value const value("   1.2.3\n", ' ');
    EXPECT_EQ(value.text, "1.2.3");
    EXPECT_EQ(value.offset, 3);
    EXPECT_EQ(value.bytes, std::string("   1.2.3\0", 9));
}

TEST(Strget, OverwritesEveryNewlineAndNotOnlyTheFirst)
{
    Value const value("abc\ndef\n", 'x');
    EXPECT_EQ(value.text, "abc");
    EXPECT_EQ(value.offset, 0);
    EXPECT_EQ(value.bytes, std::string("abc\0def\0", 8));
}

TEST(Strget, YieldsNothingForABlankLine)
{
    Value const value(" \n", ' ');
    EXPECT_EQ(value.text, "");
    EXPECT_EQ(value.offset, 1);
}

TEST(Strget, YieldsAnEmptyTextForAnEmptyText)
{
    Value const value("", ' ');
    EXPECT_EQ(value.text, "");
    EXPECT_EQ(value.offset, 0);
}

TEST(Strget, StopsAtTheEndOfALineOfOnlyTheCharacter)
{
    Value const value("    ", ' ');
    EXPECT_EQ(value.text, "");
    EXPECT_EQ(value.offset, 4);
}

TEST(Strget, SkipsOnlyTheGivenCharacter)
{
    EXPECT_EQ(Value("\t 5.0\n", ' ').text, "\t 5.0");
    EXPECT_EQ(Value("::a:b\n", ':').text, "a:b");
}

TEST(Strget, KeepsTrailingBlanksAndCarriageReturns)
{
    EXPECT_EQ(Value(" value  \r\n", ' ').text, "value  \r");
}

TEST(Strget, KeepsNewlinesAmongTheSkippedCharacters)
{
    Value const value("\n\nvalue\n", '\n');
    EXPECT_EQ(value.text, "value");
    EXPECT_EQ(value.bytes, std::string("\n\nvalue\0", 8));
}

TEST(Strget, LogsItsEntryAndExitInItsUnitsCategory)
{
    Recording const log;
    Value const value("a\n", ' ');
    EXPECT_EQ(log.texts(3000), (std::vector<std::string>{"strget: entry", "strget: exit"}));
    for (LogRecord const& record : log.records()) {
        EXPECT_EQ(record.category, "Veltrix.IC.MI.OsSwMI.MyProcess");
        EXPECT_EQ(record.file, "MyProcess");
        EXPECT_EQ(record.function, "strget");
    }
}

} // namespace strget_test
