#include "mihost/cli/output/TreeLayout.h"

#include "mihost/cli/output/DisplayWidth.h"
#include "mihost/cli/output/Style.h"
#include "tests/support/Lines.h"

#include <gtest/gtest.h>

namespace layout_test
{

using mihost::Branch;
using mihost::Cell;
using mihost::Column;
using mihost::displayWidth;
using mihost::Grid;
using mihost::layOut;
using mihost::Room;
using mihost::Style;
using mihost::Table;
using mihost::wrapped;

constexpr char fox[] = "the quick brown fox jumps over the lazy dog";

TEST(DisplayWidth, CountsTheColumnsOfATerminal)
{
    EXPECT_EQ(displayWidth(""), 0U);
    EXPECT_EQ(displayWidth("Jürgen"), 6U);
    EXPECT_EQ(displayWidth("李明"), 4U);
    EXPECT_EQ(displayWidth("e\u0301"), 1U); // a letter and its accent
    for (Style const style :
         {Style::Bold, Style::Faint, Style::Green, Style::Yellow, Style::Red, Style::Cyan})
        EXPECT_EQ(displayWidth(styled(style, "abc")), 3U);
}

TEST(WrappedText, BreaksAtBlanksAndDropsOnlyThose)
{
    EXPECT_EQ(wrapped(fox, 10), (Lines{"the quick", "brown fox", "jumps over", "the lazy", "dog"}));
    EXPECT_EQ(wrapped(fox, 100), Lines{fox});
    EXPECT_EQ(wrapped("", 10), Lines{""});
}

TEST(WrappedText, BreaksLongWordsBetweenCharacters)
{
    EXPECT_EQ(wrapped("abcdefgh", 3), (Lines{"abc", "def", "gh"}));
    EXPECT_EQ(wrapped("李明李明", 3), (Lines{"李", "明", "李", "明"}));
    EXPECT_EQ(wrapped("e\u0301e\u0301e\u0301", 2), (Lines{"e\u0301e\u0301", "e\u0301"}));
    EXPECT_EQ(wrapped("李", 0), Lines{"李"}); // ends at any width
}

Table people()
{
    Table table({{"name"}, {"id", Column::Align::Right}, {"comment"}});
    table.add({"李明", Cell(1, "1"), fox});
    table.add({"Jürgen", Cell(22, "22"), ""});
    return table;
}

TEST(TableLayout, AlignsWideCharactersAndMarksEmptyCells)
{
    EXPECT_EQ(mihost::withoutStyles(layOut(people(), {})[0]), "name    id  comment");
    EXPECT_EQ(layOut(people(), {})[1], std::string("李明     1  ") + fox);
    EXPECT_EQ(layOut(people(), {})[2], "Jürgen  22  -");
}

TEST(TableLayout, HasItsHeadingsAlsoWithoutRowsOrNever)
{
    Table const table({{"name"}, {"id"}});
    EXPECT_EQ(mihost::withoutStyles(layOut(table, {}).at(0)), "name  id");
    EXPECT_EQ(layOut(table, {}, false), Lines());
    EXPECT_EQ(layOut(people(), {}, false)[0], std::string("李明     1  ") + fox);
}

TEST(TableLayout, WrapsOnlyTheLastTextColumn)
{
    Lines const lines = layOut(people(), {35});
    EXPECT_EQ(lines[1], "李明     1  the quick brown fox");
    EXPECT_EQ(lines[2], "            jumps over the lazy dog");
    EXPECT_EQ(lines[3], "Jürgen  22  -");
}

TEST(TableLayout, WrapsATextColumnBeforeNumbers)
{
    Table table({{"text"}, {"n", Column::Align::Right}});
    table.add({fox, Cell(5, "5")});
    EXPECT_EQ(layOut(table, {28}, false),
              (Lines{"the quick brown fox jumps  5", "over the lazy dog"}));
}

TEST(TableLayout, BecomesRecordsInANarrowTerminal)
{
    Lines lines = layOut(people(), {31});
    for (std::string& line : lines)
        line = mihost::withoutStyles(line);
    EXPECT_EQ(lines, (Lines{"name     李明", "id       1", "comment  the quick brown fox",
                            "         jumps over the lazy", "         dog", "", "name     Jürgen",
                            "id       22", "comment  -"}));
}

TEST(TableLayout, EscapesTerminalControls)
{
    Table table({{"text"}});
    table.add({"\x1b[2J\u2066"});
    EXPECT_EQ(layOut(table, {}, false), Lines{"\\x1b[2J\\u2066"});
}

TEST(TableLayout, HasNoBlanksAtLineEnds)
{
    for (std::string const& line : layOut(people(), {35}))
        EXPECT_NE(line.back(), ' ') << line;
}

std::vector<Branch> family()
{
    return {{0, "top #1", "first", {}},
            {0, "child #2", fox, {}},
            {1, "grandchild #3", "", {}},
            {0, "other #4", "last", {}}};
}

TEST(TreeLayout, HasTextsInAColumnBesideTheNames)
{
    EXPECT_EQ(layOut(family(), {}),
              (Lines{"top #1             first", std::string("├─child #2         ") + fox,
                     "│ └─grandchild #3", "└─other #4         last"}));
    EXPECT_EQ(layOut(family(), {Room::unlimited, false}).back(), "`-other #4         last");
}

TEST(TreeLayout, WrapsTextsAndDrawsItsBranchesBesideThem)
{
    Lines const lines = layOut(family(), {42});
    EXPECT_EQ(lines[1], "├─child #2         the quick brown fox");
    EXPECT_EQ(lines[2], "│ │                jumps over the lazy dog");
    EXPECT_EQ(lines[3], "│ └─grandchild #3");
}

TEST(TreeLayout, HasTextsAfterTheNamesInANarrowTerminal)
{
    Lines const lines = layOut(family(), {30});
    EXPECT_EQ(lines[1], "├─child #2  the quick brown");
    EXPECT_EQ(lines[2], "│ fox jumps over the lazy dog");
    for (std::string const& line : lines)
        EXPECT_LE(displayWidth(line), 30U) << line;
}

TEST(TreeLayout, HasEachBranchBelowItsParentInAnyOrder)
{
    std::vector<Branch> branches = family();
    branches.push_back({2, "great-grandchild #5", "", {}});
    branches.push_back({1, "late #6", "", {}});
    EXPECT_EQ(layOut(branches, {}), (Lines{"top #1                     first",
                                           std::string("├─child #2                 ") + fox,
                                           "│ ├─grandchild #3", "│ │ └─great-grandchild #5",
                                           "│ └─late #6", "└─other #4                 last"}));
}

TEST(TreeLayout, ShowsDetailsBelowTheText)
{
    std::vector<Branch> branches = family();
    branches[3].details = Grid{{Column(""), Column("")}, {{"  1 a", "x"}, {" 22 bb", "y"}}};
    Lines const lines = layOut(branches, {});
    EXPECT_EQ(lines[3], "└─other #4         last");
    EXPECT_EQ(lines[4], "                     1 a   x");
    EXPECT_EQ(lines[5], "                    22 bb  y");
}

TEST(Styles, BecomeColoursThatEndWithTheLine)
{
    std::string const text = "a" + styled(Style::Red, "b\nc") + "d";
    EXPECT_EQ(mihost::withoutStyles(text), "ab\ncd");
    EXPECT_EQ(mihost::withColours(text), "a\x1b[31mb\x1b[0m\nc\x1b[0md");
}

} // namespace layout_test
