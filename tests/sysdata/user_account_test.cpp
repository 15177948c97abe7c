#include "sysdata/userInfo_linux.h"

#include "tests/interpose/Libc.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace user_account_test
{

using NQ::userInfo;

/** Account operations; the commands that they run are only recorded. */
class AccountOperation : public testing::Test
{
protected:
    AccountOperation()
    {
        useZone("UTC0");
    }

    Lines errors() const
    {
        return log_.texts(6000);
    }

    FakeCommands commands_;
    Recording log_;
};

using UserDeletion = AccountOperation;

TEST_F(UserDeletion, RunsUserdelWithTheNameAndReturnsOne)
{
    commands_.answers["userdel -r jdoe"] = "";
    EXPECT_EQ(userInfo().setDelete("jdoe"), 1);
    EXPECT_EQ(commands_.ran, Lines{"userdel -r jdoe"});
    EXPECT_EQ(commands_.modes, Lines{"r"});
    EXPECT_EQ(commands_.open, 0);
    EXPECT_EQ(log_.texts(), (Lines{"setDelete: entry", "setDelete: exit"}));
}

TEST_F(UserDeletion, ReturnsOneIfTheCommandCannotBeStarted)
{
    EXPECT_EQ(userInfo().setDelete("jdoe"), 1);
    EXPECT_EQ(errors(), Lines{"Cannot open process: command = userdel -r jdoe"});
    EXPECT_EQ(log_.sources(), Lines{"setDelete userInfo_linux Veltrix.IC.MI.OsSwMI.UserInfo"});
}

TEST_F(UserDeletion, RunsALineOf1023BytesAndNoLongerOne)
{
    std::string const name(1023 - 11, 'x');
    EXPECT_EQ(userInfo().setDelete(name), 1);
    EXPECT_EQ(commands_.ran, Lines{"userdel -r " + name});
    log_.clear();
    EXPECT_EQ(userInfo().setDelete(name + "x"), 1);
    EXPECT_EQ(commands_.ran.size(), 1U);
    EXPECT_EQ(errors(), Lines{"Command does not fit: userdel -r"});
}

/** What one ageing operation runs and says; the date is 11 January 2008. */
struct Ageing {
    char const* function;
    bool (userInfo::*set)(std::string date, std::string user);
    char const* label;
    char const* option;
    char const* cannotStart; // as logged for jdoe, 10 days
};

class AgeingOperation : public AccountOperation, public testing::WithParamInterface<Ageing>
{
protected:
    bool set(std::string const& date, std::string const& user = "jdoe")
    {
        return (userInfo().*GetParam().set)(date, user);
    }

    /** Lets chage report the day that the age is counted from. */
    void answerListing(std::string const& date, std::string const& user = "jdoe")
    {
        commands_.answers["chage -l " + user] =
            std::string(GetParam().label) + "\t\t\t: " + date + "\n";
    }

    std::string ageLine(std::string const& days, std::string const& user = "jdoe") const
    {
        return std::string("chage ") + GetParam().option + " " + days + " " + user;
    }
};

TEST_P(AgeingOperation, SetsTheDaysFromTheListedDateToTheGivenOne)
{
    answerListing("Jan 01, 2008");
    commands_.answers[ageLine("10")] = "chage: user 'jdoe' does not exist in /etc/passwd\n";
    commands_.status = 1 << 8; // neither output nor status counts
    EXPECT_TRUE(set("2008-01-11 00:00:00"));
    EXPECT_EQ(commands_.ran, (Lines{"chage -l jdoe", ageLine("10")}));
    EXPECT_EQ(commands_.modes, (Lines{"r", "r"}));
    EXPECT_EQ(commands_.open, 0);
    std::string const function = GetParam().function;
    EXPECT_EQ(log_.texts(3000),
              (Lines{function + ": entry", "ito_time_t: entry", "to_time_t: entry",
                     "to_time_t: exit", "ito_time_t: exit", "getDays: entry", "to_time_t: entry",
                     "to_time_t: exit", "getDays: exit", function + ": exit"}));
    EXPECT_EQ(errors(), Lines{});
}

TEST_P(AgeingOperation, ReadsOnlyItsOwnLabel)
{
    commands_.answers["chage -l jdoe"] = "Last password change : Jan 01, 2008\n"
                                         "Password expires : Jan 01, 2008\n"
                                         "Password inactive : Jan 05, 2008\n"
                                         "Account expires : Jan 06, 2008\n";
    commands_.answers[ageLine("10")] = "";
    EXPECT_TRUE(set("2008-01-11 00:00:00"));
    EXPECT_EQ(commands_.ran.back(), ageLine("10"));
    commands_.answers["chage -l jdoe"] = "Password inactive : Jan 05, 2008\n";
    set("2008-01-11 00:00:00");
    EXPECT_EQ(commands_.ran.back(), ageLine("13889"));
}

TEST_P(AgeingOperation, CountsTheDaysFromTheListedDateInLocalTime)
{
    struct {
        char const* what;
        char const* zone;
        char const* listed;
        char const* given;
        char const* days;
        Lines errors;
    } const cases[] = {
        {"an earlier date",
         "UTC0",
         "Feb 01, 2008",
         "2008-01-11 00:00:00",
         "99999",
         {"new_day < last_day"}},
        {"no date, which is 1970",
         "UTC0",
         "Jan 01, 2008",
         "tomorrow",
         "99999",
         {"Invalid YY: YY = 0", "new_day < last_day"}},
        {"two days that lack the hour of the change to summer time",
         "CET-1CEST,M3.5.0,M10.5.0/3",
         "Mar 29, 2008",
         "2008-03-31 00:00:00",
         "1",
         {}},
        {"two days that lack one second",
         "AAA0BBB-0:00:01,M3.5.0,M10.5.0",
         "Mar 29, 2008",
         "2008-03-31 00:00:00",
         "1",
         {}},
        {"neither zeros nor time of day", "UTC0", "Jan 01, 2008", "2008-1-11", "10", {}},
        {"two digits of the day", "UTC0", "Jan 01, 2008", "2008-01-111", "10", {}},
        {"December, and no day: the last of November",
         "UTC0",
         "Jan 01, 2008",
         "2008-123-1",
         "334",
         {}},
        {"the year 2008, no month (January) and no day (the day before)",
         "UTC0",
         "Jan 01, 2008",
         "20081-01-1",
         "99999",
         {"new_day < last_day"}},
    };
    for (auto const& [what, zone, listed, given, days, errors] : cases) {
        useZone(zone);
        answerListing(listed);
        commands_.answers[ageLine(days)] = "";
        log_.clear();
        EXPECT_TRUE(set(given)) << what;
        EXPECT_EQ(commands_.ran.back(), ageLine(days)) << what;
        EXPECT_EQ(log_.texts(6000), errors) << what;
    }
}

TEST_P(AgeingOperation, Sets99999IfChageCannotList)
{
    commands_.answers[ageLine("99999")] = "";
    EXPECT_TRUE(set("2008-01-11 00:00:00"));
    EXPECT_EQ(commands_.ran, (Lines{"chage -l jdoe", ageLine("99999")}));
    EXPECT_EQ(errors(), Lines{"Cannot open process: command = chage -l jdoe"});
}

TEST_P(AgeingOperation, FailsIfTheChangeCannotBeStarted)
{
    answerListing("Jan 01, 2008");
    EXPECT_FALSE(set("2008-01-11 00:00:00"));
    EXPECT_EQ(errors(), Lines{GetParam().cannotStart});
    LogRecord const last = log_.records().at(log_.records().size() - 3);
    EXPECT_EQ(last.text, GetParam().cannotStart);
    EXPECT_EQ(last.function, GetParam().function);
}

TEST_P(AgeingOperation, RunsNothingIfTheListingExceeds1024Bytes)
{
    EXPECT_FALSE(set("2008-01-11 00:00:00", std::string(1024 - 9, 'x')));
    EXPECT_EQ(commands_.ran, Lines{});
    EXPECT_EQ(errors(), Lines{"Command does not fit: chage -l"});
}

TEST_P(AgeingOperation, RunsAChangeThatFills1024BytesAndNoLongerOne)
{
    std::string const longest(1023 - 12, 'x');
    for (std::string const& user : {longest, longest + "x"}) {
        answerListing("Jan 01, 2008", user);
        commands_.answers[ageLine("10", user)] = "";
        commands_.ran.clear();
        log_.clear();
        bool const fits = user == longest;
        EXPECT_EQ(set("2008-01-11 00:00:00", user), fits);
        EXPECT_EQ(commands_.ran.size(), fits ? 2U : 1U);
        EXPECT_EQ(errors(),
                  fits ? Lines{}
                       : Lines{std::string("Command does not fit: chage ") + GetParam().option});
    }
}

INSTANTIATE_TEST_SUITE_P(
    Of, AgeingOperation,
    testing::Values(Ageing{"setInactivityTimeout", &userInfo::setInactivityTimeout,
                           "Password expires", "-I",
                           "Cannot open process: command = chage -I 10 jdoe"},
                    Ageing{"setPasswordExpiration", &userInfo::setPasswordExpiration,
                           "Last password change", "-M", "Cannot open process: chage -M"}),
    [](auto const& of) { return of.param.function; });

struct Outcome {
    bool result;
    std::string output;
};

/** Runs "tool" with arguments; the first entry of the list, the program, is not used. */
Outcome runTool(std::vector<char const*> args, std::string command = "/usr/bin/tool")
{
    std::vector<char> output(20000, '#');
    args.push_back("");
    bool const result = userInfo().executeLinCommand(command.data(), args.data(), output.data());
    return {result, std::string(output.data())};
}

using CommandRunner = AccountOperation;

TEST_F(CommandRunner, AppendsArgumentsUpToAnEmptyOne)
{
    commands_.answers["/usr/bin/tool -a b c 2>&1"] = "said\n";
    Outcome const outcome = runTool({"ignored", "-a", "b c", "", "d"});
    EXPECT_TRUE(outcome.result);
    EXPECT_EQ(outcome.output, "said\n");
    EXPECT_EQ(commands_.modes, Lines{"r"});
    EXPECT_EQ(commands_.open, 0);
    EXPECT_EQ(log_.texts(), (Lines{"executeLinCommand: entry", "executeLinCommand: exit"}));
}

TEST_F(CommandRunner, CopiesWhatFollowsANulByteToo)
{
    commands_.answers["/usr/bin/tool 2>&1"] = std::string("one\0two", 7);
    char command[] = "/usr/bin/tool";
    char const* const args[] = {command, ""};
    char output[9] = {'#', '#', '#', '#', '#', '#', '#', '#', '#'};
    EXPECT_TRUE(userInfo().executeLinCommand(command, args, output));
    EXPECT_EQ(std::string(output, sizeof output), std::string("one\0two\0#", 9));
}

TEST_F(CommandRunner, CopiesTheOutputAndIsTrueIfThereIsAny)
{
    commands_.status = 1 << 8;
    for (std::string const& output : {std::string(), std::string("x"), std::string(15000, 'o')}) {
        commands_.answers["/usr/bin/tool 2>&1"] = output;
        Outcome const outcome = runTool({"ignored"});
        EXPECT_EQ(outcome.result, !output.empty());
        EXPECT_EQ(outcome.output, output);
        EXPECT_EQ(commands_.open, 0);
    }
}

TEST_F(CommandRunner, IsFalseForACommandThatCannotBeStarted)
{
    Outcome const outcome = runTool({"ignored"});
    EXPECT_FALSE(outcome.result);
    EXPECT_EQ(outcome.output, "");
    EXPECT_EQ(errors(), Lines{"Cannot open process: /usr/bin/tool"});
    char user[] = "jdoe";
    EXPECT_FALSE(userInfo().findIsAcctDisabled(user));
}

TEST_F(CommandRunner, RunsALineOf4999BytesAndNoLongerOne)
{
    std::string const argument(4999 - 13 - 1 - 5, 'x');
    runTool({"ignored", argument.c_str()});
    EXPECT_EQ(commands_.ran, Lines{"/usr/bin/tool " + argument + " 2>&1"});
    log_.clear();
    EXPECT_FALSE(runTool({"ignored", (argument + "x").c_str()}).result);
    EXPECT_EQ(commands_.ran.size(), 1U);
    EXPECT_EQ(errors(), Lines{"Command does not fit: /usr/bin/tool"});
}

/** Queries whether jdoe is locked, with a given answer of passwd. */
class AccountLock : public AccountOperation
{
protected:
    bool locked(std::string const& output)
    {
        commands_.answers["/usr/bin/passwd -S jdoe 2>&1"] = output;
        char user[] = "jdoe";
        return userInfo().findIsAcctDisabled(user);
    }

    FakeFiles const files_;
};

TEST_F(AccountLock, IsReadFromPasswd)
{
    locked("jdoe PS");
    EXPECT_EQ(commands_.ran, Lines{"/usr/bin/passwd -S jdoe 2>&1"});
    EXPECT_EQ(log_.texts(), (Lines{"findIsAcctDisabled: entry", "executeLinCommand: entry",
                                   "executeLinCommand: exit", "findIsAcctDisabled: exit"}));
}

TEST_F(AccountLock, IsFoundAsWordsAnywhereInTheOutput)
{
    EXPECT_TRUE(locked("jdoe LK 2008-01-01 (Password locked.)\n"));
    EXPECT_TRUE(locked("Locked password.\n"));
    for (char const* output : {"jdoe LK 2008-01-01 0 99999 7 -1\n",
                               "jdoe PS (Password set, MD5 crypt.)\n", "password locked", ""})
        EXPECT_FALSE(locked(output)) << output;
}

TEST_F(AccountLock, IsFoundAfterTheNameOnASuseSystem)
{
    for (char const* release : {"/etc/SuSE-release", "/etc/UnitedLinux-release"}) {
        files_.write(release, "");
        for (char const* output : {"jdoe LK 01/01/2008 0 99999 7 -1\n", "jdoe LKx"})
            EXPECT_TRUE(locked(output)) << release << output;
        for (char const* output :
             {"jdoe L", "jdoe PS 01/01/2008\n", " jdoe LK", "jdoes LK", "Password locked", ""})
            EXPECT_FALSE(locked(output)) << release << output;
        files_.remove(release);
    }
}

TEST_F(AccountLock, IsFoundInTheFirst4999BytesOfAnyAmountOfOutput)
{
    std::string const mark = "Password locked";
    std::string const rest(1000000, 'x');
    EXPECT_TRUE(locked(std::string(4999 - mark.size(), '.') + mark + rest));
    EXPECT_FALSE(locked(std::string(5000 - mark.size(), '.') + mark + rest));
    EXPECT_EQ(commands_.open, 0);
}

TEST_F(AccountLock, LooksForTheSecondReleaseFileOnlyWithoutTheFirst)
{
    Lines opened;
    libc::hooks().fopen.watch(
        [&opened](char const* path, char const*) { opened.emplace_back(path); });
    locked("jdoe PS");
    EXPECT_EQ(opened, (Lines{"/etc/SuSE-release", "/etc/UnitedLinux-release"}));
    files_.write("/etc/SuSE-release", "");
    opened.clear();
    locked("jdoe PS");
    EXPECT_EQ(opened, Lines{"/etc/SuSE-release"});
}

TEST_F(AccountOperation, DoesNotChangeTheRecord)
{
    userInfo user("jdoe");
    user.setUserPassword("secret");
    user.setPwdMaxDays(90);
    user.setPwdExpDays(30);
    commands_.otherwise = "Password expires : Jan 01, 2008\nLast password change : Jan 01, 2008\n";
    user.setInactivityTimeout("2008-01-11 00:00:00", "jdoe");
    user.setPasswordExpiration("2008-01-11 00:00:00", "jdoe");
    user.setDelete("jdoe");
    EXPECT_EQ(user.getUserName(), "jdoe");
    EXPECT_EQ(user.getUserPassword(), "secret");
    EXPECT_EQ(user.getPwdMaxDays(), 90U);
    EXPECT_EQ(user.getPwdExpDays(), 30U);
    EXPECT_FALSE(user.IsDelete());
}

TEST_F(AccountLock, LogsAtLevel3000UnderTheUnitsName)
{
    commands_.otherwise = "";
    char command[] = "chage -l jdoe";
    char label[] = "Password expires";
    char user[] = "jdoe";
    userInfo info;
    info.setDelete(user);
    info.setInactivityTimeout("2008-01-11 00:00:00", user);
    info.setPasswordExpiration("2008-01-11 00:00:00", user);
    info.getDays(command, label, 0);
    info.findIsAcctDisabled(user);
    for (LogRecord const& record : log_.records()) {
        if (record.file == "MyProcess")
            continue; // the date conversions
        EXPECT_EQ(record.level, 3000) << record.text;
        EXPECT_EQ(record.file, "userInfo_linux");
        EXPECT_EQ(record.category, "Veltrix.IC.MI.OsSwMI.UserInfo");
        EXPECT_EQ(record.function, record.text.substr(0, record.text.find(':')));
    }
}

} // namespace user_account_test
