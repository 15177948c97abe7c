#include "mihost/cli/input/Moment.h"

#include "mihost/cli/input/Day.h"

#include <gtest/gtest.h>

namespace moment_test
{

using namespace mihost;

/** @return the moment as it is shown, if it is now noon on a day in June */
std::string moment(std::string const& text)
{
    auto const seconds = parseMoment(text, parseTime("2026-06-10 12:00:00").value());
    return seconds ? timeText(*seconds) : "none";
}

TEST(Moment, IsADayOrATime)
{
    EXPECT_EQ(moment("2026-06-01"), "2026-06-01 00:00:00");
    EXPECT_EQ(moment("2026-06-01 03:04:05"), "2026-06-01 03:04:05");
}

TEST(Moment, IsNamed)
{
    EXPECT_EQ(moment("now"), "2026-06-10 12:00:00");
    EXPECT_EQ(moment("today"), "2026-06-10 00:00:00");
    EXPECT_EQ(moment("yesterday"), "2026-06-09 00:00:00");
}

TEST(Moment, IsSomeTimeAgo)
{
    EXPECT_EQ(moment("1 second ago"), "2026-06-10 11:59:59");
    EXPECT_EQ(moment("90 minutes ago"), "2026-06-10 10:30:00");
    EXPECT_EQ(moment("0 hours ago"), "2026-06-10 12:00:00");
    EXPECT_EQ(moment("2 days ago"), "2026-06-08 12:00:00");
    EXPECT_EQ(moment("1 week ago"), "2026-06-03 12:00:00");
    EXPECT_EQ(parseMoment("1000000 weeks ago", 1), 0); // and not before 1970
}

TEST(Moment, HasNoOtherForm)
{
    for (char const* text :
         {"", "soon", "tomorrow", "1 hour", "hour ago", "-1 hours ago", "1 month ago",
          "1 hour ago now", "9999999999 weeks ago", "2026-02-30", "2026-06-01 24:00:00"})
        EXPECT_EQ(moment(text), "none") << text;
}

} // namespace moment_test
