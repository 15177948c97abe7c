#include "util/MyProcess.h"

#include "tests/interpose/Libc.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <climits>
#include <cstdlib>
#include <string>
#include <vector>

namespace dates_test
{

// Zones are given by their rules, so that no time zone files are needed.
constexpr char const* utc = "UTC0";
constexpr char const* centralEurope = "CET-1CEST,M3.5.0,M10.5.0/3";
constexpr char const* newYork = "EST5EDT,M3.2.0,M11.1.0";

time_t named(int year, std::string month, int day, int hour, int minute, int second, int isdst = -1)
{
    return NQ::to_time_t(year, month.data(), day, 0, hour, minute, second, isdst);
}

constexpr time_t hour = 3600;
constexpr time_t day = 24 * hour;

TEST(ToTimeT, ReadsTheFieldsAsLocalTime)
{
    struct {
        char const* zone;
        time_t shift;
    } const zones[] = {{utc, 0}, {newYork, 5 * hour}, {centralEurope, -hour}};
    for (auto const& [zone, shift] : zones) {
        useZone(zone);
        EXPECT_EQ(named(2008, "Dec", 31, 23, 59, 59), 1230767999 + shift) << zone;
    }
}

TEST(ToTimeT, KnowsTheTwelveMonthsByName)
{
    useZone(utc);
    struct {
        char const* name;
        time_t firstOf2009;
    } const months[] = {{"Jan", 1230768000}, {"Feb", 1233446400}, {"Mar", 1235865600},
                        {"Apr", 1238544000}, {"May", 1241136000}, {"Jun", 1243814400},
                        {"Jul", 1246406400}, {"Aug", 1249084800}, {"Sep", 1251763200},
                        {"Oct", 1254355200}, {"Nov", 1257033600}, {"Dec", 1259625600}};
    for (auto const& month : months)
        EXPECT_EQ(named(2009, month.name, 1, 0, 0, 0), month.firstOf2009) << month.name;
}

TEST(ToTimeT, TreatsOtherMonthNamesAsJanuaryWithoutAMessage)
{
    useZone(utc);
    Recording const log;
    for (char const* name :
         {"dec", "DEC", "Dec ", " Dec", "December", "De", "", "   ", "never", "12"})
        EXPECT_EQ(named(2009, name, 1, 0, 0, 0), 1230768000) << '"' << name << '"';
    EXPECT_TRUE(log.remarks().empty());
}

TEST(ToTimeT, RejectsTheYear1900AndEarlierOnesWithAMessage)
{
    useZone(utc);
    for (int const year : {1900, 0, -5, INT_MIN}) {
        Recording const log;
        EXPECT_EQ(named(year, "Jan", 19, 0, 0, 0), 0);
        std::string const complaint = "Invalid YY: YY = " + std::to_string(year);
        EXPECT_EQ(log.texts(), (Lines{"to_time_t: entry", complaint, "to_time_t: exit"}));
        EXPECT_EQ(log.texts(6000), Lines{complaint});
    }
    Recording const log;
    EXPECT_EQ(named(1901, "Dec", 14, 0, 0, 0), -2147472000);
    EXPECT_EQ(log.texts(6000), Lines{});
}

TEST(ToTimeT, CarriesFieldsOutOfRangeOver)
{
    useZone(utc);
    time_t const february = named(2009, "Feb", 1, 0, 0, 0);
    EXPECT_EQ(named(2009, "Jan", 32, 0, 0, 0), february);
    EXPECT_EQ(named(2009, "Feb", 0, 0, 0, 0), february - day);
    EXPECT_EQ(named(2009, "Jan", 31, 24, 0, 0), february);
    EXPECT_EQ(named(2009, "Jan", 31, 23, 60, 0), february);
    EXPECT_EQ(named(2009, "Feb", 1, 0, 0, -1), february - 1);
}

TEST(ToTimeT, IgnoresTheWeekday)
{
    useZone(utc);
    char month[] = "May";
    for (int const weekday : {-1, 0, 1, 6, 7, INT_MAX, INT_MIN})
        EXPECT_EQ(NQ::to_time_t(2010, month, 12, weekday, 10, 23, 45, -1), 1273659825);
}

TEST(ToTimeT, LeavesSummerTimeToTheSystemUnlessItIsGiven)
{
    useZone(centralEurope);
    constexpr time_t may = 1273659825 - 2 * hour;
    constexpr time_t january = 1263291825 - hour;
    EXPECT_EQ(named(2010, "May", 12, 10, 23, 45, -1), may);
    EXPECT_EQ(named(2010, "Jan", 12, 10, 23, 45, -1), january);
    EXPECT_EQ(named(2010, "May", 12, 10, 23, 45, 0), may + hour);
    EXPECT_EQ(named(2010, "Jan", 12, 10, 23, 45, 0), january);
    EXPECT_EQ(named(2010, "Jan", 12, 10, 23, 45, 1), january - hour);
}

TEST(ToTimeT, YieldsZeroForADateThatCannotBeRepresented)
{
    useZone(utc);
    Recording const log;
    EXPECT_EQ(named(INT_MAX, "Dec", INT_MAX, INT_MAX, INT_MAX, INT_MAX), 0);
    EXPECT_TRUE(log.texts(6000).empty());
}

TEST(ToTimeT, CannotTellTheSecondBefore1970FromAFailure)
{
    useZone(utc);
    EXPECT_EQ(named(1969, "Dec", 31, 23, 59, 58), -2);
    EXPECT_EQ(named(1969, "Dec", 31, 23, 59, 59), 0);
    EXPECT_EQ(named(1970, "Jan", 1, 0, 0, 0), 0);
}

TEST(ItoTimeT, EqualsTheConversionByName)
{
    useZone(centralEurope);
    char const* const names[] = {"Jan", "Feb", "Mar", "Apr", "May", "Jun",
                                 "Jul", "Aug", "Sep", "Oct", "Nov", "Dec"};
    for (int month = 1; month <= 12; ++month)
        EXPECT_EQ(NQ::ito_time_t(2011, month, 5, 3, 6, 7, 8, -1),
                  named(2011, names[month - 1], 5, 6, 7, 8))
            << month;
}

TEST(ItoTimeT, PassesTheOtherArgumentsOnInTheirOrder)
{
    useZone(utc);
    // 3 February 2009 05:06:07; 4 would be a Thursday, but the date is a Tuesday.
    EXPECT_EQ(NQ::ito_time_t(2009, 2, 3, 4, 5, 6, 7, 0), 1233637567);
}

TEST(ItoTimeT, TreatsOtherMonthNumbersAsJanuary)
{
    useZone(utc);
    for (int const month : {0, -1, 13, INT_MAX, INT_MIN})
        EXPECT_EQ(NQ::ito_time_t(2009, month, 1, 0, 0, 0, 0, -1), 1230768000) << month;
}

TEST(ItoTimeT, LogsAroundTheConversionByName)
{
    useZone(utc);
    Recording const log;
    NQ::ito_time_t(1900, 1, 1, 0, 0, 0, 0, -1);
    EXPECT_EQ(log.texts(), (Lines{"ito_time_t: entry", "to_time_t: entry", "Invalid YY: YY = 1900",
                                  "to_time_t: exit", "ito_time_t: exit"}));
    EXPECT_EQ(log.sources(), (Lines{"ito_time_t MyProcess Veltrix.IC.MI.OsSwMI.MyProcess",
                                    "to_time_t MyProcess Veltrix.IC.MI.OsSwMI.MyProcess"}));
}

TEST(ToTimeT, DoesNotCallMktimeForYearsUpTo1900)
{
    useZone("AAA0");
    setenv("TZ", "BBB0", 1); // which mktime would notice
    named(1900, "Jan", 1, 0, 0, 0);
    EXPECT_STREQ(tzname[0], "AAA");
    named(1901, "Jan", 1, 0, 0, 0);
    EXPECT_STREQ(tzname[0], "BBB");
}

TEST(ToTimeT, PassesEveryFieldButTheDayOfTheYearToMktime)
{
    std::tm passed{};
    libc::hooks().mktime = [&passed](std::tm* fields) {
        passed = *fields;
        return time_t{1};
    };
    char month[] = "Mar";
    EXPECT_EQ(NQ::to_time_t(2010, month, 12, 5, 10, 23, 45, 1), 1);
    EXPECT_EQ((std::vector<int>{passed.tm_year, passed.tm_mon, passed.tm_mday, passed.tm_wday,
                                passed.tm_hour, passed.tm_min, passed.tm_sec, passed.tm_isdst}),
              (std::vector<int>{110, 2, 12, 5, 10, 23, 45, 1}));
}

} // namespace dates_test
