#include "sysdata/logInfo_linux.h"
#include "tests/interpose/Libc.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/Insides.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"
#include "tests/support/SystemLog.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <cstring>
#include <ctime>
#include <fcntl.h>
#include <string>
#include <sys/stat.h>
#include <vector>

namespace log_reader_test
{

using NQ::logInfo;

constexpr auto& wc = systemLog::count;
constexpr auto sed = systemLog::line;

/** Seconds since 1970 of a day in UTC. */
long at(int year, int month, int day, int hour, int minute, int second)
{
    std::tm fields{};
    fields.tm_year = year - 1900;
    fields.tm_mon = month - 1;
    fields.tm_mday = day;
    fields.tm_hour = hour;
    fields.tm_min = minute;
    fields.tm_sec = second;
    return static_cast<long>(timegm(&fields));
}

/** A log of 10 lines, of which only line 10 can be fetched. */
class LogReader : public testing::Test
{
protected:
    LogReader()
    {
        useZone("UTC0");
        commands.answers = {{wc, "10 /var/log/messages\n"},
                            {sed(10), "Nov 20 10:11:12 host sshd[1]: session opened\n"},
                            {"date", "Sat Nov 21 03:15:30 UTC 2026\n"}};
    }

    /** The whole buffer of this length after getLog. */
    std::string fetched(unsigned int line, std::size_t length)
    {
        std::string buffer(length, '#');
        log.getLog(line, buffer.data(), static_cast<int>(length));
        return buffer;
    }

    std::string data(unsigned int index)
    {
        std::string text = "unset";
        EXPECT_TRUE(log.getData(text, index));
        return text;
    }

    long timeOf(unsigned int index)
    {
        long time = -1;
        EXPECT_TRUE(log.getCreationTime(time, index));
        return time;
    }

