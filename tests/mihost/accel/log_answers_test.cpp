// wc and sed, run and answered by the accelerator, compared byte by byte.

#include "tests/support/ComparedLog.h"
#include "tests/support/ReadCounter.h"

#include <atomic>
#include <filesystem>
#include <fstream>
#include <future>
#include <linux/magic.h>
#include <sys/stat.h>
#include <sys/vfs.h>
#include <thread>

namespace log_answers_test
{

using bothways::answered;
using bothways::real;
using bothways::reasonOf;

class AccelLog : public testing::Test
{
protected:
    std::string sed(std::uint64_t line) const
    {
        return sedCommand(line, log_);
    }

    ScratchFolder const folder_;
    std::string const log_ = folder_.write("log", "1\n2\n3\n");
    std::string const wc_ = "wc -l " + log_;
};

TEST(AccelLogs, AreReadAsTheCommandsReadThem)
{
    EXPECT_GT(percentOfSedsAnswered(7, 100), 50U);
}

TEST_F(AccelLog, IsAnsweredInLinesOfUpTo16Mebibytes)
{
    std::string const line = std::string(16 * 1024 * 1024 - 1, 'x') + '\n';
    folder_.write("log", line + "\n" + line + "y\nx" + line);
    EXPECT_EQ(answered(wc_), real(wc_));
    for (std::uint64_t number = 1; number <= 4; ++number)
        EXPECT_TRUE(answered(sed(number)) == real(sed(number))) << number;
    EXPECT_FALSE(answered(sed(5)));
}

TEST_F(AccelLog, IsIndexedOnceForBothCommands)
{
    constexpr std::size_t size = 4'000'000;
    folder_.write("log", std::string(size, '\n'));
    ReadCounter const counter;
    EXPECT_TRUE(answered(wc_));
    EXPECT_TRUE(answered(sed(size)));
    EXPECT_LT(counter.bytes, size + size / 10);
}

TEST_F(AccelLog, IsReadUnderAnyName)
{
    std::filesystem::create_symlink("log", folder_.path("link"));
    EXPECT_EQ(answered("wc -l " + folder_.path("link")), "3 " + folder_.path("link") + "\n");
    std::filesystem::current_path(folder_.name());
    EXPECT_EQ(answered("wc -l log"), "3 log\n");
    std::filesystem::current_path("/");
    EXPECT_FALSE(answered("wc -l log"));
}

TEST_F(AccelLog, LeavesNulBytesAndALineWithoutEndToSed)
{
    folder_.write("log", "1\n2");
    EXPECT_EQ(answered(sed(1)), "1\n");
    EXPECT_FALSE(answered(sed(2)));
    EXPECT_EQ(reasonOf("sed"), "the line has no newline, which versions of sed treat differently");
    EXPECT_EQ(answered(sed(3)), "");
    folder_.append("log", std::string("\n\0\n", 3));
    EXPECT_FALSE(answered(sed(1)));
    EXPECT_EQ(reasonOf("sed"), "the file has NUL bytes, which versions of sed treat differently");
    EXPECT_EQ(answered(wc_), real(wc_));
}

TEST_F(AccelLog, CountsNeitherBackwardsNorAheadWhileItGrows)
{
    constexpr int rounds = 40;
    std::atomic<int> round{0};
    std::thread writer([&] {
        std::ofstream log(log_, std::ios::app);
        for (int own = 0; own < rounds; ++own) {
            for (int lines = 0; lines < 500; ++lines)
                log << std::string(200, 'x') << std::endl;
            while (round <= own)
                std::this_thread::yield();
        }
    });
    for (; round < rounds; ++round) {
        unsigned long const before = std::stoul(real(wc_));
        unsigned long const between = std::stoul(answered(wc_).value_or("0"));
        unsigned long const after = std::stoul(real(wc_));
        EXPECT_LE(before, between);
        EXPECT_LE(between, after);
        EXPECT_EQ(answered(sed(1)), "1\n");
        EXPECT_EQ(answered(sed(before)), real(sed(before)));
    }
    writer.join();
}

TEST_F(AccelLog, KeepsAnOpenAnswerWhenTheLogIsCut)
{
    std::string const line = std::string(1024 * 1024, 'a') + '\n';
    folder_.write("log", line);
    FILE* const stream = miaccel::openAnswer(sed(1).c_str(), "r");
    folder_.write("log", "new\n");
    std::thread([&] { EXPECT_EQ(answered(sed(1)), "new\n"); }).join(); // nothing is locked
    EXPECT_TRUE(bothways::readAll(stream) == line);
    std::fclose(stream);
}

TEST_F(AccelLog, IsLeftToTheCommandsWhenItIsCutWhileItIsRead)
{
    libc::hooks().pread = [&](int file, void* buffer, std::size_t size, off_t offset) {
        std::filesystem::resize_file(log_, 4);
        return interpose::real(pread)(file, buffer, size, offset);
    };
    EXPECT_FALSE(answered(wc_));
    EXPECT_EQ(reasonOf("wc"), "the file changes while it is read");
    libc::hooks().pread.reset();
    EXPECT_EQ(answered(wc_), real(wc_));
}

TEST_F(AccelLog, IsLeftToTheCommandsUnlessItIsARegularFileOfADisk)
{
    ASSERT_EQ(mkfifo(folder_.path("pipe").c_str(), 0600), 0);
    for (std::string const& path : std::vector<std::string>{
             folder_.path("none"), folder_.name(), folder_.path("pipe"), "/dev/null",
             "/proc/version", "/sys/kernel/uevent_seqnum", "/etc/passwd/x"}) {
        EXPECT_FALSE(answered("wc -l " + path)) << path;
        EXPECT_FALSE(answered(sedCommand(1, path))) << path;
    }
}

TEST_F(AccelLog, DeclinesFileSystemsWithUnreliableTimes)
{
    ASSERT_TRUE(answered(wc_));
    for (unsigned int const type :
         {NFS_SUPER_MAGIC + 0U, SMB2_SUPER_MAGIC + 0U, CIFS_SUPER_MAGIC + 0U, FUSE_SUPER_MAGIC + 0U,
          V9FS_MAGIC + 0U, CEPH_SUPER_MAGIC + 0U}) {
        libc::hooks().fstatfs = [type](int file, struct statfs* system) {
            int const result = interpose::real(fstatfs)(file, system);
            system->f_type = static_cast<decltype(system->f_type)>(type);
            return result;
        };
        EXPECT_FALSE(answered(wc_)) << type;
        EXPECT_EQ(reasonOf("wc"), "the file system may not give each change a new time stamp");
    }
    libc::hooks().fstatfs = [](int, struct statfs*) { return -1; };
    EXPECT_FALSE(answered(wc_));
}

TEST_F(AccelLog, IsReadByManyThreadsAtOnce)
{
    std::string const other = "wc -l " + folder_.write("other", "x\n");
    auto const ask = [&] {
        for (int i = 0; i < 100; ++i) {
            EXPECT_EQ(answered(wc_), "3 " + log_ + "\n");
            EXPECT_EQ(answered(sed(2)), "2\n");
            EXPECT_EQ(answered(other), "1 " + folder_.path("other") + "\n");
            EXPECT_TRUE(answered("date"));
        }
    };
    std::vector<std::future<void>> threads; // waited for by their destructors
    for (int i = 0; i < 4; ++i)
        threads.push_back(std::async(std::launch::async, ask));
}

} // namespace log_answers_test
