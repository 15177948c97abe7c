#include "sysdata/userInfo_parse.h"
#include "tests/support/Lines.h"

#include <gtest/gtest.h>

#include <map>
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

struct Denied {
    Scan scan;
    long number;
};

Denied denied(std::string const& line)
{
    long number = untouched;
    Scan const scan = scanDeny(line, number);
    return {scan, number};
}

void expectDenied(std::string const& line, Scan scan, long number)
{
    Denied const found = denied(line);
    EXPECT_EQ(found.scan, scan) << line;
    EXPECT_EQ(found.number, number) << line;
}

TEST(LoginRule, GivesTheNumberAfterDeny)
{
    expectDenied("auth required pam_tally2.so deny=3 unlock_time=600", Scan::valid, 3);
    expectDenied("deny=0", Scan::valid, 0);
    expectDenied("deny=-1", Scan::valid, -1);
    expectDenied("deny= 12", Scan::valid, 12);
    expectDenied("deny=5x", Scan::valid, 5);
}

TEST(LoginRule, CountsInACommentAndInsideAnotherWord)
{
    expectDenied("# deny=4", Scan::valid, 4);
    expectDenied("even_root_deny=6", Scan::valid, 6);
}

TEST(LoginRule, IsReadFromItsFirstDenyOnly)
{
    expectDenied("deny=1 deny=2", Scan::valid, 1);
    expectDenied("deny=x deny=2", Scan::invalid, untouched);
}

TEST(LoginRule, IsInvalidWithoutANumber)
{
    expectDenied("deny=", Scan::invalid, untouched);
    expectDenied("deny=many", Scan::invalid, untouched);
}

TEST(LoginRule, IsAbsentWithoutDeny)
{
    expectDenied("", Scan::absent, untouched);
    expectDenied("auth required pam_unix.so", Scan::absent, untouched);
    expectDenied("deny 3", Scan::absent, untouched);
    expectDenied("DENY=3", Scan::absent, untouched);
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
}

TEST(LoginRules, MayEndWithoutALineEnd)
{
    EXPECT_EQ(denyLines("x\ndeny=5"), (Lines{"deny=5"}));
}

TEST(LoginRules, KeepNulBytes)
{
    EXPECT_EQ(denyLines(std::string_view("a\0deny=1\n", 9)), (Lines{std::string("a\0deny=1", 8)}));
}

TEST(LoginRules, MayBeNone)
{
    EXPECT_EQ(denyLines(""), Lines());
    EXPECT_EQ(denyLines("deny\n=3\n"), Lines());
}

constexpr char const* label = "Password expires";

/** The outcome of scanning a line, and the date that was 3 February 2008 before. */
std::string scanned(char const* line)
{
    static std::map<Scan, std::string> const outcomes = {
        {Scan::valid, "valid"}, {Scan::invalid, "invalid"}, {Scan::absent, "absent"}};
    LabelledDate date{"Feb", 3, 2008};
    Scan const scan = scanLabelledDate(line, label, date);
    return outcomes.at(scan) + ' ' + date.month + ' ' + std::to_string(date.day) + ' ' +
           std::to_string(date.year);
}

TEST(LabelledDate, IsReadAfterItsLabelAndAColon)
{
    EXPECT_EQ(scanned("Password expires\t\t\t\t\t: Dec 01, 2010\n"), "valid Dec 1 2010");
    EXPECT_EQ(scanned("Password expires : Dec 31, 2010"), "valid Dec 31 2010");
}

TEST(LabelledDate, IsKeptByALineWithoutTheLabel)
{
    EXPECT_EQ(scanned("Account expires : Dec 31, 2010"), "absent Feb 3 2008");
}

TEST(LabelledDate, IsInvalidIfTheLabelIsNotAtTheStart)
{
    EXPECT_EQ(scanned("x Password expires : Dec 31, 2010"), "invalid Feb 3 2008");
}

TEST(LabelledDate, ReadsNeverAsTheMonthOfAnInvalidDate)
{
    EXPECT_EQ(scanned("Password expires : never\n"), "invalid never 3 2008");
}

TEST(LabelledDate, Is19January2038IfADayAndAYearFollowNever)
{
    EXPECT_EQ(scanned("Password expires : never 01, 2008"), "valid Jan 19 2038");
}

TEST(LabelledDate, KeepsWhatWasReadOfAnInvalidDate)
{
    EXPECT_EQ(scanned("Password expires : Dec 31 2010"), "invalid Dec 31 2008");
}

TEST(LabelledDate, ReadsTwoDigitsOfTheDayAndFourOfTheYear)
{
    EXPECT_EQ(scanned("Password expires : Dec 31, 20109"), "valid Dec 31 2010");
    EXPECT_EQ(scanned("Password expires : Dec 311, 2010"), "invalid Dec 31 2008");
}

TEST(LabelledDate, IsValidWithADayThatNoMonthHas)
{
    EXPECT_EQ(scanned("Password expires : Feb 0, 2008"), "valid Feb 0 2008");
    EXPECT_EQ(scanned("Password expires : Feb 99, 2008"), "valid Feb 99 2008");
}

TEST(LabelledDate, HoldsAMonthTextAsLongAsTheLine)
{
    std::string const text(100000, 'm');
    LabelledDate date;
    EXPECT_EQ(scanLabelledDate(("Password expires : " + text).c_str(), label, date), Scan::invalid);
    EXPECT_EQ(date.month, text);
}

void expectDay(char const* text, int year, int month, int day)
{
    NQ::USER_INFO::CalendarDay const found = scanDay(text);
    EXPECT_EQ(found.year, year) << text;
    EXPECT_EQ(found.month, month) << text;
    EXPECT_EQ(found.day, day) << text;
}

TEST(WrittenDate, IsReadAsYearMonthAndDay)
{
    expectDay("2010-12-31 00:00:00", 2010, 12, 31);
    expectDay("2010-05-07", 2010, 5, 7);
    expectDay("2010-5-7 12:30:00", 2010, 5, 7);
}

TEST(WrittenDate, HasZerosForUnreadableFields)
{
    expectDay("", 0, 0, 0);
    expectDay("tomorrow", 0, 0, 0);
    expectDay("2010", 2010, 0, 0);
    expectDay("2010-12", 2010, 12, 0);
    expectDay("2010/12/31", 2010, 0, 0);
}

} // namespace user_parse_test
