#include "sysdata/osInfo_linux.h"

#include <gtest/gtest.h>

namespace trim_string_test
{

TEST(TrimString, StripsBlanksFromBothEndsOfATextThatHasMore)
{
    struct {
        std::string text;
        char const* trimmed;
    } const cases[] = {{"  x  ", "x"},       {" 10", "10"}, {"10 ", "10"}, {"10", "10"},
                       {" a  b ", "a  b"},   {"   ", "  "}, {" ", ""},     {"", ""},
                       {" \tx\n ", "\tx\n"}, {"\n", "\n"}};
    for (auto [text, trimmed] : cases) {
        NQ::OsInfo().trimString(text);
        EXPECT_EQ(text, trimmed);
    }
}

} // namespace trim_string_test
