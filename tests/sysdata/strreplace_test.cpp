#include "sysdata/logInfo_linux.h"
#include "sysdata/osInfo_linux.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

namespace strreplace_test
{

/** What an operation of that name makes of a text, which may hold NUL bytes. */
template <class Info> std::string replaced(std::string text, char from, char to)
{
    Info().strreplace(text.data(), from, to);
    return text;
}

template <class Info> void expectReplacements()
{
    EXPECT_EQ(replaced<Info>("-a-b-", '-', ' '), "-a b ");
    EXPECT_EQ(replaced<Info>("-", '-', ' '), "-");
    EXPECT_EQ(replaced<Info>(std::string("ab-c--d-\0-", 10), '-', ' '),
              std::string("ab c  d \0-", 10));
    EXPECT_EQ(replaced<Info>("abcbd", 'b', '\0'), std::string("a\0cbd", 5));
    EXPECT_EQ(replaced<Info>(std::string("\0-", 2), '-', ' '), std::string("\0-", 2));
    Recording const recording;
    replaced<Info>("a-b", '-', ' ');
    EXPECT_EQ(recording.texts(3000), (Lines{"strreplace: entry", "strreplace: exit"}));
}

TEST(Strreplace, KeepsTheFirstCharacterAndEndsWithTheText)
{
    expectReplacements<NQ::OsInfo>();
    expectReplacements<NQ::logInfo>();
}

} // namespace strreplace_test
