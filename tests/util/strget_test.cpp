#include "util/MyProcess.h"

#include "tests/support/Lines.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <string>

namespace strget_test
{

TEST(Strget, SkipsLeadingCharactersAndCutsEachLineEnd)
{
    struct {
        char const* what;
        std::string line;
        char skipped;
        std::ptrdiff_t offset;
        char const* value;
        std::string bytes; // of the line, afterwards
    } const cases[] = {
        {"blanks", "   1.2.3\n", ' ', 3, "1.2.3", std::string("   1.2.3\0", 9)},
        {"two line ends", "abc\ndef\n", 'x', 0, "abc", std::string("abc\0def\0", 8)},
        {"a blank line", " \n", ' ', 1, "", std::string(" \0", 2)},
        {"no text", "", ' ', 0, "", ""},
        {"only the character", "    ", ' ', 4, "", "    "},
        {"a tab before the blank", "\t 5.0\n", ' ', 0, "\t 5.0", std::string("\t 5.0\0", 6)},
        {"another character", "::a:b\n", ':', 2, "a:b", std::string("::a:b\0", 6)},
        {"blanks at the end", " value  \r\n", ' ', 1, "value  \r", std::string(" value  \r\0", 10)},
        {"line ends that are skipped", "\n\nvalue\n", '\n', 2, "value",
         std::string("\n\nvalue\0", 8)},
    };
    for (auto const& [what, line, skipped, offset, value, bytes] : cases) {
        std::string text = line;
        char* const found = NQ::strget(text.data(), skipped);
        EXPECT_EQ(found - text.data(), offset) << what;
        EXPECT_STREQ(found, value) << what;
        EXPECT_EQ(text, bytes) << what;
    }
}

TEST(Strget, LogsItsEntryAndExitInItsUnitsCategory)
{
    Recording const log;
    char line[] = "a\n";
    NQ::strget(line, ' ');
    EXPECT_EQ(log.texts(3000), (Lines{"strget: entry", "strget: exit"}));
    EXPECT_EQ(log.sources(), Lines{"strget MyProcess Veltrix.IC.MI.OsSwMI.MyProcess"});
}

} // namespace strget_test
