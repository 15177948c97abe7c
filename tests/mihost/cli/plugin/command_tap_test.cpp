// What the program records of the commands that it runs, and what the plug-in reads of them.

#include "mihost/cli/plugin/CommandTap.h"
#include "mihost/cli/system/BoundedText.h"
#include "mihost/sandbox/Descriptor.h"

#include <array>
#include <csignal>
#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

namespace command_tap_test
{

namespace tap = mihost::commandTap;
using mihost::BoundedText;

constexpr std::size_t many = 5 * BoundedText::limit;
constexpr char marker[] = "... (4194304 more bytes)\n";
static_assert(many - BoundedText::limit == 4194304);

/** @return a command that writes that many bytes */
std::string writing(std::size_t bytes)
{
    return "head -c " + std::to_string(bytes) + " /dev/zero";
}

std::size_t readToEnd(std::FILE* stream)
{
    std::array<char, 1000> block{};
    std::size_t read = 0;
    while (std::size_t const length = std::fread(block.data(), 1, block.size(), stream))
        read += length;
    return read;
}

class CommandTap : public testing::Test
{
protected:
    void SetUp() override
    {
        tap::setRunner({popen, pclose});
    }
};

TEST_F(CommandTap, PassesOnAndRecordsWhatACommandWrites)
{
    tap::Recording const recording;
    std::FILE* const stream = tap::open("echo one; echo two; exit 3", "r");
    std::array<char, 64> line{};
    ASSERT_TRUE(std::fgets(line.data(), line.size(), stream));
    EXPECT_STREQ(line.data(), "one\n");
    ASSERT_TRUE(std::fgets(line.data(), line.size(), stream));
    EXPECT_STREQ(line.data(), "two\n");
    EXPECT_FALSE(std::fgets(line.data(), line.size(), stream));
    EXPECT_EQ(WEXITSTATUS(tap::close(stream)), 3);
    ASSERT_EQ(recording.commands().size(), 1U);
    EXPECT_EQ(recording.commands()[0].line, "echo one; echo two; exit 3");
    EXPECT_EQ(recording.commands()[0].output, "one\ntwo\n");
    EXPECT_EQ(WEXITSTATUS(recording.commands()[0].status), 3);
}

TEST_F(CommandTap, LetsThePluginReadAllOfALongOutput)
{
    tap::Recording const recording;
    std::FILE* const stream = tap::open(writing(many).c_str(), "r");
    EXPECT_EQ(readToEnd(stream), many);
    EXPECT_EQ(WEXITSTATUS(tap::close(stream)), 0);
    std::string const kept = recording.commands().at(0).output;
    EXPECT_EQ(kept.size(), BoundedText::limit + 1 + std::string(marker).size());
    EXPECT_EQ(kept.substr(BoundedText::limit + 1), marker);
}

TEST_F(CommandTap, LetsACommandFinishWhoseOutputIsNotRead)
{
    tap::Recording const recording;
    std::string const line = writing(many) + " && exit 4";
    EXPECT_EQ(WEXITSTATUS(tap::close(tap::open(line.c_str(), "r"))), 4);
    std::string const kept = recording.commands().at(0).output;
    EXPECT_EQ(kept.substr(BoundedText::limit + 1), marker);
}

TEST_F(CommandTap, RecordsCommandsInTheOrderOfTheirStart)
{
    tap::Recording const recording;
    std::FILE* const outer = tap::open("echo outer", "r");
    std::FILE* const inner = tap::open("echo inner", "r");
    EXPECT_EQ(readToEnd(inner), 6U);
    tap::close(inner);
    EXPECT_EQ(readToEnd(outer), 6U);
    std::fclose(outer); // as a plug-in may
    ASSERT_EQ(recording.commands().size(), 2U);
    EXPECT_EQ(recording.commands()[0].output, "outer\n");
    EXPECT_EQ(recording.commands()[1].output, "inner\n");
}

TEST_F(CommandTap, KeepsTheBeginningOfStandardError)
{
    tap::takeStandardError();
    std::string const line = writing(many) + " >&2";
    EXPECT_EQ(WEXITSTATUS(tap::close(tap::open(line.c_str(), "r"))), 0);
    std::string const kept = tap::takeStandardError();
    EXPECT_EQ(kept.substr(BoundedText::limit + 1), marker);
    EXPECT_EQ(tap::takeStandardError(), "");
}

TEST_F(CommandTap, DoesNotWaitForTheEndOfStandardError)
{
    std::FILE* const stream = tap::open("yes 3>&1 >&2 & echo $!", "r");
    std::array<char, 64> line{};
    ASSERT_TRUE(std::fgets(line.data(), line.size(), stream));
    mihost::Descriptor const untilItEnds(dup(fileno(stream)));
    tap::close(stream);
    tap::takeStandardError();
    EXPECT_LE(tap::takeStandardError().size(), BoundedText::limit + 64);
    kill(std::stoi(line.data()), SIGKILL);
    EXPECT_EQ(read(untilItEnds.get(), line.data(), line.size()), 0);
    tap::takeStandardError(); // the rest, which the next test would find
}

TEST_F(CommandTap, KeepsTheBeginningOfWhatItsOwnCommandsPrint)
{
    EXPECT_EQ(tap::outputOf("echo text"), "text\n");
    EXPECT_EQ(tap::outputOf(writing(many)).substr(BoundedText::limit + 1), marker);
}

} // namespace command_tap_test
