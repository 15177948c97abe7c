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

#include <cstdlib>
#include <cstring>
#include <ctime>
#include <fcntl.h>
#include <iterator>
#include <set>
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

TEST_F(LogReader, HasTheSizeOfOneString)
{
    EXPECT_EQ(sizeof(logInfo), sizeof(std::string));
}

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

TEST_F(LogReader, CountsNothingInOutputThatIsNotANumber)
{
    commands.answers[wc] = "what is this 10\n";
    Recording const recording;
    EXPECT_EQ(log.getMaxLine(), 0U);
    EXPECT_EQ(recording.texts(6000), Lines{"Invalid format: buffer = what is this 10\n"});
    EXPECT_TRUE(recording.has("buffer = what is this 10\n", 3000));
}

TEST_F(LogReader, CountsNothingWhenWcPrintsNothing)
{
    commands.answers[wc] = "";
    Recording const recording;
    EXPECT_EQ(log.getMaxLine(), 0U);
    EXPECT_EQ(recording.remarks(), (Lines{"buffer = ", "Invalid format: buffer = "}));
}

TEST_F(LogReader, ReadsOnlyTheFirstLineOfWc)
{
    commands.answers[wc] = "3 a\n10 b\n";
    EXPECT_EQ(log.getMaxLine(), 3U);
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
    std::set<std::string> functions;
    for (LogRecord const& record : recording.records()) {
        if (record.function == "strget" || record.function == "to_time_t")
            continue;
        functions.insert(record.function);
        EXPECT_EQ(record.file, "logInfo_linux");
        EXPECT_EQ(record.category, "Veltrix.IC.MI.OsSwMI.LogInfo");
    }
    EXPECT_EQ(functions, (std::set<std::string>{"getMaxLine", "getData", "getLog",
                                                "getCreationTime", "strreplace"}));
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

TEST_F(LogReader, StripsLeadingSpacesOfALineAndNothingElse)
{
    commands.answers[sed(3)] = "   \t third line \r\n";
    EXPECT_STREQ(fetched(3, 100).c_str(), "\t third line \r");
}

TEST_F(LogReader, FillsTheRestOfTheBufferWithNul)
{
    commands.answers[sed(3)] = "abc\n";
    EXPECT_EQ(fetched(3, 600), "abc" + std::string(597, '\0'));
}

TEST_F(LogReader, AddsNoTerminatorWhenTheTextFillsTheLength)
{
    commands.answers[sed(3)] = "abcdef\n";
    EXPECT_EQ(fetched(3, 6), "abcdef");
    EXPECT_EQ(fetched(3, 4), "abcd");
    EXPECT_EQ(fetched(3, 1), "a");
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

TEST_F(LogReader, CutsALineAt511Characters)
{
    commands.answers[sed(3)] = std::string(700, 'x') + "\n";
    EXPECT_EQ(fetched(3, 600), std::string(511, 'x') + std::string(89, '\0'));
}

TEST_F(LogReader, EmptiesTheBufferWhenSedCannotBeStarted)
{
    Recording const recording;
    EXPECT_EQ(fetched(4, 3), std::string("\0##", 3));
    EXPECT_EQ(recording.texts(6000), Lines{"sed -n '%dp' /var/log/messages"});
    EXPECT_EQ(recording.texts(3000), (Lines{"getLog: entry", "getLog: exit"}));
    EXPECT_EQ(commands.ran, Lines{"sed -n '4p' /var/log/messages"});
}

TEST_F(LogReader, YieldsTheNewestMessageBetweenAsterisks)
{
    EXPECT_EQ(data(1), "*host sshd[1]: session opened*");
}

TEST_F(LogReader, CountsIndexesFromTheEndOfTheFile)
{
    commands.answers[sed(8)] = "Nov 20 10:11:12 third from the end\n";
    EXPECT_EQ(data(3), "*third from the end*");
    commands.answers[sed(1)] = "Nov 20 10:11:12 the oldest\n";
    EXPECT_EQ(data(10), "*the oldest*");
}

TEST_F(LogReader, RunsThreeCountsAndOneFetchForAMessage)
{
    data(1);
    EXPECT_EQ(commands.ran, (Lines{wc, wc, wc, sed(10)}));
    EXPECT_EQ(commands.modes, Lines(4, "r"));
    EXPECT_EQ(commands.open, 0);
}

TEST_F(LogReader, RunsTwoCountsForAMessageThatIsRefused)
{
    std::string text;
    EXPECT_FALSE(log.getData(text, 12));
    EXPECT_EQ(commands.ran, (Lines{wc, wc}));
}

TEST_F(LogReader, FetchesTheLineThatTheLastCountNames)
{
    commands.first[wc] = {"10 f\n", "11 f\n", "12 f\n"};
    commands.answers[sed(12)] = "Nov 20 10:11:12 newest of all\n";
    EXPECT_EQ(data(1), "*newest of all*");
}

TEST_F(LogReader, NamesTheFirstCountAndRefusesByTheSecond)
{
    commands.first[wc] = {"12 f\n", "10 f\n"};
    Recording const recording;
    std::string text;
    EXPECT_FALSE(log.getData(text, 12));
    EXPECT_EQ(recording.texts(6000), Lines{"Invalid index: getMaxLine()=12, Index=12"});
}

TEST_F(LogReader, AcceptsTheIndexAfterTheOldestLineAsEmpty)
{
    commands.answers[sed(0)] = "";
    EXPECT_EQ(data(11), "**");
    EXPECT_EQ(commands.ran, (Lines{wc, wc, wc, "sed -n '0p' /var/log/messages"}));
}

TEST_F(LogReader, AcceptsTheIndexZeroAsEmpty)
{
    commands.answers[sed(11)] = "";
    EXPECT_EQ(data(0), "**");
    EXPECT_EQ(commands.ran.back(), "sed -n '11p' /var/log/messages");
}

TEST_F(LogReader, RefusesTheNextIndexAndKeepsTheText)
{
    Recording const recording;
    std::string text = "before";
    EXPECT_FALSE(log.getData(text, 12));
    EXPECT_EQ(text, "before");
    EXPECT_EQ(recording.texts(6000), Lines{"Invalid index: getMaxLine()=10, Index=12"});
    EXPECT_EQ(recording.texts().back(), "getData: exit");
    EXPECT_EQ(recording.records()[recording.records().size() - 3].function, "getData");
}

TEST_F(LogReader, RefusesIndexesAboveOneOfAnUncountableLog)
{
    commands.answers[wc] = "";
    commands.answers[sed(0)] = "";
    std::string text;
    EXPECT_TRUE(log.getData(text, 1));
    EXPECT_EQ(text, "**");
    EXPECT_FALSE(log.getData(text, 2));
    EXPECT_FALSE(log.getData(text, 4294967295U));
}

TEST_F(LogReader, YieldsAnEmptyMessageForALineWithoutOne)
{
    for (char const* line :
         {"\n", "short\n", "Nov 20 10:11:12\n", "Nov 20 10:11:12 \n", "123456789012345\n"}) {
        commands.answers[sed(10)] = line;
        EXPECT_EQ(data(1), "**") << line;
    }
}

TEST_F(LogReader, DropsSixteenCharactersWhateverTheyAre)
{
    commands.answers[sed(10)] = "2026-11-20T10:11:12.000000+00:00 host sshd\n";
    EXPECT_EQ(data(1), "*:12.000000+00:00 host sshd*");
    commands.answers[sed(10)] = "1234567890123456x\n";
    EXPECT_EQ(data(1), "*x*");
}

TEST_F(LogReader, CutsAMessageAt495Characters)
{
    commands.answers[sed(10)] = "Nov 20 10:11:12 " + std::string(700, 'm') + "\n";
    EXPECT_EQ(data(1), "*" + std::string(495, 'm') + "*");
}

TEST_F(LogReader, YieldsAnEmptyMessageWhenSedCannotBeStarted)
{
    commands.answers.erase(sed(10));
    Recording const recording;
    EXPECT_EQ(data(1), "**");
    EXPECT_EQ(recording.texts(6000), Lines{"sed -n '%dp' /var/log/messages"});
}

TEST_F(LogReader, EndsAMessageAtANulByte)
{
    commands.answers[sed(10)] = std::string("Nov 20 10:11:12 ab\0cd\n", 22);
    EXPECT_EQ(data(1), "*ab*");
}

TEST_F(LogReader, PassesOnBytesOfAnyKind)
{
    std::string bytes;
    for (int byte = 1; byte < 256; ++byte)
        if (byte != '\n')
            bytes.push_back(static_cast<char>(byte));
    commands.answers[sed(10)] = "Nov 20 10:11:12 " + bytes;
    EXPECT_EQ(data(1), "*" + bytes + "*");
}

TEST_F(LogReader, LogsEveryStepOfAMessageInOrder)
{
    Recording const recording;
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
    EXPECT_EQ(recording.texts(3000), expected);
    EXPECT_EQ(recording.texts(6000), Lines{});
}

TEST_F(LogReader, ReadsATimeStampInTheCurrentYear)
{
    EXPECT_EQ(timeOf(1), at(2026, 11, 20, 10, 11, 12));
}

TEST_F(LogReader, RunsThreeCountsOneFetchAndOneDateForATime)
{
    timeOf(1);
    EXPECT_EQ(commands.ran, (Lines{wc, wc, wc, sed(10), "date"}));
    EXPECT_EQ(commands.modes, Lines(5, "r"));
    EXPECT_EQ(commands.open, 0);
}

TEST_F(LogReader, ReadsEachCommandsLineIntoABufferOf512Bytes)
{
    std::vector<int> sizes;
    libc::hooks().fgets = [&sizes](char* buffer, int size, FILE* stream) {
        sizes.push_back(size);
        return interpose::real(fgets)(buffer, size, stream);
    };
    timeOf(1);
    libc::hooks().fgets = nullptr;
    EXPECT_EQ(sizes, std::vector<int>(5, 512)); // three counts, the line and the date
}

TEST_F(LogReader, ReadsATimeStampAsLocalTime)
{
    useZone("CET-1CEST,M3.5.0,M10.5.0/3");
    EXPECT_EQ(timeOf(1), at(2026, 11, 20, 9, 11, 12));
    commands.answers[sed(10)] = "Jul  2 10:11:12 host\n";
    EXPECT_EQ(timeOf(1), at(2026, 7, 2, 8, 11, 12));
}

TEST_F(LogReader, DatesDecemberReadInJanuaryBack)
{
    commands.answers[sed(10)] = "Dec 31 23:59:59 host\n";
    commands.answers["date"] = "Fri Jan  2 03:15:30 UTC 2026\n";
    EXPECT_EQ(timeOf(1), at(2025, 12, 31, 23, 59, 59));
}

TEST_F(LogReader, LeavesJanuaryReadInDecemberInTheCurrentYear)
{
    commands.answers[sed(10)] = "Jan  1 00:00:01 host\n";
    commands.answers["date"] = "Thu Dec 31 03:15:30 UTC 2026\n";
    EXPECT_EQ(timeOf(1), at(2026, 1, 1, 0, 0, 1));
}

TEST_F(LogReader, CountsTheIndexOfATimeAsThatOfAMessage)
{
    commands.answers[sed(8)] = "Nov  3 01:02:03 third from the end\n";
    EXPECT_EQ(timeOf(3), at(2026, 11, 3, 1, 2, 3));
    commands.first[wc] = {"10 f\n", "11 f\n", "8 f\n"};
    EXPECT_EQ(timeOf(1), at(2026, 11, 3, 1, 2, 3));
}

TEST_F(LogReader, RefusesATimeByAnIndexOutOfRange)
{
    Recording const recording;
    long time = 5;
    EXPECT_FALSE(log.getCreationTime(time, 12));
    EXPECT_EQ(time, 5);
    EXPECT_EQ(recording.texts(6000), Lines{"Invalid index: getMaxLine()=10, logIndex=12"});
    EXPECT_EQ(commands.ran, (Lines{wc, wc}));
}

TEST_F(LogReader, FindsNoTimeInTheLinesThatItAcceptsBeyondTheLog)
{
    commands.answers[sed(0)] = "";
    commands.answers[sed(11)] = "";
    long time = 5;
    EXPECT_FALSE(log.getCreationTime(time, 11));
    EXPECT_FALSE(log.getCreationTime(time, 0));
    EXPECT_EQ(time, 5);
}

TEST_F(LogReader, FindsNoTimeInAnotherStampAndRunsNoDate)
{
    commands.answers[sed(10)] = "2026-11-20T10:11:12.000000+00:00 host sshd\n";
    Recording const recording;
    long time = 5;
    EXPECT_FALSE(log.getCreationTime(time, 1));
    EXPECT_EQ(time, 5);
    EXPECT_EQ(recording.texts(6000), Lines{"Invalid format: buffer = 2026-11-20T10:1"});
    EXPECT_EQ(commands.ran, (Lines{wc, wc, wc, sed(10)}));
}

TEST_F(LogReader, ReadsATimeFromFifteenCharactersOnly)
{
    commands.answers[sed(10)] = "Nov  20 10:11:12 host\n"; // the last digit is the sixteenth
    EXPECT_EQ(timeOf(1), at(2026, 11, 20, 10, 11, 1));
    commands.answers[sed(10)] = "November 20 10:11:12 host\n";
    long time = 5;
    EXPECT_FALSE(log.getCreationTime(time, 1));
}

TEST_F(LogReader, DatesAnEntryToZeroIfDateCannotBeStarted)
{
    commands.answers.erase("date");
    Recording const recording;
    EXPECT_EQ(timeOf(1), 0);
    EXPECT_EQ(recording.texts(6000), (Lines{"Cannot opne process: date", "Invalid YY: YY = 0"}));
}

TEST_F(LogReader, FindsNoTimeWhenDatePrintsAnotherForm)
{
    for (char const* line : {"", "\n", "2026\n", "Sat Nov 21 03:15:30 UTC\n", " \n"}) {
        commands.answers["date"] = line;
        Recording const recording;
        long time = 5;
        EXPECT_FALSE(log.getCreationTime(time, 1)) << line;
        EXPECT_EQ(time, 5) << line;
        EXPECT_EQ(recording.texts(6000), Lines{std::string("Invalid format: buffer = ") + line});
        EXPECT_EQ(commands.open, 0);
    }
}

TEST_F(LogReader, DatesAnEntryToZeroIfTheYearIsTooEarly)
{
    commands.answers["date"] = "Sat Nov 21 03:15:30 UTC 1900\n";
    Recording const recording;
    EXPECT_EQ(timeOf(1), 0);
    EXPECT_EQ(recording.texts(6000), Lines{"Invalid YY: YY = 1900"});
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
    std::string contents() const
    {
        return contentOf(files.realPath("/var/log/messages"));
    }

    FakeFiles files;
    FakeCommands commands;
};

TEST_F(LogClearing, TruncatesTheFileWithoutAnyCommand)
{
    files.write("/var/log/messages", "one\ntwo\n");
    Recording const recording;
    EXPECT_TRUE(logInfo().clearLog());
    EXPECT_EQ(contents(), "");
    EXPECT_TRUE(commands.ran.empty());
    EXPECT_EQ(recording.texts(), (Lines{"clearLog: entry", "clearLog: exit"}));
}

TEST_F(LogClearing, KeepsTheFileAndItsPermissions)
{
    files.write("/var/log/messages", "one\n");
    std::string const path = files.realPath("/var/log/messages");
    ASSERT_EQ(chmod(path.c_str(), 0640), 0);
    struct stat before {
    };
    struct stat after {
    };
    ASSERT_EQ(stat(path.c_str(), &before), 0);
    EXPECT_TRUE(logInfo().clearLog());
    ASSERT_EQ(stat(path.c_str(), &after), 0);
    EXPECT_EQ(after.st_size, 0);
    EXPECT_EQ(after.st_ino, before.st_ino);
    EXPECT_EQ(after.st_mode, before.st_mode);
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
    files.write("/var/log/messages", "one\n");
    libc::hooks().fopen = [](char const*, char const*) -> FILE* { return nullptr; };
    Recording const recording;
    EXPECT_FALSE(logInfo().clearLog());
    libc::hooks().fopen = nullptr;
    EXPECT_EQ(contents(), "one\n");
    EXPECT_EQ(recording.texts(), (Lines{"clearLog: entry", "clearLog: exit"}));
}

TEST_F(LogClearing, FailsWithoutTheDirectory)
{
    EXPECT_FALSE(logInfo().clearLog());
}

std::string replaced(std::string text, char from, char to)
{
    logInfo().strreplace(text.data(), from, to);
    return text;
}

TEST(LogStrreplace, KeepsTheFirstCharacter)
{
    EXPECT_EQ(replaced("-a-b-", '-', ' '), "-a b ");
    EXPECT_EQ(replaced("-", '-', ' '), "-");
}

TEST(LogStrreplace, StopsAtTheFirstReplacementByNul)
{
    char text[] = "abcbd";
    logInfo().strreplace(text, 'b', '\0');
    EXPECT_EQ(std::string(text, 5), std::string("a\0cbd", 5));
}

TEST(LogStrreplace, KeepsAnEmptyText)
{
    char text[] = {'\0', '-', '\0'};
    logInfo().strreplace(text, '-', ' ');
    EXPECT_EQ(std::string(text, 2), std::string("\0-", 2));
}

TEST(LogStrreplace, LogsEntryAndExit)
{
    Recording const recording;
    replaced("a-b", '-', ' ');
    EXPECT_EQ(recording.texts(3000), (Lines{"strreplace: entry", "strreplace: exit"}));
}

TEST_F(LogClearing, LogsUnderItsUnitAndCategory)
{
    files.write("/var/log/messages", "one\n");
    Recording const recording;
    logInfo().clearLog();
    ASSERT_EQ(recording.records().size(), 4U);
    for (LogRecord const& record : recording.records()) {
        EXPECT_EQ(record.function, "clearLog");
        EXPECT_EQ(record.file, "logInfo_linux");
        EXPECT_EQ(record.category, "Veltrix.IC.MI.OsSwMI.LogInfo");
        EXPECT_EQ(record.level, 3000);
    }
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

TEST_F(LogReader, NeitherReadsNorWritesItsString)
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
    }
}

TEST_F(LogReader, IgnoresTheExitStatusOfItsCommands)
{
    libc::hooks().pclose = [close = libc::hooks().pclose.answer()](FILE* stream) {
        close(stream);
        return 1 << 8;
    };
    EXPECT_EQ(log.getMaxLine(), 10U);
    EXPECT_EQ(data(1), "*host sshd[1]: session opened*");
    EXPECT_EQ(timeOf(1), at(2026, 11, 20, 10, 11, 12));
}

} // namespace log_reader_test
