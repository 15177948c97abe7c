// What the exporter gets from the program that it runs for each scrape.

#include "integrations/prometheus/exporter/Scrape.h"
#include "mihost/sandbox/Descriptor.h"
#include "tests/support/ScratchFolder.h"

#include <csignal>
#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

namespace scrape_test
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

TEST(Scrape, EndsWithAProgramThatIsTerminated)
{
    sigset_t endings;
    sigset_t before;
    sigemptyset(&endings);
    sigaddset(&endings, SIGTERM);
    pthread_sigmask(SIG_BLOCK, &endings, &before); // as the exporter does
    EXPECT_EQ(shell("kill -TERM $$; echo late"), std::nullopt);
    pthread_sigmask(SIG_SETMASK, &before, nullptr);
}

/** @return all that is written to the pipe until its last writer has ended */
std::string readToEnd(int pipe)
{
    fcntl(pipe, F_SETFL, 0); // blocking from here on
    std::string text;
    char byte = 0;
    while (read(pipe, &byte, 1) == 1)
        text += byte;
    return text;
}

TEST(Scrape, EndsALateProgramAndItsCommands)
{
    ScratchFolder const folder;
    std::string const path = folder.path("pipe");
    ASSERT_EQ(mkfifo(path.c_str(), 0600), 0);
    std::string written;
    // On a busy machine the program may end before it has begun.
    for (std::chrono::milliseconds limit(500); written.empty() && limit < longEnough; limit *= 4) {
        mihost::Descriptor const pipe(open(path.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC));
        EXPECT_EQ(shell("exec 9>" + path + "; sleep 600 & echo begun >&9; echo early; wait", limit),
                  std::nullopt);
        written = readToEnd(pipe.get());
    }
    EXPECT_EQ(written, "begun\n");
}

} // namespace scrape_test
