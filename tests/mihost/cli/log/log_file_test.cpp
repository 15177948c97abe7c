#include "mihost/cli/log/LogFile.h"

#include "tests/support/Lines.h"
#include "tests/support/ScratchFolder.h"

#include <filesystem>
#include <gtest/gtest.h>
#include <system_error>

namespace log_file_test
{

namespace fs = std::filesystem;
using mihost::LogFile;

class LogFileTest : public testing::Test
{
protected:
    LogFileTest() : path(folder.write("log", "one\ntwo\nthree\n")) {}

    void append(std::string const& text)
    {
        folder.append("log", text);
    }

    ScratchFolder folder;
    std::string path;
};

TEST_F(LogFileTest, BeginsWithTheNewestLines)
{
    EXPECT_EQ(LogFile(path).newestLines(2), (Lines{"two", "three"}));
    EXPECT_EQ(LogFile(path).newestLines(9), (Lines{"one", "two", "three"}));
    EXPECT_EQ(LogFile(path).newestLines(0), Lines());
}

TEST_F(LogFileTest, ContinuesWithAppendedLines)
{
    LogFile log(path);
    log.newestLines(1);
    EXPECT_EQ(log.newLines(), Lines());
    append("four\nfive\n");
    EXPECT_EQ(log.newLines(), (Lines{"four", "five"}));
    EXPECT_EQ(log.newLines(), Lines());
}

TEST_F(LogFileTest, WaitsForTheEndOfALine)
{
    append("fo");
    LogFile log(path);
    EXPECT_EQ(log.newestLines(1), Lines{"three"});
    append("u");
    EXPECT_EQ(log.newLines(), Lines());
    append("r\nfive");
    EXPECT_EQ(log.newLines(), Lines{"four"});
}

TEST_F(LogFileTest, FinishesARotatedLogAndThenReadsTheNewOne)
{
    LogFile log(path);
    log.newestLines(1);
    fs::rename(path, path + ".1");
    folder.append("log.1", "last of the old\n");
    EXPECT_EQ(log.newLines(), Lines{"last of the old"}); // there is no new one yet
    append("");
    folder.append("log.1", "later than that\n");
    EXPECT_EQ(log.newLines(), Lines{"later than that"}); // nothing is in the new one yet
    append("first of the new\n");
    EXPECT_EQ(log.newLines(), Lines{"first of the new"});
    append("second\n");
    EXPECT_EQ(log.newLines(), Lines{"second"});
}

TEST_F(LogFileTest, LosesNothingIfRotationAndNewLinesComeTogether)
{
    LogFile log(path);
    log.newestLines(1);
    append("old\nhalf");
    fs::rename(path, path + ".1");
    append("new\n");
    EXPECT_EQ(log.newLines(), (Lines{"old", "new"}));
}

TEST_F(LogFileTest, ReadsAnEmptiedLogFromItsBeginning)
{
    LogFile log(path);
    log.newestLines(1);
    append("half");
    log.newLines();
    fs::resize_file(path, 0);
    append("new\n");
    EXPECT_EQ(log.newLines(), Lines{"new"});
}

TEST_F(LogFileTest, BeginsWithinALongLogAtAWholeLine)
{
    append(std::string(300'000, 'x') + "\nlast\n");
    EXPECT_EQ(LogFile(path).newestLines(1), Lines{"last"});
    Lines const lines = LogFile(path).newestLines(3);
    ASSERT_EQ(lines.size(), 3U);
    EXPECT_EQ(lines[0], "three");
}

TEST_F(LogFileTest, BeginsWithAsManyLinesAsRequested)
{
    std::string text;
    for (int number = 0; number < 50'000; ++number)
        text += "line " + std::to_string(number) + "\n";
    append(text);
    Lines const lines = LogFile(path).newestLines(40'000);
    ASSERT_EQ(lines.size(), 40'000U);
    EXPECT_EQ(lines.front(), "line 10000");
    EXPECT_EQ(lines.back(), "line 49999");
}

TEST_F(LogFileTest, KeepsTheStartOfALineWithoutEnd)
{
    LogFile log(path);
    log.newestLines(1);
    append(std::string(200'000, 'x'));
    EXPECT_EQ(log.newLines(), Lines());
    append("\n");
    Lines const lines = log.newLines();
    ASSERT_EQ(lines.size(), 1U);
    EXPECT_EQ(lines[0], std::string(65536, 'x'));
}

TEST_F(LogFileTest, CannotBeReadIfItIsMissing)
{
    EXPECT_THROW(LogFile(folder.path("none")), std::system_error);
}

} // namespace log_file_test
