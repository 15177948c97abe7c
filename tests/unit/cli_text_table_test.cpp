#include "mihost/cli/output/TextTable.h"

#include <gtest/gtest.h>

namespace
{

using mihost::displayWidth;
using mihost::fitted;
using mihost::TextTable;
using Lines = std::vector<std::string>;

TEST(DisplayWidth, CountsTheColumnsOfATerminal)
{
    EXPECT_EQ(displayWidth(""), 0U);
    EXPECT_EQ(displayWidth("Jürgen"), 6U);
    EXPECT_EQ(displayWidth("李明"), 4U);
    EXPECT_EQ(displayWidth("e\u0301"), 1U); // a letter and its accent
}

TEST(Fitted, LeavesTextThatFitsAlone)
{
    EXPECT_EQ(fitted("abcd", {4}), "abcd");
    EXPECT_EQ(fitted("", {0}), "");
}

TEST(Fitted, CutsWithAnEllipsisAndNeverThroughACharacter)
{
    EXPECT_EQ(fitted("abcde", {4}), "abc…");
    EXPECT_EQ(fitted("李明李", {4}), "李…");
    EXPECT_EQ(fitted("abc", {1}), "…");
    EXPECT_EQ(fitted("abc", {0}), "");
    EXPECT_EQ(fitted("abcde", {4, "~"}), "abc~");
}

TEST(TextTable, MakesColumnsAsWideAsTheirWidestCell)
{
    TextTable table({"name", "id"});
    table.add({"李明", "1"});
    table.add({"Jürgen", "22"});
    EXPECT_EQ(table.lines({}), (Lines{"name    id", "李明    1", "Jürgen  22"}));
}

TEST(TextTable, CutsTheWidestColumnsToFitTheTerminal)
{
    TextTable table({"id", "text"});
    table.add({"1", std::string(100, 'x')});
    for (std::string const& line : table.lines({80}))
        EXPECT_LE(displayWidth(line), 80U);
    EXPECT_EQ(table.lines({20}).back(), "1   xxxxxxxxxxxxxxx…");
    EXPECT_EQ(table.lines({200}).back(), "1   " + std::string(100, 'x'));
}

TEST(TextTable, KeepsSomethingOfEveryColumnOnATinyTerminal)
{
    TextTable table({"first", "second"});
    table.add({"abcdef", "abcdef"});
    EXPECT_EQ(table.lines({1}).back(), "abc…  abc…");
}

TEST(TextTable, LeavesNoBlanksAtLineEnds)
{
    TextTable table({"a", "b"});
    table.add({"x", ""});
    EXPECT_EQ(table.lines({}), (Lines{"a  b", "x"}));
}

} // namespace
