#include "sysdata/osInfo_linux.h"

#include <gtest/gtest.h>

namespace strreplace_test
{

std::string replaced(std::string text, char from, char to)
{
    text.push_back('\0');
    NQ::OsInfo().strreplace(text.data(), from, to);
    text.erase(text.find('\0'));
    return text;
}

TEST(Strreplace, KeepsTheFirstCharacter)
{
    EXPECT_EQ(replaced("-a-b", '-', ' '), "-a b");
}

TEST(Strreplace, ReplacesEveryOtherCharacterUpToTheEndOfTheText)
{
    char text[] = "ab-c--d-\0-";
    NQ::OsInfo().strreplace(text, '-', ' ');
    EXPECT_EQ(std::string(text, 10), std::string("ab c  d \0-", 10));
}

TEST(Strreplace, StopsAtTheFirstReplacementByNul)
{
    char text[] = "abcbd";
    NQ::OsInfo().strreplace(text, 'b', '\0');
    EXPECT_EQ(std::string(text, 5), std::string("a\0cbd", 5));
}

TEST(Strreplace, KeepsAnEmptyText)
{
    char text[] = {'\0', '-', '\0'};
    NQ::OsInfo().strreplace(text, '-', ' ');
    EXPECT_EQ(std::string(text, 2), std::string("\0-", 2));
}

} // namespace strreplace_test
