// date, run and answered by the accelerator, compared byte by byte.

#include "mihost/accel/Answers.h"
#include "tests/support/BothWays.h"
#include "tests/support/Lines.h"
#include "tests/support/ScratchFolder.h"

#include <cstdlib>
#include <gtest/gtest.h>

namespace date_test
{

using bothways::answered;
using bothways::countOf;
using bothways::real;

constexpr std::time_t day = 24 * 60 * 60;

/** @return seconds since 1970: all through three years, and some before 1970 and after 2038 */
std::vector<std::time_t> instants()
{
    std::vector<std::time_t> times{-3000000000, -1, 0, 1, 2147483647, 2147483648, 4102444800};
    for (std::time_t const year : {1995, 2026, 2040})
        for (std::time_t half = 0; half < 24; half += year == 2026 ? 1 : 4)
            times.push_back((year - 1970) * 365 * day + (year - 1969) / 4 * day + half * 15 * day +
                            half * 3601);
    return times;
}

/** The dates of all of the instants in the zone and locale of the environment. */
class AccelDates : public testing::Test
{
protected:
    AccelDates()
    {
        for (std::time_t const time : instants_)
            folder_.append("times", '@' + std::to_string(time) + '\n');
    }

    std::string own() const
    {
        std::string text;
        for (std::time_t const time : instants_)
            text += miaccel::dateAt(time);
        return text;
    }

    ScratchFolder const folder_;
    std::vector<std::time_t> const instants_ = instants();
    std::string const command_ = "date -f " + folder_.path("times");
};

TEST_F(AccelDates, AreThoseOfDateInEveryTimeZone)
{
    setenv("LC_ALL", "C", 1);
    Lines const zones = linesOf(
        real("cd /usr/share/zoneinfo; find * -xtype f -not -path 'right/*' -not -path 'posix/*'"));
    EXPECT_GT(zones.size(), 300U);
    std::string script; // one shell for all: starting it takes longer than date itself
    std::string text;
    for (std::string const& zone : zones) {
        script.append("TZ=").append(zone).append(" ").append(command_).append("; ");
        setenv("TZ", zone.c_str(), 1);
        text += own();
    }
    Lines const found = linesOf(text);
    Lines const expected = linesOf(real(script + "true"));
    ASSERT_EQ(found.size(), expected.size());
    for (std::size_t line = 0; line < found.size(); ++line)
        ASSERT_EQ(found[line], expected[line]) << zones[line / instants_.size()];
}

TEST_F(AccelDates, AreThoseOfDateForZonesOfEveryForm)
{
    for (char const* zone :
         {"", ":", ":Europe/Berlin", "/usr/share/zoneinfo/Asia/Tokyo", "UTC0", "XYZ-5:30",
          "<+03>-3", "CET-1CEST,M3.5.0,M10.5.0/3", "EST5EDT", "NZST-12NZDT,M9.5.0,M4.1.0/3",
          "EST5EDT4", "nonsense", "Europe/Nowhere", "A", "12", "../../../etc/localtime",
          "right/UTC", " UTC"}) {
        setenv("TZ", zone, 1);
        EXPECT_EQ(own(), real(command_)) << zone;
    }
    unsetenv("TZ");
    EXPECT_EQ(own(), real(command_));
}

TEST_F(AccelDates, AreThoseOfDateInPresentAndMissingLocales)
{
    char const* const variables[] = {"LC_ALL", "LC_TIME", "LANG", "LC_COLLATE"};
    for (char const* locale : {"C", "POSIX", "C.UTF-8", "xx_YY.UTF-8", "", "/tmp", "../x"})
        for (char const* variable : variables) {
            for (char const* other : variables)
                unsetenv(other);
            setenv("LC_TIME", "C.UTF-8", 1);
            setenv(variable, locale, 1);
            EXPECT_EQ(own(), real(command_)) << variable << '=' << locale;
        }
}

/** @return how many times date is run to answer it once */
unsigned long runsOfDate()
{
    unsigned long const before = countOf("date").ran;
    EXPECT_TRUE(answered("date"));
    return countOf("date").ran - before;
}

/** Until the test ends, gives this process another time than the commands that it runs. */
void shiftClock(std::time_t seconds)
{
    libc::hooks().clock_gettime = [seconds](clockid_t clock, timespec* now) {
        int const result = interpose::real(clock_gettime)(clock, now);
        now->tv_sec += seconds;
        return result;
    };
}

TEST(AccelDate, IsRunOnceAndThenAnswered)
{
    auto const [expected, found] = bothways::dates();
    EXPECT_EQ(found, expected);
    for (int times = 0; times < 2; ++times) // the hour may change
        answered("date");
    EXPECT_GE(countOf("date").answered, 1U);
    EXPECT_GE(countOf("date").ran, 1U);
    EXPECT_EQ(bothways::reasonOf("date"), "date runs once an hour, for comparison");
}

TEST(AccelDate, IsRunAgainInAnotherEnvironmentOrHour)
{
    for (char const* zone : {"Asia/Tokyo", "Europe/Berlin", "UTC0"}) {
        setenv("TZ", zone, 1);
        EXPECT_EQ(runsOfDate(), 1U) << zone;
    }
    shiftClock(3600);
    EXPECT_EQ(runsOfDate(), 1U);
}

TEST(AccelDate, IsLeftToADateThatPrintsSomethingElse)
{
    setenv("TZ", "UTC0", 1);
    shiftClock(2 * day);
    std::string const first = answered("date").value();
    EXPECT_EQ(first.substr(0, 10), real("date").substr(0, 10)) << "not what the real one printed";
    EXPECT_FALSE(answered("date"));
    EXPECT_EQ(bothways::reasonOf("date"), "date printed an unexpected text");
    shiftClock(0); // another hour, so it is compared again
    EXPECT_TRUE(answered("date"));
    EXPECT_TRUE(answered("date"));
}

} // namespace date_test
