#include "sysdata/userInfo_parse.h"
#include "tests/support/Lines.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace user_parse_test
{

using NQ::USER_INFO::LabelledDate;
using NQ::USER_INFO::Scan;
using NQ::USER_INFO::scanDay;
using NQ::USER_INFO::scanDeny;
using NQ::USER_INFO::scanLabelledDate;

constexpr long untouched = 4711;

TEST(LoginRule, GivesTheNumberAfterItsFirstDeny)
{
    struct {
        char const* line;
        Scan scan;
        long number;
    } const cases[] = {{"auth required pam_tally2.so deny=3 unlock_time=600", Scan::valid, 3},
                       {"deny=0", Scan::valid, 0},
                       {"deny=-1", Scan::valid, -1},
                       {"deny= 12", Scan::valid, 12},
                       {"deny=5x", Scan::valid, 5},
                       {"# deny=4", Scan::valid, 4},
                       {"even_root_deny=6", Scan::valid, 6},
                       {"deny=1 deny=2", Scan::valid, 1},
                       {"deny=x deny=2", Scan::invalid, untouched},
                       {"deny=", Scan::invalid, untouched},
                       {"deny=many", Scan::invalid, untouched},
                       {"", Scan::absent, untouched},
                       {"auth required pam_unix.so", Scan::absent, untouched},
                       {"deny 3", Scan::absent, untouched},
                       {"DENY=3", Scan::absent, untouched}};
    for (auto const& [line, scan, expected] : cases) {
        long number = untouched;
        EXPECT_EQ(scanDeny(line, number), scan) << line;
        EXPECT_EQ(number, expected) << line;
    }
}

Lines denyLines(std::string_view rules)
{
    Lines lines;
    for (std::string line = NQ::USER_INFO::takeDenyLine(rules); !line.empty();
         line = NQ::USER_INFO::takeDenyLine(rules))
        lines.push_back(line);
    return lines;
}

TEST(LoginRules, AreTheLinesThatHoldDenyInTheirOrder)
{
    EXPECT_EQ(denyLines("a deny=1 b\nc\n# deny=2\n\ndeny=3 deny=4\n"),
              (Lines{"a deny=1 b", "# deny=2", "deny=3 deny=4"}));
    EXPECT_EQ(denyLines("x\ndeny=5"), (Lines{"deny=5"}));
    EXPECT_EQ(denyLines(std::string_view("a\0deny=1\n", 9)), (Lines{std::string("a\0deny=1", 8)}));
    EXPECT_EQ(denyLines(""), Lines());
    EXPECT_EQ(denyLines("deny\n=3\n"), Lines());
}

constexpr char const* label = "Password expires";

TEST(LabelledDate, IsReadAfterItsLabelAndAColon)
{
    struct {
        char const* line;
        Scan scan;
        char const* date; // which was 3 February 2008 before
    } const cases[] = {
        {"Password expires\t\t\t\t\t: Dec 01, 2010\n", Scan::valid, "Dec 1 2010"},
        {"Password expires : Dec 31, 2010", Scan::valid, "Dec 31 2010"},
        {"Account expires : Dec 31, 2010", Scan::absent, "Feb 3 2008"},
        {"x Password expires : Dec 31, 2010", Scan::invalid, "Feb 3 2008"},
        {"Password expires : never\n", Scan::invalid, "never 3 2008"},
        {"Password expires : never 01, 2008", Scan::valid, "Jan 19 2038"},
        {"Password expires : Dec 31 2010", Scan::invalid, "Dec 31 2008"},
        {"Password expires : Dec 31, 20109", Scan::valid, "Dec 31 2010"},
        {"Password expires : Dec 311, 2010", Scan::invalid, "Dec 31 2008"},
        {"Password expires : Feb 0, 2008", Scan::valid, "Feb 0 2008"},
        {"Password expires : Feb 99, 2008", Scan::valid, "Feb 99 2008"},
    };
    for (auto const& [line, scan, expected] : cases) {
        LabelledDate date{"Feb", 3, 2008};
        EXPECT_EQ(scanLabelledDate(line, label, date), scan) << line;
        EXPECT_EQ(date.month + ' ' + std::to_string(date.day) + ' ' + std::to_string(date.year),
                  expected);
    }
}

TEST(LabelledDate, HoldsAMonthTextAsLongAsTheLine)
{
    std::string const text(100000, 'm');
    LabelledDate date;
    EXPECT_EQ(scanLabelledDate(("Password expires : " + text).c_str(), label, date), Scan::invalid);
    EXPECT_EQ(date.month, text);
}

TEST(WrittenDate, HasZerosForUnreadableFields)
{
    struct {
        char const* text;
        std::vector<int> fields; // year, month, day
    } const cases[] = {{"2010-12-31 00:00:00", {2010, 12, 31}},
                       {"2010-05-07", {2010, 5, 7}},
                       {"2010-5-7 12:30:00", {2010, 5, 7}},
                       {"", {0, 0, 0}},
                       {"tomorrow", {0, 0, 0}},
                       {"2010", {2010, 0, 0}},
                       {"2010-12", {2010, 12, 0}},
                       {"2010/12/31", {2010, 0, 0}}};
    for (auto const& [text, fields] : cases) {
        NQ::USER_INFO::CalendarDay const found = scanDay(text);
        EXPECT_EQ((std::vector<int>{found.year, found.month, found.day}), fields) << text;
    }
}

} // namespace user_parse_test
