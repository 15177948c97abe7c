// date, asked in both ways and compared byte by byte.

#include "mihost/accel/Answers.h"
#include "tests/interpose/Libc.h"
#include "tests/support/BothWays.h"
#include "tests/support/Lines.h"
#include "tests/support/ScratchFolder.h"

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <vector>

namespace date_test
{

using bothways::answered;
using bothways::countOf;
using bothways::real;

constexpr std::time_t day = 24 * 60 * 60;

/** All through some years, at every hour of the day, and the ends of what fits. */
std::vector<std::time_t> instants()
{
    std::vector<std::time_t> times{-3000000000, -1, 0, 1, 2147483647, 2147483648, 4102444800};
    for (std::time_t const year : {1995, 2026, 2040})
        for (std::time_t half = 0; half < 24; half += year == 2026 ? 1 : 4)
            times.push_back((year - 1970) * 365 * day + (year - 1969) / 4 * day + half * 15 * day +
                            half * 3601);
    return times;
}

/** A command that prints the real dates of all of the instants. */
std::string dateCommand(ScratchFolder const& folder)
{
    std::ofstream file(folder.path("times"));
    for (std::time_t const time : instants())
        file << '@' << time << '\n';
    return "date -f " + folder.path("times");
}

/** What it prints in the zone and locale of the environment. */
std::string realDates(ScratchFolder const& folder)
{
    return real(dateCommand(folder));
}

std::string expectedDates()
{
    std::string text;
    for (std::time_t const time : instants())
        text += miaccel::dateAt(time);
    return text;
}

/** The last zone before the first line that differs, and that line. */
std::string firstDifference(Lines const& expected, Lines const& found)
{
    std::string zone;
    for (std::size_t line = 0; line < std::min(expected.size(), found.size()); ++line) {
        if (expected[line] != found[line])
            return zone + ": " + found[line] + ", not " + expected[line];
        if (expected[line].find(' ') == std::string::npos)
            zone = expected[line];
    }
    return "of other length";
}

Lines allZones()
{
    Lines zones;
    std::filesystem::path const all = "/usr/share/zoneinfo";
    for (auto const& entry : std::filesystem::recursive_directory_iterator(all)) {
        std::string const name = entry.path().lexically_relative(all);
        if (entry.is_regular_file() && name.rfind("right/", 0) != 0 && name.rfind("posix/", 0) != 0)
            zones.push_back(name);
    }
    return zones;
}

TEST(AccelDate, IsThatOfDateInEveryTimeZoneThereIs)
{
    ScratchFolder const folder;
    setenv("LC_ALL", "C", 1);
    Lines const zones = allZones();
    EXPECT_GT(zones.size(), 300U);
    std::string const command = dateCommand(folder);
    std::string script; // one shell for all: starting it takes longer than date itself
    std::string expected;
    for (std::string const& zone : zones) {
        script += "echo " + zone + "; TZ=" + zone + " " + command + "; ";
        setenv("TZ", zone.c_str(), 1);
        expected += zone + "\n" + expectedDates();
    }
    script += "true";
    EXPECT_TRUE(expected == real(script))
        << firstDifference(linesOf(expected), linesOf(real(script)));
}

TEST(AccelDate, IsThatOfDateForZonesOfEveryForm)
{
    ScratchFolder const folder;
    for (char const* zone :
         {"", ":", ":Europe/Berlin", "/usr/share/zoneinfo/Asia/Tokyo", "UTC0", "XYZ-5:30",
          "<+03>-3", "CET-1CEST,M3.5.0,M10.5.0/3", "EST5EDT", "NZST-12NZDT,M9.5.0,M4.1.0/3",
          "EST5EDT4", "nonsense", "Europe/Nowhere", "A", "12", "../../../etc/localtime",
          "right/UTC", " UTC"}) {
        setenv("TZ", zone, 1);
        EXPECT_EQ(expectedDates(), realDates(folder)) << zone;
    }
    unsetenv("TZ");
    EXPECT_EQ(expectedDates(), realDates(folder));
}

TEST(AccelDate, IsThatOfDateInLocalesThatAreThereAndThatAreNot)
{
    ScratchFolder const folder;
    char const* const variables[] = {"LC_ALL", "LC_TIME", "LANG", "LC_COLLATE"};
    for (char const* locale : {"C", "POSIX", "C.UTF-8", "xx_YY.UTF-8", "", "/tmp", "../x"})
        for (char const* variable : variables) {
            for (char const* other : variables)
                unsetenv(other);
            setenv("LC_TIME", "C.UTF-8", 1);
            setenv(variable, locale, 1);
            EXPECT_EQ(expectedDates(), realDates(folder)) << variable << '=' << locale;
        }
}

TEST(AccelDate, IsRunOnceAndThenAnswered)
{
    std::string before;
    std::string between;
    do {
        before = real("date");
        between = answered("date").value();
    } while (before != real("date"));
    EXPECT_EQ(between, before);
    answered("date");
    EXPECT_GE(countOf("date").answered, 1U);
    EXPECT_GE(countOf("date").handed_on, 1U); // the hour may have changed
    EXPECT_EQ(bothways::reasonOf("date"), "date runs once an hour, for comparison");
}

TEST(AccelDate, IsRunAgainInAnotherEnvironment)
{
    for (char const* zone : {"Asia/Tokyo", "Europe/Berlin"}) {
        setenv("TZ", zone, 1);
        unsigned long const before = countOf("date").handed_on;
        EXPECT_TRUE(answered("date"));
        EXPECT_EQ(countOf("date").handed_on, before + 1) << zone;
    }
}

/** For as long as it lives, this process has another time than the commands that it runs. */
void shiftClock(std::time_t seconds)
{
    libc::hooks().clock_gettime = [seconds](clockid_t clock, timespec* now) {
        int const result = interpose::real(clock_gettime)(clock, now);
        now->tv_sec += seconds;
        return result;
    };
}

TEST(AccelDate, IsLeftToADateThatPrintsSomethingElse)
{
    setenv("TZ", "UTC0", 1);
    libc::HookGuard const guard;
    shiftClock(2 * day);
    std::string const first = answered("date").value();
    EXPECT_EQ(first.substr(0, 10), real("date").substr(0, 10)) << "not what the real one printed";
    EXPECT_FALSE(answered("date"));
    EXPECT_EQ(bothways::reasonOf("date"), "date printed an unexpected text");
    shiftClock(0); // another hour, so it is compared again
    EXPECT_TRUE(answered("date"));
    EXPECT_TRUE(answered("date"));
}

TEST(AccelDate, IsRunAgainInEveryOtherHour)
{
    setenv("TZ", "UTC0", 1);
    EXPECT_TRUE(answered("date"));
    unsigned long const before = countOf("date").handed_on;
    libc::HookGuard const guard;
    shiftClock(3600);
    EXPECT_TRUE(answered("date"));
    EXPECT_EQ(countOf("date").handed_on, before + 1);
}

} // namespace date_test
