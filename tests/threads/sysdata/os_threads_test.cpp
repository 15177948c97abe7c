// The distribution's name and version read in several threads.

#include "sysdata/osInfo_linux.h"

#include "tests/support/FakeFiles.h"

#include <gtest/gtest.h>

#include <atomic>
#include <string>
#include <thread>
#include <vector>

namespace os_threads_test
{

TEST(OSThreads, ReadNameAndVersionAtOnce)
{
    FakeFiles const files;
    files.write("/etc/release", "Kesto Linux\nVERSION = 10\nPATCHLEVEL = 2\n");
    std::atomic<int> wrong{0};
    std::vector<std::thread> threads;
    for (int thread = 0; thread < 4; ++thread)
        threads.emplace_back([&wrong] {
            for (int round = 0; round < 50; ++round) {
                std::string name;
                std::string number;
                NQ::OsInfo().getOSName(name);
                NQ::OsInfo().getOSVersion(number);
                if (name != "Kesto Linux" || number != "10.2")
                    ++wrong;
            }
        });
    for (std::thread& thread : threads)
        thread.join();
    EXPECT_EQ(wrong, 0);
}

} // namespace os_threads_test