    FakeCommands commands;
    logInfo log;
};

TEST_F(LogReader, IsMadeAndDestroyedWithoutAMessage)
{
    Recording const recording;
    {
        logInfo const another;
    }
    EXPECT_TRUE(recording.records().empty());
    EXPECT_TRUE(commands.ran.empty());
}

TEST_F(LogReader, CountsTheLines)
{
    Recording const recording;
    EXPECT_EQ(log.getMaxLine(), 10U);
    EXPECT_EQ(commands.ran, Lines{wc});
    EXPECT_EQ(commands.modes, Lines{"r"});
    EXPECT_EQ(commands.open, 0);
    EXPECT_EQ(recording.texts(),
              (Lines{"getMaxLine: entry", "buffer = 10 /var/log/messages\n", "getMaxLine: exit"}));
    EXPECT_EQ(recording.texts(3000).size(), 3U);
}

TEST_F(LogReader, CountsNothingWhenWcCannotBeStarted)
{
    commands.answers.clear();
    Recording const recording;
    EXPECT_EQ(log.getMaxLine(), 0U);
    EXPECT_EQ(recording.texts(6000), Lines{"Cannot open process: wc -l /var/log/messages"});
    EXPECT_EQ(recording.texts(3000), (Lines{"getMaxLine: entry", "getMaxLine: exit"}));
}

TEST_F(LogReader, CountsByTheNumberThatBeginsTheFirstLine)
{
    struct {
        std::string output;
        unsigned int count;
        Lines errors;
    } const cases[] = {
        {"3 a\n10 b\n", 3, {}},
        {"what is this 10\n", 0, {"Invalid format: buffer = what is this 10\n"}},
        {"", 0, {"Invalid format: buffer = "}},
    };
    for (auto const& [output, count, errors] : cases) {
        commands.answers[wc] = output;
        Recording const recording;
        EXPECT_EQ(log.getMaxLine(), count) << output;
        EXPECT_EQ(recording.texts(6000), errors);
        EXPECT_TRUE(recording.has("buffer = " + output.substr(0, output.find('\n') + 1), 3000));
    }
}

TEST_F(LogReader, LogsUnderItsUnitAndCategory)
{
    commands.answers.erase("date");
    Recording const recording;
    std::string text;
    long time = 0;
    log.getMaxLine();
    log.getData(text, 12);
    log.getCreationTime(time, 12);
    log.getCreationTime(time, 1);
    char letters[] = "a";
    log.strreplace(letters, 'x', 'y');
    std::string const unit = " logInfo_linux Veltrix.IC.MI.OsSwMI.LogInfo";
    std::string const other = " MyProcess Veltrix.IC.MI.OsSwMI.MyProcess";
    EXPECT_EQ(recording.sources(), (Lines{"getCreationTime" + unit, "getData" + unit,
                                          "getLog" + unit, "getMaxLine" + unit, "strget" + other,
                                          "strreplace" + unit, "to_time_t" + other}));
}

TEST_F(LogReader, FetchesOneLineByItsNumber)
{
    commands.answers[sed(3)] = "third line\n";
    Recording const recording;
    EXPECT_STREQ(fetched(3, 100).c_str(), "third line");
    EXPECT_EQ(commands.ran, Lines{"sed -n '3p' /var/log/messages"});
    EXPECT_EQ(commands.modes, Lines{"r"});
    EXPECT_EQ(commands.open, 0);
    EXPECT_EQ(recording.texts(3000), (Lines{"getLog: entry", "buffer = third line\n",
                                            "strget: entry", "strget: exit", "getLog: exit"}));
    EXPECT_EQ(recording.texts(6000), Lines{});
}

TEST_F(LogReader, FillsTheBufferWithTheLineAndThenWithNul)
{
    struct {
        char const* what;
        std::string line;
        std::size_t length;
        std::string buffer;
    } const cases[] = {
        {"only leading spaces are stripped", "   \t third line \r\n", 20,
         std::string("\t third line \r\0\0\0\0\0", 20)},
        {"the rest is NUL", "abc\n", 600, "abc" + std::string(597, '\0')},
        {"no terminator", "abcdef\n", 6, "abcdef"},
        {"a short buffer", "abcdef\n", 4, "abcd"},
        {"one byte", "abcdef\n", 1, "a"},
        {"511 characters at most", std::string(700, 'x') + "\n", 600,
         std::string(511, 'x') + std::string(89, '\0')},
    };
    for (auto const& [what, line, length, buffer] : cases) {
        commands.answers[sed(3)] = line;
        EXPECT_EQ(fetched(3, length), buffer) << what;
    }
}

TEST_F(LogReader, ReadsAMissingLineAsEmpty)
{
    commands.answers[sed(11)] = "";
    Recording const recording;
    EXPECT_EQ(fetched(11, 8), std::string(8, '\0'));
    EXPECT_EQ(recording.remarks(), Lines{"buffer = "});
}

TEST_F(LogReader, ReadsALineAsEmptyIfReadingFails)
{
    libc::hooks().fgets = [](char* buffer, int, FILE*) -> char* {
        std::strcpy(buffer, "7 left over"); // after a failure the content is unspecified
        return nullptr;
    };
    EXPECT_EQ(log.getMaxLine(), 0U);
    EXPECT_EQ(fetched(10, 8), std::string(8, '\0'));
    commands.answers[sed(0)] = "not read\n";
    EXPECT_EQ(data(1), "**");
    libc::hooks().fgets = nullptr;
}

TEST_F(LogReader, EmptiesTheBufferWhenSedCannotBeStarted)
{
    Recording recording;
    EXPECT_EQ(fetched(4, 3), std::string("\0##", 3));
    EXPECT_EQ(recording.texts(6000), Lines{"sed -n '%dp' /var/log/messages"});
    EXPECT_EQ(recording.texts(3000), (Lines{"getLog: entry", "getLog: exit"}));
    EXPECT_EQ(commands.ran, Lines{"sed -n '4p' /var/log/messages"});
    recording.clear();
    commands.answers.erase(sed(10));
    EXPECT_EQ(data(1), "**");
    EXPECT_EQ(recording.texts(6000), Lines{"sed -n '%dp' /var/log/messages"});
}

TEST_F(LogReader, YieldsMessagesFromTheEndBetweenAsterisks)
{
    EXPECT_EQ(data(1), "*host sshd[1]: session opened*");
    commands.answers[sed(8)] = "Nov 20 10:11:12 third from the end\n";
    EXPECT_EQ(data(3), "*third from the end*");
    commands.answers[sed(1)] = "Nov 20 10:11:12 the oldest\n";
    EXPECT_EQ(data(10), "*the oldest*");
}

TEST_F(LogReader, NamesRefusesAndFetchesByThreeCounts)
{
    commands.first[wc] = {"10 f\n", "11 f\n", "12 f\n"};
    commands.answers[sed(12)] = "Nov  3 01:02:03 newest of all\n";
    EXPECT_EQ(data(1), "*newest of all*");
    commands.first[wc] = {"10 f\n", "11 f\n", "12 f\n"};
    EXPECT_EQ(timeOf(1), at(2026, 11, 3, 1, 2, 3));
    commands.first[wc] = {"12 f\n", "10 f\n"};
    Recording const recording;
    std::string text;
    EXPECT_FALSE(log.getData(text, 12));
    EXPECT_EQ(recording.texts(6000), Lines{"Invalid index: getMaxLine()=12, Index=12"});
}

TEST_F(LogReader, AcceptsTheIndexesNextToTheLogAsEmpty)
{
    for (auto const& [index, line] : {std::pair{11U, 0U}, {0U, 11U}}) {
        commands.answers[sed(line)] = "";
        commands.ran.clear();
        EXPECT_EQ(data(index), "**");
        EXPECT_EQ(commands.ran, (Lines{wc, wc, wc, sed(line)}));
        long time = 5;
        EXPECT_FALSE(log.getCreationTime(time, index));
        EXPECT_EQ(time, 5);
    }
}

TEST_F(LogReader, RefusesTheNextIndexAndKeepsTextAndTime)
{
    Recording recording;
    std::string text = "before";
    EXPECT_FALSE(log.getData(text, 12));
    EXPECT_EQ(text, "before");
    EXPECT_EQ(commands.ran, (Lines{wc, wc}));
    EXPECT_EQ(recording.texts(6000), Lines{"Invalid index: getMaxLine()=10, Index=12"});
    EXPECT_EQ(recording.texts().back(), "getData: exit");
    EXPECT_EQ(recording.records()[recording.records().size() - 3].function, "getData");
    recording.clear();
    long time = 5;
    EXPECT_FALSE(log.getCreationTime(time, 12));
    EXPECT_EQ(time, 5);
    EXPECT_EQ(commands.ran, Lines(4, wc));
    EXPECT_EQ(recording.texts(6000), Lines{"Invalid index: getMaxLine()=10, logIndex=12"});
}

TEST_F(LogReader, RefusesIndexesAboveOneOfAnUncountableLog)
{
    commands.answers[wc] = "";
    commands.answers[sed(0)] = "";
    std::string text;
    EXPECT_TRUE(log.getData(text, 1));
    EXPECT_EQ(text, "**");
    EXPECT_FALSE(log.getData(text, 2));
    Recording const recording;
    EXPECT_FALSE(log.getData(text, 4294967295U));
    EXPECT_TRUE(recording.has("Invalid index: getMaxLine()=0, Index=4294967295", 6000));
}

TEST_F(LogReader, YieldsWhatFollowsTheFirstSixteenCharacters)
{
    std::string bytes;
    for (int byte = 1; byte < 256; ++byte)
        if (byte != '\n')
            bytes.push_back(static_cast<char>(byte));
    struct {
        std::string line;
        std::string message;
    } const cases[] = {
        {"\n", ""},
        {"short\n", ""},
        {"Nov 20 10:11:12\n", ""},
        {"Nov 20 10:11:12 \n", ""},
        {"123456789012345\n", ""},
        {"1234567890123456x\n", "x"},
        {"2026-11-20T10:11:12.000000+00:00 host sshd\n", ":12.000000+00:00 host sshd"},
        {"Nov 20 10:11:12 " + std::string(700, 'm') + "\n", std::string(495, 'm')},
        {std::string("Nov 20 10:11:12 ab\0cd\n", 22), "ab"},
        {"Nov 20 10:11:12 " + bytes, bytes},
    };
    for (auto const& [line, message] : cases) {
        commands.answers[sed(10)] = line;
        EXPECT_EQ(data(1), "*" + message + "*") << line;
    }
}

TEST_F(LogReader, LogsEveryStepOfAMessageAndOfATimeInOrder)
{
    Recording recording;
    data(1);
    Lines expected{"getData: entry"};
    for (int i = 0; i < 3; ++i)
        for (char const* text :
             {"getMaxLine: entry", "buffer = 10 /var/log/messages\n", "getMaxLine: exit"})
            expected.emplace_back(text);
    for (char const* text :
         {"getLog: entry", "buffer = Nov 20 10:11:12 host sshd[1]: session opened\n",
          "strget: entry", "strget: exit", "getLog: exit", "getData: exit"})
        expected.emplace_back(text);
    EXPECT_EQ(recording.texts(), expected);
    EXPECT_EQ(commands.ran, (Lines{wc, wc, wc, sed(10)}));
    EXPECT_EQ(commands.modes, Lines(4, "r"));
    EXPECT_EQ(commands.open, 0);

    recording.clear();
    timeOf(1);
    expected.front() = "getCreationTime: entry"; // then the same, and the conversion
    expected.back() = "to_time_t: entry";
    expected.emplace_back("to_time_t: exit");
    expected.emplace_back("getCreationTime: exit");
    EXPECT_EQ(recording.texts(), expected);
}

TEST_F(LogReader, ReadsATimeStampInTheYearOfTheDate)
{
    struct {
        char const* line;
        char const* date;
        char const* zone;
        long time;
    } const cases[] = {
        {"Nov 20 10:11:12 host\n", "Sat Nov 21 03:15:30 UTC 2026\n", "UTC0",
         at(2026, 11, 20, 10, 11, 12)},
        {"Nov 20 10:11:12 host\n", "Sat Nov 21 03:15:30 UTC 2026\n", "CET-1CEST,M3.5.0,M10.5.0/3",
         at(2026, 11, 20, 9, 11, 12)},
        {"Jul  2 10:11:12 host\n", "Sat Nov 21 03:15:30 UTC 2026\n", "CET-1CEST,M3.5.0,M10.5.0/3",
         at(2026, 7, 2, 8, 11, 12)},
        // December read in January is of the year before, but never the other way round.
        {"Dec 31 23:59:59 host\n", "Fri Jan  2 03:15:30 UTC 2026\n", "UTC0",
         at(2025, 12, 31, 23, 59, 59)},
        {"Jan  1 00:00:01 host\n", "Thu Dec 31 03:15:30 UTC 2026\n", "UTC0",
         at(2026, 1, 1, 0, 0, 1)},
        {"Nov 30 10:11:12 host\n", "Fri Jan  2 03:15:30 UTC 2026\n", "UTC0",
         at(2026, 11, 30, 10, 11, 12)},
        {"Feb 29 12:00:00 host\n", "Sat Nov 21 03:15:30 UTC 2026\n", "UTC0", // has 28 days
         at(2026, 3, 1, 12, 0, 0)},
        // Only fifteen characters are read: the last digit is the sixteenth.
        {"Nov  20 10:11:12 host\n", "Sat Nov 21 03:15:30 UTC 2026\n", "UTC0",
         at(2026, 11, 20, 10, 11, 1)},
    };
    for (auto const& [line, date, zone, time] : cases) {
        useZone(zone);
        commands.answers[sed(10)] = line;
        commands.answers["date"] = date;
        EXPECT_EQ(timeOf(1), time) << line << date << zone;
    }
}

TEST_F(LogReader, RunsThreeCountsOneFetchAndOneDateForATime)
{
    std::vector<int> sizes; // of the buffer for each line
    libc::hooks().fgets.watch([&sizes](char*, int size, FILE*) { sizes.push_back(size); });
    timeOf(1);
    EXPECT_EQ(commands.ran, (Lines{wc, wc, wc, sed(10), "date"}));
    EXPECT_EQ(commands.modes, Lines(5, "r"));
    EXPECT_EQ(commands.open, 0);
    EXPECT_EQ(sizes, std::vector<int>(5, 512));
}

TEST_F(LogReader, FindsNoTimeInAnotherStampAndRunsNoDate)
{
    for (std::string const stamp : {"2026-11-20T10:1", "November 20 10:"}) {
        commands.answers[sed(10)] = stamp + "1:12.000000+00:00 host sshd\n";
        commands.ran.clear();
        Recording const recording;
        long time = 5;
        EXPECT_FALSE(log.getCreationTime(time, 1));
        EXPECT_EQ(time, 5);
        EXPECT_EQ(recording.texts(6000), Lines{"Invalid format: buffer = " + stamp});
        EXPECT_EQ(commands.ran, (Lines{wc, wc, wc, sed(10)}));
    }
}

TEST_F(LogReader, DatesAnEntryToZeroWithoutADateOrAYear)
{
    commands.answers["date"] = "Sat Nov 21 03:15:30 UTC 1900\n";
    Recording recording;
    EXPECT_EQ(timeOf(1), 0);
    EXPECT_EQ(recording.texts(6000), Lines{"Invalid YY: YY = 1900"});
    commands.answers.erase("date");
    recording.clear();
    EXPECT_EQ(timeOf(1), 0);
    EXPECT_EQ(recording.texts(6000), (Lines{"Cannot opne process: date", "Invalid YY: YY = 0"}));
}

TEST_F(LogReader, FindsNoTimeWhenDatePrintsAnotherForm)
{
    for (std::string const line : {"", "\n", "2026\n", "Sat Nov 21 03:15:30 UTC\n", " \n"}) {
        commands.answers["date"] = line;
        Recording const recording;
        long time = 5;
        EXPECT_FALSE(log.getCreationTime(time, 1)) << line;
        EXPECT_EQ(time, 5) << line;
        EXPECT_EQ(recording.texts(6000), Lines{"Invalid format: buffer = " + line});
        EXPECT_EQ(commands.open, 0);
    }
}

TEST_F(LogReader, SurvivesBinaryGarbageFromEveryCommand)
{
    std::string garbage;
    for (unsigned int i = 0; i < 5000; ++i)
        garbage.push_back(static_cast<char>((i * 7919U) >> 3));
    commands.answers[sed(10)] = garbage;
    data(1);
    long time = 0;
    log.getCreationTime(time, 1);
    commands.answers[sed(10)] = "Nov 20 10:11:12 host\n";
    for (std::string const& date :
         {garbage, std::string("Sat Jan 1 0 -2147483648\n"), std::string("a b 99999999999999\n"),
          std::string("\0 \0", 3), std::string(" "), std::string(2000, ' ')}) {
        commands.answers["date"] = date;
        log.getCreationTime(time, 1);
    }
    commands.answers[sed(10)] = "Dec 20 10:11:12 host\n";
    commands.answers["date"] = "Sat Jan 1 0 -2147483648\n";
    EXPECT_EQ(timeOf(1), 0);
    commands.answers[wc] = garbage;
    log.getMaxLine();
    EXPECT_EQ(commands.open, 0);
}

class LogClearing : public testing::Test
{
protected:
    FakeFiles files;
    FakeCommands commands;
};

TEST_F(LogClearing, TruncatesTheFileAndKeepsItAndItsPermissions)
{
    files.write("/var/log/messages", "one\ntwo\n");
    std::string const path = files.realPath("/var/log/messages");
    ASSERT_EQ(chmod(path.c_str(), 0640), 0);
    struct stat before {
    };
    struct stat after {
    };
    ASSERT_EQ(stat(path.c_str(), &before), 0);
    Recording const recording;
    EXPECT_TRUE(logInfo().clearLog());
    ASSERT_EQ(stat(path.c_str(), &after), 0);
    EXPECT_EQ(after.st_size, 0);
    EXPECT_EQ(after.st_ino, before.st_ino);
    EXPECT_EQ(after.st_mode, before.st_mode);
    EXPECT_TRUE(commands.ran.empty());
    EXPECT_EQ(recording.texts(3000), (Lines{"clearLog: entry", "clearLog: exit"}));
    EXPECT_EQ(recording.sources(), Lines{"clearLog logInfo_linux Veltrix.IC.MI.OsSwMI.LogInfo"});
}

TEST_F(LogClearing, OpensTheLogForWritingAndClosesIt)
{
    Lines opened;
    int descriptor = -1;
    libc::hooks().fopen = [&](char const* path, char const* mode) {
        opened.push_back(std::string(path) + "|" + mode);
        FILE* const stream = std::tmpfile();
        descriptor = fileno(stream);
        return stream;
    };
    EXPECT_TRUE(logInfo().clearLog());
    EXPECT_EQ(opened, Lines{"/var/log/messages|w"});
    EXPECT_EQ(fcntl(descriptor, F_GETFD), -1);
}

TEST_F(LogClearing, FailsWithoutAMessageIfTheFileCannotBeOpened)
{
    Recording const recording;
    EXPECT_FALSE(logInfo().clearLog()); // its directory is missing
    EXPECT_EQ(recording.texts(), (Lines{"clearLog: entry", "clearLog: exit"}));
}

TEST_F(LogReader, LogsTheExitOfEveryReadOfATime)
{
    auto const expectBothEnds = [this](unsigned int index) {
        Recording const recording;
        long time = 0;
        log.getCreationTime(time, index);
        Lines const said = recording.texts(3000);
        EXPECT_EQ(said.front(), "getCreationTime: entry");
        EXPECT_EQ(said.back(), "getCreationTime: exit");
    };
    expectBothEnds(12); // refused
    expectBothEnds(1);
    commands.answers["date"] = "2026\n"; // in another form
    expectBothEnds(1);
    commands.answers.erase("date"); // not started
    expectBothEnds(1);
    commands.answers[sed(10)] = "short\n"; // no stamp
    expectBothEnds(1);
}

TEST_F(LogReader, UsesNeitherItsStringNorTheStatusOfCommands)
{
    std::string& member = onlyMember(log);
    EXPECT_EQ(member, "");
    for (std::string const content : {"", "something else"}) {
        member = content;
        EXPECT_EQ(log.getMaxLine(), 10U);
        EXPECT_EQ(data(1), "*host sshd[1]: session opened*");
        EXPECT_EQ(timeOf(1), at(2026, 11, 20, 10, 11, 12));
        char letters[] = "a-b";
        log.strreplace(letters, '-', ' ');
        EXPECT_STREQ(letters, "a b");
        EXPECT_EQ(member, content);
        commands.status = 1 << 8;
    }
}

} // namespace log_reader_test
