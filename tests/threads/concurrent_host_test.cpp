// A busy host: threads that read whatever the tree holds while one refreshes it and another
// administers the machine. script/concurrency lets it run for minutes. Most useful when built with
// the thread sanitizer.

#include "TestPaths.h"
#include "host/Properties.h"
#include "tests/interpose/Libc.h"
#include "tests/support/ErrorCount.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/FileRoot.h"
#include "tests/support/LiveNodes.h"
#include "tests/support/Plugin.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <atomic>
#include <chrono>
#include <cstdlib>
#include <cstring>
#include <iostream>
#include <thread>
#include <vector>

namespace concurrent_host_test
{

constexpr unsigned int writesEach = 20;
constexpr unsigned int readers = 3;

/** The output of the machine's commands. Unlike FakeCommands, it records nothing to share. */
char const* outputOf(char const* command)
{
    struct Answer {
        char const* beginning;
        char const* output;
    };
    static constexpr Answer answers[] = {
        {"lsmod", "Module Size Used by\nloop 1 0\n"},
        {"modinfo ", "description: Loopback\nversion: 1.0\n"},
        {"wc ", "2 /var/log/messages\n"},
        {"sed ", "Nov  1 10:00:00 host daemon: a line\n"},
        {"date", "Sat Nov 21 10:00:00 UTC 2026\n"},
        {"stat ", "Change: 2010-05-12 10:23:45.000000000 +0200\n"},
    };
    for (auto const& [beginning, output] : answers)
        if (std::strncmp(command, beginning, std::strlen(beginning)) == 0)
            return output;
    return ""; // tools that succeed print nothing
}

FILE* answer(char const* command, char const*)
{
    char const* const output = outputOf(command);
    FILE* const stream = std::tmpfile();
    std::fputs(output, stream);
    std::rewind(stream);
    return stream;
}

/** When writers stop: after this many writes or, if set, seconds. */
class Duration
{
public:
    bool goesOn(unsigned int writes) const
    {
        return seconds_ ? std::chrono::steady_clock::now() < end_ : writes < writesEach;
    }

private:
    char const* const seconds_ = std::getenv("MI_CONCURRENCY_SECONDS");
    std::chrono::steady_clock::time_point const end_ =
        std::chrono::steady_clock::now() + std::chrono::seconds(seconds_ ? std::atoi(seconds_) : 0);
};

class ConcurrentHost : public testing::Test
{
protected:
    ConcurrentHost()
    {
        // Without a zone, libc looks it up each time, under a lock that the sanitizer cannot see.
        useZone("UTC0");
        libc::hooks().popen = answer;
        libc::hooks().pclose = [](FILE* stream) { return std::fclose(stream); };
        plugin.initialize();
    }

    FileRoot const root{MACHINES_DIR "/users-and-groups"};
    Plugin plugin;
};

TEST_F(ConcurrentHost, ReadsNodesDuringRefreshesAndNewGroups)
{
    IC::MutableNode& os = plugin.node(IC::nodeType::operatingSystem);
    std::size_t const nodeCount = plugin.nodes().size();
    ErrorCount const log;
    LiveNodes live(plugin.nodes());
    Duration const duration;
    std::atomic<unsigned int> writers{2};
    std::atomic<unsigned int> wrong{0};
    std::atomic<unsigned long> writes{0};
    std::atomic<unsigned long> reads{0};

    auto const write = [&](unsigned int id, IC::PropertyValue const& value) {
        for (unsigned int done = 0; duration.goesOn(done); ++done) {
            wrong += os.setProperty(id, value).getStatus();
            ++writes;
        }
        --writers;
    };
    auto const readAll = [&](IC::MutableNode const& node) {
        wrong += node.getDescription().empty() ? 1 : 0;
        for (auto const& entry : node.getProperties()) {
            IC::PropertyValue value(IC::PropertyValue::EmptyKind, true);
            wrong += node.getProperty(entry.first, value).getStatus();
            ++reads;
        }
    };
    std::vector<std::thread> threads;
    threads.emplace_back(write, IC::property::refresh, IC::PropertyValue(IC::Number(0U), true));
    threads.emplace_back(write, IC::property::createUser,
                         IC::PropertyValue("LocalGroupAdd,GroupName:CMPI_string:staff", true));
    for (unsigned int i = 0; i < readers; ++i)
        threads.emplace_back([&] {
            do
                live.useEach(readAll);
            while (writers > 0);
        });
    for (std::thread& thread : threads)
        thread.join();

    EXPECT_EQ(wrong, 0U);
    EXPECT_EQ(log.errors, 0U);
    EXPECT_GE(writes, 2UL);
    EXPECT_GE(reads, readers * nodeCount);
    EXPECT_EQ(plugin.nodes().size(), nodeCount);
    std::cout << reads << " reads, " << writes << " writes\n";
}

} // namespace concurrent_host_test
