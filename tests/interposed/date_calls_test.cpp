// The order and the arguments of calls of the date conversions, which a host may replace.

#include "util/MyProcess.h"

#include "sysdata/logInfo_linux.h"
#include "sysdata/userInfo_linux.h"
#include "tests/interpose/Real.h"
#include "tests/interposed/StandIns.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/SystemLog.h"

#include <gtest/gtest.h>

#include <initializer_list>
#include <string>
#include <vector>

namespace
{

using Calls = std::vector<std::string>;

Calls& conversions()
{
    static Calls calls;
    return calls;
}

void note(std::string call, std::string const& month, std::initializer_list<int> others)
{
    call += " " + month;
    for (int const other : others)
        call += " " + std::to_string(other);
    conversions().push_back(call);
}

} // namespace

time_t NQ::to_time_t(int year, char* month, int day, int weekday, int hour, int minute, int second,
                     int isdst)
{
    static auto* const real = interpose::real(NQ::to_time_t);
    note("by name " + std::to_string(year), month, {day, weekday, hour, minute, second, isdst});
    return real(year, month, day, weekday, hour, minute, second, isdst);
}

time_t NQ::ito_time_t(int year, int month, int day, int weekday, int hour, int minute, int second,
                      int isdst)
{
    static auto* const real = interpose::real(NQ::ito_time_t);
    note("by number " + std::to_string(year), std::to_string(month),
         {day, weekday, hour, minute, second, isdst});
    return real(year, month, day, weekday, hour, minute, second, isdst);
}

namespace
{

class DateCalls : public testing::Test
{
protected:
    DateCalls()
    {
        conversions().clear();
    }

    FakeFiles const files_;
    FakeCommands commands_;
};

TEST_F(DateCalls, ByNumberPassTheirArgumentsOnByName)
{
    NQ::ito_time_t(2009, 2, 3, 4, 5, 6, 7, 0);
    NQ::ito_time_t(2009, 0, 3, 4, 5, 6, 7, 1);
    EXPECT_EQ(conversions(), (Calls{"by number 2009 2 3 4 5 6 7 0", "by name 2009 Feb 3 4 5 6 7 0",
                                    "by number 2009 0 3 4 5 6 7 1",
                                    "by name 2009     3 4 5 6 7 1"})); // three blanks
}

TEST_F(DateCalls, OfTheInstallDateLeaveSummerTimeToTheSystem)
{
    files_.write("/etc/redhat-release", "");
    commands_.answers["stat /etc/redhat-release | grep Change"] = "Change: 2010-05-12 10:23:45\n";
    long date = 0;
    EXPECT_TRUE(realGetInstallDate(date));
    EXPECT_EQ(conversions().at(0), "by number 2010 5 12 0 10 23 45 -1");
}

TEST_F(DateCalls, OfALogEntryLeaveSummerTimeToTheSystem)
{
    commands_.answers = systemLog::answers({"Nov 20 10:11:12 host"});
    long time = 0;
    EXPECT_TRUE(NQ::logInfo().getCreationTime(time, 1));
    EXPECT_EQ(conversions(), Calls{"by name 2026 Nov 20 0 10 11 12 -1"});
}

TEST_F(DateCalls, OfAUsersDatesAreAtMidnight)
{
    NQ::userInfo user("jdoe");
    user.setPwdInactDays(99999);
    user.setPwdInactDays(14000);
    user.setLstPwdChg(14000);
    EXPECT_EQ(conversions(),
              (Calls{"by name 2038 Jan 19 0 0 0 0 -1", "by name 1970 Jan 1 0 0 0 0 -1",
                     "by number 1970 1 1 0 0 0 0 -1", "by name 1970 Jan 1 0 0 0 0 -1"}));
}

TEST_F(DateCalls, OfAnAgeingDateAreByNumberAndOfChageByName)
{
    commands_.answers["chage -l jdoe"] = "Password expires : Mar 02, 2008\n"
                                         "Last password change : Feb 01, 2008\n";
    NQ::userInfo user;
    user.setInactivityTimeout("2008-12-31 00:00:00", "jdoe");
    user.setPasswordExpiration("2008-12-31 00:00:00", "jdoe");
    EXPECT_EQ(conversions(),
              (Calls{"by number 2008 12 31 0 0 0 0 -1", "by name 2008 Dec 31 0 0 0 0 -1",
                     "by name 2008 Mar 2 0 0 0 0 -1", "by number 2008 12 31 0 0 0 0 -1",
                     "by name 2008 Dec 31 0 0 0 0 -1", "by name 2008 Feb 1 0 0 0 0 -1"}));
}

} // namespace
