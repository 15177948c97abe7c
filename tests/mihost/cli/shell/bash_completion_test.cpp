#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/shell/BashCompletion.h"

#include "mihost/cli/input/ShellWords.h"

#include <gtest/gtest.h>

namespace bash_completion_test
{

using namespace mihost;

constexpr char breaks[] = " \t\n\"'><=;|&(:";

std::vector<std::string> names(NodeKind const&)
{
    return {"ev`id>x`", "jdoe", "tab\tx", "new\nx", "esc\x1Bx", "high\xFFx", "Jürgen"};
}

std::string inBash(std::string const& line)
{
    return bashCompletionText(line, breaks, names, mihost::commandTable());
}

TEST(BashCompletionText, ReplacesWhatFollowsTheLastBreak)
{
    EXPECT_EQ(inBash("mihost get user:j"), "words\njdoe\n");
    EXPECT_EQ(inBash("mihost call UserDel UserName=j"), "words\njdoe\n");
    EXPECT_EQ(bashCompletionText("mihost get user:j", " ", names, mihost::commandTable()),
              "words\nuser:jdoe\n");
    EXPECT_EQ(inBash("mihost power "), "words\nrestart\nhalt\n");
}

TEST(BashCompletionText, IsQuotedByBackslashesOrForTheOpenQuote)
{
    EXPECT_EQ(inBash("mihost get user:ev"), "words\nev\\`id\\>x\\`\n");
    EXPECT_EQ(inBash("mihost get user:ev\\`id\\>"), "words\nev\\`id\\>x\\`\n");
    EXPECT_EQ(inBash("mihost get 'user:ev"), "words\nuser:ev`id>x`\n");
    EXPECT_EQ(inBash("mihost get \"user:ev"), "words\nuser:ev\\`id>x\\`\n");
    EXPECT_EQ(inBash("mihost get user:'ev"), "words\nev`id>x`\n");
    EXPECT_EQ(inBash("mihost get 'user:'ev"), "words\nev\\`id\\>x\\`\n");
    EXPECT_EQ(inBash("mihost get \"user\":ev"), "words\nev\\`id\\>x\\`\n");
}

TEST(BashCompletionText, OmitsNamesThatAreNotPlainText)
{
    EXPECT_EQ(inBash("mihost get user:"), "words\nev\\`id\\>x\\`\njdoe\nJürgen\n");
}

TEST(BashCompletionText, IsEmptyWhileTheProgramsNameIsTyped)
{
    for (char const* line : {"", "mihost", "/home/jdoe=x:y/mihost", "'mih"})
        EXPECT_EQ(inBash(line), "words\n") << line;
}

TEST(BashCompletionText, LeavesFilesToBash)
{
    EXPECT_EQ(inBash("mihost --trace "), "files\n");
    EXPECT_EQ(inBash("mihost --overlay "), "folders\n");
}

TEST(BashQuoting, IsReadBackAsItWas)
{
    for (char const quote : {'\0', '\'', '"'})
        for (int byte = 0x20; byte < 0x7F; ++byte) {
            std::string const text = std::string("a") + static_cast<char>(byte) + "b";
            std::string const open = quote == '\0' ? "" : std::string(1, quote);
            EXPECT_EQ(splitWords("x" + open + quotedForBash(text, quote) + open),
                      std::vector<std::string>{"x" + text});
        }
}

} // namespace bash_completion_test
