#include "sysdata/userInfo_linux.h"

#include "tests/support/FakeCommands.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <string>
#include <vector>

namespace user_days_test
{

constexpr long firstOf2008 = 1199145600; // 1 January 2008, 00:00 UTC
constexpr long day = 86400;

/** Days to a labelled date, with chage replaced by its output. */
class LabelledDays : public testing::Test
{
protected:
    LabelledDays()
    {
        setZone("UTC0");
    }

    static void setZone(char const* zone)
    {
        useZone(zone);
    }

    long days(std::string const& output, long reference, std::string label = "Password expires")
    {
        commands_.answers["chage -l jdoe"] = output;
        char command[] = "chage -l jdoe";
        return NQ::userInfo().getDays(command, label.data(), reference);
    }

    Lines errors() const
    {
        return log_.texts(6000);
    }

    FakeCommands commands_;
    Recording log_;
};

TEST_F(LabelledDays, AreThoseFromTheDateToTheReference)
{
    EXPECT_EQ(days("Password expires : Jan 01, 2008\n", firstOf2008 + 10 * day), 10);
    EXPECT_EQ(errors(), Lines{});
}

TEST_F(LabelledDays, AreReadFromWhatChagePrints)
{
    std::string const output = "Last password change\t\t\t\t\t: Dec 22, 2007\n"
                               "Password expires\t\t\t\t\t: Jan 01, 2008\n"
                               "Password inactive\t\t\t\t\t: never\n"
                               "Account expires\t\t\t\t\t\t: never\n"
                               "Minimum number of days between password change\t\t: 0\n";
    EXPECT_EQ(days(output, firstOf2008 + 10 * day), 10);
    EXPECT_EQ(days(output, firstOf2008 + 10 * day, "Last password change"), 20);
    EXPECT_EQ(errors(), Lines{});
}

TEST_F(LabelledDays, AreWholeDaysOnly)
{
    EXPECT_EQ(days("Password expires : Jan 01, 2008\n", firstOf2008 + 10 * day - 1), 9);
    EXPECT_EQ(days("Password expires : Jan 01, 2008\n", firstOf2008 + 1), 0);
}

TEST_F(LabelledDays, AreNoneOnTheDayItself)
{
    EXPECT_EQ(days("Password expires : Jan 01, 2008\n", firstOf2008), 0);
    EXPECT_EQ(errors(), Lines{});
}

TEST_F(LabelledDays, Are99999IfTheDateIsAfterTheReference)
{
    EXPECT_EQ(days("Password expires : Jan 01, 2008\n", firstOf2008 - 31 * day), 99999);
    EXPECT_EQ(errors(), Lines{"new_day < last_day"});
}

TEST_F(LabelledDays, Are99999IfTheDateIsOneSecondAfterTheReference)
{
    EXPECT_EQ(days("Password expires : Jan 01, 2008\n", firstOf2008 - 1), 99999);
    EXPECT_EQ(errors(), Lines{"new_day < last_day"});
}

TEST_F(LabelledDays, Are99999IfTheCommandCannotBeStarted)
{
    char command[] = "chage -l nobody";
    char label[] = "Password expires";
    EXPECT_EQ(NQ::userInfo().getDays(command, label, firstOf2008), 99999);
    EXPECT_EQ(log_.texts(),
              (Lines{"getDays: entry", "Cannot open process: command = chage -l nobody",
                     "getDays: exit"}));
    EXPECT_EQ(errors(), Lines{"Cannot open process: command = chage -l nobody"});
}

TEST_F(LabelledDays, ReadTheDateAsLocalTime)
{
    setZone("CET-1");
    EXPECT_EQ(days("Password expires : Jan 01, 2008\n", firstOf2008 - 3600), 0);
    EXPECT_EQ(days("Password expires : Jan 01, 2008\n", firstOf2008 - 3601), 99999);
    setZone("EST5");
    EXPECT_EQ(days("Password expires : Jan 01, 2008\n", firstOf2008 + 5L * 3600), 0);
    EXPECT_EQ(days("Password expires : Jan 01, 2008\n", firstOf2008 + 5L * 3600 - 1), 99999);
}

TEST_F(LabelledDays, LoseTheShortDayOfTheChangeToSummerTime)
{
    setZone("CET-1CEST,M3.5.0,M10.5.0/3");
    long const march29 = 1206745200; // 2008-03-29 00:00 +0100
    EXPECT_EQ(days("Password expires : Mar 29, 2008\n", march29 + 2 * day - 3600), 1);
}

TEST_F(LabelledDays, AreCountedFromTheLastLineWithTheLabel)
{
    EXPECT_EQ(days("Password expires : Dec 01, 2007\nPassword expires : Jan 01, 2008\n",
                   firstOf2008 + 10 * day),
              10);
}

TEST_F(LabelledDays, AreCountedSince1970IfNoLineHasTheLabel)
{
    EXPECT_EQ(days("nothing of the kind\n", firstOf2008), 13879);
    EXPECT_EQ(errors(), Lines{"Invalid YY: YY = 0"});
}

TEST_F(LabelledDays, AreCountedSince1970WithoutOutput)
{
    EXPECT_EQ(days("", firstOf2008), 13879);
}

TEST_F(LabelledDays, TreatTheWordNeverAsAnInvalidDate)
{
    EXPECT_EQ(days("Password expires\t: never\n", firstOf2008), 13879);
    EXPECT_EQ(errors(), (Lines{"Invalid format: buffer = Password expires\t: never\n",
                               "Invalid YY: YY = 0"}));
}

TEST_F(LabelledDays, KeepDayAndYearIfAnInvalidLineFollows)
{
    // The month is then none of the twelve, which counts as January.
    EXPECT_EQ(
        days("Password expires : Mar 11, 2008\nPassword expires : never\n", firstOf2008 + 30 * day),
        20);
    EXPECT_EQ(errors(), Lines{"Invalid format: buffer = Password expires : never\n"});
}

TEST_F(LabelledDays, ContinueAfterAnInvalidLine)
{
    EXPECT_EQ(
        days("Password expires : never\nPassword expires : Jan 01, 2008\n", firstOf2008 + 10 * day),
        10);
}

TEST_F(LabelledDays, CountTo19January2038IfADateFollowsNever)
{
    EXPECT_EQ(days("Password expires : never 01, 2008\n", 2147472000), 0);
    EXPECT_EQ(days("Password expires : never 01, 2008\n", 2147472000 - 1), 99999);
}

TEST_F(LabelledDays, AreReadFromPiecesOf1023BytesOfALongLine)
{
    std::string const filler(1023, '.');
    EXPECT_EQ(days(filler + "Password expires : Jan 01, 2008\n", firstOf2008 + 10 * day), 10);
    EXPECT_EQ(days(filler + "." + "Password expires : Jan 01, 2008\n", firstOf2008), 13879);
}

TEST_F(LabelledDays, CloseTheCommandsPipe)
{
    days("Password expires : Jan 01, 2008\n", firstOf2008);
    EXPECT_EQ(commands_.open, 0);
}

TEST_F(LabelledDays, ConvertTheDateOnceAtTheEndOfTheOutput)
{
    days("Password expires : never\nPassword expires : Jan 01, 2008\n", firstOf2008 - 1);
    EXPECT_EQ(
        log_.texts(),
        (Lines{"getDays: entry", "Invalid format: buffer = Password expires : never\n",
               "to_time_t: entry", "to_time_t: exit", "new_day < last_day", "getDays: exit"}));
    LogRecord const complaint = log_.records().at(2);
    EXPECT_EQ(complaint.text, "Invalid format: buffer = Password expires : never\n");
    EXPECT_EQ(complaint.function, "getDays");
    EXPECT_EQ(complaint.file, "userInfo_linux");
    EXPECT_EQ(complaint.category, "Veltrix.IC.MI.OsSwMI.UserInfo");
    EXPECT_EQ(complaint.level, 6000);
}

} // namespace user_days_test
