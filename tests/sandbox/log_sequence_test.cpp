// Every logger call from the opening of the library to its unload, on one machine.
//
// script/expected-log derives the expected file from the machine's files, without the plug-in.

#include "TestPaths.h"
#include "tests/support/Machine.h"
#include "tests/support/Plugin.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>
#include <regex>

namespace log_sequence_test
{

char const* const expectedFile = TESTS_DIR "/sandbox/expected/suse.log";

/** Level, category, file, function and text, one call a line. */
std::string line(LogRecord const& record)
{
    std::string text = std::to_string(record.level) + ' ' + record.category + ' ' + record.file +
                       ' ' + record.function + " | ";
    for (char const character : record.text) {
        if (character == '\n')
            text += "\\n";
        else if (character == '\t')
            text += "\\t";
        else
            text += character;
    }
    return text;
}

/** Replaces the two times of a run by a word if they look like times. */
std::string withoutTimes(std::string const& text)
{
    static std::regex const time(
        "((LastBootTime|InstallDate) = )"
        "[A-Z][a-z]{2} [A-Z][a-z]{2} [ 0-9][0-9] [0-9]{2}:[0-9]{2}:[0-9]{2} [0-9]{4}");
    return std::regex_replace(text, time, "$1<time>");
}

bool areTheSame(LogRecord const& one, LogRecord const& other)
{
    return one.function == other.function && one.file == other.file && one.line == other.line &&
           one.category == other.category && one.level == other.level && one.text == other.text;
}

/** The messages of a whole run, once each; expects that both operations agree. */
std::vector<std::string> saidByAWholeRun()
{
    Recording recording;
    {
        Plugin plugin;
        plugin.initialize();
        plugin.unload();
    }
    std::vector<LogRecord> const records = recording.records();
    std::vector<std::string> lines;
    for (std::size_t at = 0; at + 1 < records.size(); at += 2) {
        LogRecord const& log = records[at];
        LogRecord const& trace = records[at + 1];
        EXPECT_FALSE(log.trace);
        EXPECT_TRUE(trace.trace);
        EXPECT_TRUE(areTheSame(log, trace)) << line(log) << '\n' << line(trace);
        for (LogRecord const& record : {log, trace}) {
            EXPECT_TRUE(record.extraIsNull);
            EXPECT_EQ(record.first, 0);
            EXPECT_EQ(record.second, 0);
            EXPECT_GT(record.line, 0);
        }
        lines.push_back(withoutTimes(line(log)));
    }
    EXPECT_EQ(records.size() % 2, 0U);
    return lines;
}

TEST(LogSequence, OfAWholeRunIsTheExpectedOne)
{
    machine::lay("suse");
    EXPECT_EQ(saidByAWholeRun(), linesOf(machine::read(expectedFile)));
}

} // namespace log_sequence_test
