#include "sysdata/userInfo_linux.h"

#include "tests/support/FakeCommands.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <string>

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
        useZone("UTC0");
    }

    long days(std::string const& output, long reference, std::string label = "Password expires")
    {
        commands_.answers["chage -l jdoe"] = output;
        char command[] = "chage -l jdoe";
        return NQ::userInfo().getDays(command, label.data(), reference);
    }

    FakeCommands commands_;
    Recording log_;
};

TEST_F(LabelledDays, AreThoseFromTheDateToTheReference)
{
    std::string const first = "Password expires : Jan 01, 2008\n";
    std::string const never = "Password expires : never\n";
    std::string const filler(1023, '.'); // as long as the piece that is read at once
    std::string const backwards = "new_day < last_day";
    std::string const noYear = "Invalid YY: YY = 0";
    struct {
        char const* what;
        std::string output;
        long reference;
        long days;
        Lines errors;
    } const cases[] = {
        {"ten days", first, firstOf2008 + 10 * day, 10, {}},
        {"a second less", first, firstOf2008 + 10 * day - 1, 9, {}},
        {"a second", first, firstOf2008 + 1, 0, {}},
        {"the day itself", first, firstOf2008, 0, {}},
        {"a month before", first, firstOf2008 - 31 * day, 99999, {backwards}},
        {"a second before", first, firstOf2008 - 1, 99999, {backwards}},
        {"the last line counts",
         "Password expires : Dec 01, 2007\n" + first,
         firstOf2008 + 10 * day,
         10,
         {}},
        {"no label: since 1970", "nothing of the kind\n", firstOf2008, 13879, {noYear}},
        {"no output", "", firstOf2008, 13879, {noYear}},
        {"never is not a date",
         never,
         firstOf2008,
         13879,
         {"Invalid format: buffer = " + never, noYear}},
        {"day and year stay, the month is January",
         "Password expires : Mar 11, 2008\n" + never,
         firstOf2008 + 30 * day,
         20,
         {"Invalid format: buffer = " + never}},
        {"a date after an invalid line",
         never + first,
         firstOf2008 + 10 * day,
         10,
         {"Invalid format: buffer = " + never}},
        {"never with a date: 19 January 2038",
         "Password expires : never 01, 2008\n",
         2147472000,
         0,
         {}},
        {"and not a second less",
         "Password expires : never 01, 2008\n",
         2147472000 - 1,
         99999,
         {backwards}},
        {"the second piece of a long line", filler + first, firstOf2008 + 10 * day, 10, {}},
        {"within that piece",
         filler + "." + first,
         firstOf2008,
         13879,
         {"Invalid format: buffer = ." + first, noYear}},
    };
    for (auto const& [what, output, reference, expected, errors] : cases) {
        log_.clear();
        EXPECT_EQ(days(output, reference), expected) << what;
        EXPECT_EQ(log_.texts(6000), errors) << what;
        EXPECT_EQ(commands_.open, 0);
    }
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
}

TEST_F(LabelledDays, Are99999IfTheCommandCannotBeStarted)
{
    char command[] = "chage -l nobody";
    char label[] = "Password expires";
    EXPECT_EQ(NQ::userInfo().getDays(command, label, firstOf2008), 99999);
    EXPECT_EQ(log_.texts(),
              (Lines{"getDays: entry", "Cannot open process: command = chage -l nobody",
                     "getDays: exit"}));
    EXPECT_EQ(log_.texts(6000), Lines{"Cannot open process: command = chage -l nobody"});
}

TEST_F(LabelledDays, ReadTheDateAsLocalTime)
{
    useZone("CET-1");
    EXPECT_EQ(days("Password expires : Jan 01, 2008\n", firstOf2008 - 3600), 0);
    EXPECT_EQ(days("Password expires : Jan 01, 2008\n", firstOf2008 - 3601), 99999);
    useZone("EST5");
    EXPECT_EQ(days("Password expires : Jan 01, 2008\n", firstOf2008 + 5L * 3600), 0);
    EXPECT_EQ(days("Password expires : Jan 01, 2008\n", firstOf2008 + 5L * 3600 - 1), 99999);
    useZone("CET-1CEST,M3.5.0,M10.5.0/3");
    long const march29 = 1206745200; // 2008-03-29 00:00 +0100; the next day has 23 hours
    EXPECT_EQ(days("Password expires : Mar 29, 2008\n", march29 + 2 * day - 3600), 1);
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
