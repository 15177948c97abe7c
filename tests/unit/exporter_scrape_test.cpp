// What the exporter gets from the program that it runs for each scrape.

#include "integrations/prometheus/exporter/Scrape.h"
#include "tests/support/ScratchFolder.h"

#include <cerrno>
#include <csignal>
#include <fstream>
#include <gtest/gtest.h>

namespace
{

using namespace std::chrono_literals;
using Text = std::optional<std::string>;

constexpr auto longEnough = 60s;

Text shell(std::string const& line, std::chrono::milliseconds timeLimit = longEnough)
{
    return scrape({"/bin/sh", "-c", line}, timeLimit);
}

TEST(Scrape, IsWhatTheProgramPrints)
{
    EXPECT_EQ(shell("echo one; echo two >&2; echo three"), "one\nthree\n");
}

TEST(Scrape, IsTheWholeOfALongText)
{
    Text const text = shell("head -c 1000000 /dev/zero");
    ASSERT_TRUE(text);
    EXPECT_EQ(text->size(), 1000000U);
}

TEST(Scrape, IsTheTextOfAProgramThatFails)
{
    EXPECT_EQ(shell("echo 'mi_collection_success 0'; exit 3"), "mi_collection_success 0\n");
}

TEST(Scrape, IsNothingWithoutAText)
{
    EXPECT_EQ(shell("true"), std::nullopt);
    EXPECT_EQ(scrape({"/no/such/program"}, longEnough), std::nullopt);
}

TEST(Scrape, EndsALateProgramAndItsCommands)
{
    ScratchFolder const folder;
    std::string const file = folder.path("pid");
    EXPECT_EQ(shell("sleep 600 & echo $! >" + file + "; echo early; wait", 500ms), std::nullopt);
    pid_t command = 0;
    std::ifstream(file) >> command;
    ASSERT_GT(command, 0);
    // Killed, it is gone, or a zombie until its new parent looks after it.
    std::string state;
    std::ifstream status("/proc/" + std::to_string(command) + "/stat");
    status >> state >> state >> state;
    EXPECT_TRUE(!status || state == "Z" || state == "X") << state;
}

} // namespace
