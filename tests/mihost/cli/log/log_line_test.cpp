#include "mihost/cli/log/LogLine.h"

#include "mihost/cli/input/Day.h"
#include "mihost/cli/log/LogFilter.h"
#include "tests/mihost/cli/Refusal.h"

#include <gtest/gtest.h>

namespace log_line_test
{

using namespace mihost;

/** @return the first day of a month */
std::tm dayIn(int year, int month)
{
    std::tm today{};
    today.tm_year = year - 1900;
    today.tm_mon = month - 1;
    today.tm_mday = 1;
    return today;
}

std::string shownTime(std::string const& line, std::tm const& today = dayIn(2026, 6))
{
    auto const time = logLineOf(line, today).time;
    return time ? timeText(*time) : "none";
}

TEST(LogLine, SeparatesStampAndMessage)
{
    EXPECT_EQ(logLineOf("Jan  2 03:04:05 host prog[1]: text", dayIn(2026, 6)).message,
              "host prog[1]: text");
    EXPECT_EQ(shownTime("Jan  2 03:04:05 host"), "2026-01-02 03:04:05");
    EXPECT_EQ(shownTime("Jun 21 23:59:59 host"), "2026-06-21 23:59:59");
}

TEST(LogLine, BelongsToLastYearIfItIsDecemberReadInJanuary)
{
    EXPECT_EQ(shownTime("Dec 31 23:00:00 x", dayIn(2026, 1)), "2025-12-31 23:00:00");
    EXPECT_EQ(shownTime("Dec 31 23:00:00 x", dayIn(2026, 2)), "2026-12-31 23:00:00");
    EXPECT_EQ(shownTime("Jan  1 00:00:00 x", dayIn(2026, 12)), "2026-01-01 00:00:00");
}

TEST(LogLine, HasNoTimeWithoutAStamp)
{
    for (char const* line : {"", "short", "2026-01-02T03:04:05 x", "Jan  2 03:04 x y z"})
        EXPECT_EQ(shownTime(line), "none") << line;
    EXPECT_EQ(logLineOf("short", dayIn(2026, 6)).message, "");
    EXPECT_EQ(logLineOf("exactly 16 bytes", dayIn(2026, 6)).message, "");
}

TEST(LogLine, LosesLeadingBlanksAndWhatThePluginSkips)
{
    EXPECT_EQ(logLineOf("   Jan  2 03:04:05 text", dayIn(2026, 6)).message, "text");
    std::string const stamp = "Jan  2 03:04:05 ";
    EXPECT_EQ(logLineOf(stamp + std::string(600, 'x'), dayIn(2026, 6)).message,
              std::string(511 - stamp.size(), 'x'));
    EXPECT_EQ(logLineOf(stamp + "a" + std::string(1, '\0') + "b", dayIn(2026, 6)).message, "a");
}

TEST(LogMessage, LosesThePluginsAsterisksAndTheHost)
{
    EXPECT_EQ(withoutAsterisks("*text*"), "text");
    EXPECT_EQ(withoutAsterisks("**"), "");
    EXPECT_EQ(withoutAsterisks("***"), "*");
    for (char const* other : {"", "*", "text", "*text", "text*"})
        EXPECT_EQ(withoutAsterisks(other), other);
    EXPECT_EQ(withoutHostName("host prog[1]: text"), "prog[1]: text");
    EXPECT_EQ(withoutHostName("alone"), "alone");
    EXPECT_EQ(withoutHostName(""), "");
}

TEST(LogFilter, ShowsEverythingAtFirst)
{
    EXPECT_TRUE(LogFilter().shows({std::nullopt, ""}));
    EXPECT_TRUE(LogFilter().shows({5, "text"}));
}

TEST(LogFilter, KeepsTimesWithinItsBoundsAndDropsOthers)
{
    LogFilter filter;
    filter.setSince(10);
    filter.setUntil(20);
    for (long const time : {10L, 15L, 20L})
        EXPECT_TRUE(filter.shows({time, ""})) << time;
    for (long const time : {9L, 21L})
        EXPECT_FALSE(filter.shows({time, ""})) << time;
    EXPECT_FALSE(filter.shows({std::nullopt, ""}));
    LogFilter open;
    open.setUntil(20);
    EXPECT_TRUE(open.shows({0, ""}));
    EXPECT_FALSE(open.shows({std::nullopt, ""}));
}

TEST(LogFilter, MatchesMessagesByAnExtendedRegularExpression)
{
    LogFilter filter;
    filter.setPattern("^ssh(d|-agent)\\[[0-9]+\\]: (Failed|Invalid)");
    EXPECT_TRUE(filter.shows({1, "sshd[12]: Failed password"}));
    EXPECT_FALSE(filter.shows({1, "sshd[12]: Accepted password"}));
    EXPECT_FALSE(filter.shows({1, "x sshd[12]: Failed password"}));
}

TEST(LogFilter, RefusesAnInvalidPattern)
{
    LogFilter filter;
    std::string const reason = refusal([&filter] { filter.setPattern("a("); });
    EXPECT_EQ(reason.find("--grep: 'a(': "), 0U) << reason;
    EXPECT_TRUE(filter.shows({1, "anything"}));
}

} // namespace log_line_test
