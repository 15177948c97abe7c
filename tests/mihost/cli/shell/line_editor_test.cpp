#include "mihost/cli/shell/LineEditor.h"

#include <algorithm>
#include <gtest/gtest.h>

namespace line_editor_test
{

using mihost::commonStart;
using mihost::inColumns;
using Words = std::vector<std::string>;

TEST(CommonStart, IsWhatAllCandidatesBeginWith)
{
    EXPECT_EQ(commonStart({}), "");
    EXPECT_EQ(commonStart({"user:jdoe"}), "user:jdoe");
    EXPECT_EQ(commonStart({"user:jdoe", "user:jane", "user:j"}), "user:j");
    EXPECT_EQ(commonStart({"get", "set"}), "");
}

TEST(WordsInColumns, AreBelowEachOtherOrOnALineEach)
{
    EXPECT_EQ(inColumns({"tree", "list", "get", "doctor", "set"}, 24), "tree    list    get\n"
                                                                       "doctor  set\n");
    EXPECT_EQ(inColumns({"李明", "ab"}, 80), "李明  ab\n");
    EXPECT_EQ(inColumns({"tree", "list"}, 3), "tree\nlist\n");
    EXPECT_EQ(inColumns({"tree", "list"}, 0), "tree\nlist\n");
}

TEST(WordsInColumns, AreLimitedAndTheRestIsCounted)
{
    std::string const text = inColumns(Words(3000, "user:jdoe"), 80);
    EXPECT_EQ(std::count(text.begin(), text.end(), '\n'), 200 / 7 + 2);
    EXPECT_EQ(text.substr(text.rfind('\n', text.size() - 2)), "\nand 2800 more\n");
}

} // namespace line_editor_test
