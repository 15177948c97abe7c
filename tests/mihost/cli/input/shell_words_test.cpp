#include "mihost/cli/input/ShellWords.h"
#include "tests/mihost/cli/Refusal.h"

#include <gtest/gtest.h>

namespace shell_words_test
{

using mihost::holdsPassword;
using mihost::splitWords;
using mihost::wordsBeingTyped;
using Words = std::vector<std::string>;

TEST(WordsOfALine, AreSeparatedByBlanks)
{
    EXPECT_EQ(splitWords("get os\t108"), (Words{"get", "os", "108"}));
    EXPECT_EQ(splitWords("  get   os  "), (Words{"get", "os"}));
    EXPECT_EQ(splitWords(""), Words());
    EXPECT_EQ(splitWords(" \t"), Words());
}

TEST(WordsOfALine, AreKeptTogetherByQuotesAndBackslashes)
{
    EXPECT_EQ(splitWords("call UserAdd 'Comment=J. Doe'"),
              (Words{"call", "UserAdd", "Comment=J. Doe"}));
    EXPECT_EQ(splitWords(R"(Comment="J. Doe")"), Words{"Comment=J. Doe"});
    EXPECT_EQ(splitWords(R"(J.\ Doe)"), Words{"J. Doe"});
    EXPECT_EQ(splitWords(R"("a 'b' \" c" 'd "e" \')"), (Words{"a 'b' \" c", "d \"e\" \\"}));
    EXPECT_EQ(splitWords("'' a"), (Words{"", "a"}));
    EXPECT_EQ(splitWords("a''b"), Words{"ab"});
}

TEST(WordsOfALine, EndAtACommentAndAreNotExpanded)
{
    EXPECT_EQ(splitWords("# nothing"), Words());
    EXPECT_EQ(splitWords("get os # 108"), (Words{"get", "os"}));
    EXPECT_EQ(splitWords("get a#b '#c' \\#d"), (Words{"get", "a#b", "#c", "#d"}));
    EXPECT_EQ(splitWords("$HOME ~ *.c `x` a;b a|b >f"),
              (Words{"$HOME", "~", "*.c", "`x`", "a;b", "a|b", ">f"}));
}

TEST(WordsOfALine, AreRefusedIfAQuoteIsNotClosed)
{
    for (char const* line : {"get 'os", "get \"os", "get os\\", "get 'os\"", "\"a\\"})
        EXPECT_EQ(refusal([line] { splitWords(line); }).find("nothing follows the last "), 0U)
            << line;
}

TEST(WordsBeingTyped, EndWithTheOneAtTheCursor)
{
    EXPECT_EQ(wordsBeingTyped(""), Words{""});
    EXPECT_EQ(wordsBeingTyped("get"), Words{"get"});
    EXPECT_EQ(wordsBeingTyped("get "), (Words{"get", ""}));
    EXPECT_EQ(wordsBeingTyped("get 'user:j d"), (Words{"get", "user:j d"}));
}

TEST(ALineForTheHistory, HoldsAPasswordIfACallOrAWriteHasOne)
{
    for (char const* line :
         {"call UserSetPassword UserName=jdoe Password=x", "call UserAdd UserName=j Password=x",
          "call UserAdd Pass'word=x' UserName=j", "--json call UserSetPassword Password=x",
          "set os 74 UserSetPassword,UserName:CMPI_string:j,Password:CMPI_string:x",
          "set os create-user 'UserAdd,Password:CMPI_string:x'", "set user:jdoe password $6$a$b",
          "set user:jdoe 117 '$6$a$b", "sett user:jdoe password x", "cal UserAdd Password=x",
          "user set-password jdoe x", "user add j --password x", "user add j --password=x"})
        EXPECT_TRUE(holdsPassword(line)) << line;
}

TEST(ALineForTheHistory, HoldsNoPasswordOtherwise)
{
    for (char const* line :
         {"", "get user:jdoe", "get user:jdoe password", "list users", "set user:jdoe full-name x",
          "call UserDel UserName=jdoe", "user set-password jdoe", "user add jdoe --password"})
        EXPECT_FALSE(holdsPassword(line)) << line;
}

} // namespace shell_words_test
