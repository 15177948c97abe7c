#include "sysdata/logInfo_linux.h"
#include "sysdata/osInfo_linux.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

namespace strreplace_test
{

/** The operation that both classes have, on a text that may hold NUL bytes. */
template <class Info> class Strreplace : public testing::Test
{
protected:
    static std::string replaced(std::string text, char from, char to)
    {
        Info().strreplace(text.data(), from, to);
        return text;
    }
};

using Classes = testing::Types<NQ::OsInfo, NQ::logInfo>;
TYPED_TEST_SUITE(Strreplace, Classes);

TYPED_TEST(Strreplace, ReplacesAllButTheFirstCharacterUpToTheEndOfTheText)
{
    EXPECT_EQ(this->replaced("-a-b-", '-', ' '), "-a b ");
    EXPECT_EQ(this->replaced("-", '-', ' '), "-");
    EXPECT_EQ(this->replaced(std::string("ab-c--d-\0-", 10), '-', ' '),
              std::string("ab c  d \0-", 10));
    EXPECT_EQ(this->replaced("abcbd", 'b', '\0'), std::string("a\0cbd", 5));
    EXPECT_EQ(this->replaced(std::string("\0-", 2), '-', ' '), std::string("\0-", 2));
}

TYPED_TEST(Strreplace, LogsEntryAndExit)
{
    Recording const recording;
    this->replaced("a-b", '-', ' ');
    EXPECT_EQ(recording.texts(3000), (Lines{"strreplace: entry", "strreplace: exit"}));
}

} // namespace strreplace_test
