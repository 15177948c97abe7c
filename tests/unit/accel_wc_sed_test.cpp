// wc and sed, asked in both ways and compared byte by byte.

#include "tests/support/BothWays.h"
#include "tests/support/ScratchFolder.h"
#include "tests/unit/AccelStandIns.h"

#include <atomic>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <linux/magic.h>
#include <random>
#include <sys/stat.h>
#include <thread>
#include <unistd.h>

namespace
{

using bothways::answered;
using bothways::real;

std::string sedCommand(std::uint64_t line, std::string const& path)
{
    return "sed -n '" + std::to_string(line) + "p' " + path;
}

std::string randomLine(std::mt19937& random)
{
    std::string line;
    switch (random() % 20) {
    case 0:
        return line;
    case 1:
        line.assign(random() % 70000, 'x');
        return line;
    default:
        line.resize(random() % 120);
        for (char& character : line)
            do
                character = static_cast<char>(random() % 256);
            while (character == '\n');
        return line;
    }
}

/** Lines of every kind, with or without an end of the last one. */
std::string randomText(std::mt19937& random)
{
    std::string text;
    for (unsigned long lines = random() % 40; lines > 0; --lines)
        text += randomLine(random) + '\n';
    if (random() % 2 == 0)
        text += randomLine(random);
    return text;
}

/** One thing that may happen to a log. */
void change(ScratchFolder const& folder, std::mt19937& random)
{
    std::string const path = folder.path("log");
    auto const size = std::filesystem::exists(path) ? std::filesystem::file_size(path) : 0;
    switch (random() % 8) {
    case 0:
        folder.write("log", randomText(random));
        break;
    case 1:
        folder.write("new", randomText(random));
        std::filesystem::rename(folder.path("new"), path);
        break;
    case 2:
        folder.append("log", "");
        std::filesystem::resize_file(path, size / 2);
        break;
    case 3: { // the same size, another content
        std::string text = randomText(random);
        text.resize(size, '\n');
        folder.write("log", text);
        break;
    }
    case 4:
        folder.append("log", "");
        std::filesystem::resize_file(path, size + random() % 5000); // ends in NUL bytes
        break;
    default:
        folder.append("log", randomText(random));
    }
}

TEST(AccelWcSed, AnswerAsTheCommandsDoWhateverHappensToTheLog)
{
    ScratchFolder const folder;
    std::string const path = folder.path("log");
    std::mt19937 random(7);
    for (int i = 0; i < 1100; ++i) {
        for (unsigned long changes = i == 0 ? 1 : random() % 4; changes > 0; --changes)
            change(folder, random);
        std::uint64_t const last = std::stoull(answered("wc -l " + path).value());
        std::vector<std::string> commands{"wc -l " + path};
        for (std::uint64_t const line : {1 + random() % (last + 2), last, last + 1})
            if (line > 0)
                commands.push_back(sedCommand(line, path));
        std::string script;
        std::string together;
        for (std::string const& command : commands) {
            script += command + "; ";
            together += answered(command).value();
        }
        ASSERT_TRUE(together == real(script + ":")) << i << ' ' << script;
    }
}

TEST(AccelWcSed, AnswerForLinesOfAMegabyte)
{
    ScratchFolder const folder;
    std::string const megabyte(1024 * 1024, '\0');
    std::string const path = folder.write("log", megabyte + "\n\n" + megabyte + "x\n" + megabyte);
    EXPECT_EQ(answered("wc -l " + path), real("wc -l " + path));
    for (std::uint64_t line = 1; line <= 5; ++line)
        EXPECT_TRUE(answered(sedCommand(line, path)) == real(sedCommand(line, path))) << line;
}

TEST(AccelWcSed, AnswerForAnEmptyFile)
{
    ScratchFolder const folder;
    std::string const path = folder.write("log", "");
    EXPECT_EQ(answered("wc -l " + path), "0 " + path + "\n");
    EXPECT_EQ(answered(sedCommand(1, path)), "");
}

TEST(AccelWcSed, AnswerForFilesBehindLinks)
{
    ScratchFolder const folder;
    folder.write("log", "1\n2\n");
    std::string const link = folder.path("link");
    std::filesystem::create_symlink("log", link);
    EXPECT_EQ(answered("wc -l " + link), real("wc -l " + link));
    EXPECT_EQ(answered(sedCommand(2, link)), "2\n");
}

TEST(AccelWcSed, AnswerForNamesOfTheWorkingFolder)
{
    ScratchFolder const folder;
    folder.write("log", "1\n2\n");
    std::filesystem::current_path(folder.name());
    EXPECT_EQ(answered("wc -l log"), "2 log\n");
    std::filesystem::current_path("/");
    EXPECT_EQ(answered("wc -l log"), std::nullopt);
}

TEST(AccelWcSed, TellApartMoreFilesThanTheyRemember)
{
    ScratchFolder const folder;
    std::vector<std::string> paths;
    for (std::size_t i = 0; i < 40; ++i)
        paths.push_back(folder.write(std::to_string(i), std::string(i, '\n')));
    for (int round = 0; round < 2; ++round)
        for (std::size_t i = 0; i < paths.size(); ++i)
            EXPECT_EQ(answered("wc -l " + paths[i]), std::to_string(i) + ' ' + paths[i] + '\n');
}

TEST(AccelWcSed, CountNeitherBackwardsNorAheadWhileTheLogGrows)
{
    ScratchFolder const folder;
    std::string const path = folder.write("log", "first\n");
    constexpr int rounds = 60;
    std::atomic<int> round{0};
    std::thread writer([&] {
        std::ofstream log(path, std::ios::app);
        std::string const line(200, 'x');
        for (int own = 0; own < rounds; ++own) {
            for (int lines = 0; lines < 500; ++lines)
                log << line << std::endl;
            while (round <= own)
                std::this_thread::yield();
        }
    });
    for (; round < rounds; ++round) {
        unsigned long const before = std::stoul(real("wc -l " + path));
        std::string const between = answered("wc -l " + path).value();
        unsigned long const after = std::stoul(real("wc -l " + path));
        EXPECT_LE(before, std::stoul(between));
        EXPECT_LE(std::stoul(between), after);
        EXPECT_EQ(answered(sedCommand(1, path)), "first\n");
        EXPECT_EQ(answered(sedCommand(before, path)), real(sedCommand(before, path)));
    }
    writer.join();
}

TEST(AccelWcSed, KeepWhatWasReadWhenTheLogIsCutOrReplacedMeanwhile)
{
    ScratchFolder const folder;
    std::string const line = std::string(1024 * 1024, 'a') + '\n';
    std::string const path = folder.write("log", line);
    FILE* const cut = miaccel::openAnswer(sedCommand(1, path).c_str(), "r");
    std::filesystem::resize_file(path, 0);
    folder.append("log", line);
    FILE* const replaced = miaccel::openAnswer(sedCommand(1, path).c_str(), "r");
    folder.write("new", "new\n");
    std::filesystem::rename(folder.path("new"), path);
    EXPECT_TRUE(bothways::readAll(cut) == line);
    EXPECT_TRUE(bothways::readAll(replaced) == line);
    EXPECT_EQ(answered(sedCommand(1, path)), "new\n");
    std::fclose(cut);
    std::fclose(replaced);
}

TEST(AccelWcSed, TryAgainWhereTheFileIsCutWhileItIsRead)
{
    ScratchFolder const folder;
    std::string const path = folder.write("log", "1\n2\n3\n");
    accelStandIns::Guard const guard;
    bool cut = false;
    accelStandIns::hooks().pread = [&](int descriptor, void* buffer, std::size_t size,
                                       off_t offset) {
        if (!cut)
            std::filesystem::resize_file(path, 4);
        cut = true;
        return accelStandIns::realPread(descriptor, buffer, size, offset);
    };
    EXPECT_EQ(answered("wc -l " + path), "2 " + path + "\n");
}

TEST(AccelWcSed, StepAsideWhereTheFileNeverStandsStill)
{
    ScratchFolder const folder;
    std::string const path = folder.write("log", "1\n2\n3\n");
    accelStandIns::Guard const guard;
    bool shorter = false;
    accelStandIns::hooks().pread = [&](int descriptor, void* buffer, std::size_t size,
                                       off_t offset) {
        shorter = !shorter;
        std::filesystem::resize_file(path, shorter ? 4 : 6);
        return accelStandIns::realPread(descriptor, buffer, size, offset);
    };
    EXPECT_EQ(answered("wc -l " + path), std::nullopt);
}

TEST(AccelWcSed, LeaveALineOfMoreThan16MebibytesToSed)
{
    ScratchFolder const folder;
    std::string const path = folder.write("log", "1\n");
    std::filesystem::resize_file(path, 2 + 16 * 1024 * 1024);
    EXPECT_TRUE(answered(sedCommand(2, path)));
    std::filesystem::resize_file(path, 2 + 16 * 1024 * 1024 + 1);
    EXPECT_FALSE(answered(sedCommand(2, path)));
    EXPECT_EQ(answered("wc -l " + path), "1 " + path + "\n");
}

TEST(AccelWcSed, StepAsideForWhatIsNoRegularFileOfADisk)
{
    // Missing, a folder, a device, and files of systems that make up their contents when asked.
    for (char const* path : {"/nonexistent/log", "/tmp", "/dev/null", "/proc/version",
                             "/proc/self/status", "/sys/kernel/uevent_seqnum", "/etc/passwd/x"}) {
        EXPECT_FALSE(answered(std::string("wc -l ") + path)) << path;
        EXPECT_FALSE(answered(sedCommand(1, path))) << path;
    }
}

TEST(AccelWcSed, StepAsideForAPipeWithoutWaitingForItsWriter)
{
    ScratchFolder const folder;
    ASSERT_EQ(mkfifo(folder.path("log").c_str(), 0600), 0);
    EXPECT_FALSE(answered("wc -l " + folder.path("log")));
}

TEST(AccelWcSed, StepAsideForWhatIsNamedByAnOpenDescriptor)
{
    ScratchFolder const folder;
    int const descriptor = open(folder.write("log", "1\n").c_str(), O_RDONLY | O_CLOEXEC);
    std::string const name = std::to_string(descriptor);
    EXPECT_FALSE(answered("wc -l /proc/self/fd/" + name));
    EXPECT_FALSE(answered("wc -l /dev/fd/" + name));
    close(descriptor);
}

TEST(AccelWcSed, StepAsideForAFileThatMayNotBeRead)
{
    ScratchFolder const folder;
    std::string const path = folder.write("log", "1\n");
    std::filesystem::permissions(path, std::filesystem::perms::none);
    bool const readable = access(path.c_str(), R_OK) == 0; // by root it is
    EXPECT_EQ(answered("wc -l " + path).has_value(), readable);
}

TEST(AccelWcSed, StepAsideForFileSystemsThatMayLieAboutTimes)
{
    ScratchFolder const folder;
    std::string const path = folder.write("log", "1\n");
    ASSERT_TRUE(answered("wc -l " + path));
    accelStandIns::Guard const guard;
    for (long const type : {long{NFS_SUPER_MAGIC}, long{SMB2_SUPER_MAGIC}, long{FUSE_SUPER_MAGIC},
                            long{V9FS_MAGIC}, long{CEPH_SUPER_MAGIC}, long{MSDOS_SUPER_MAGIC}}) {
        accelStandIns::hooks().fstatfs = [type](int descriptor, struct statfs* system) {
            int const result = accelStandIns::realFstatfs(descriptor, system);
            system->f_type = type;
            return result;
        };
        EXPECT_FALSE(answered("wc -l " + path)) << type;
    }
}

TEST(AccelWcSed, StepAsideWhereTheFileSystemCannotBeTold)
{
    ScratchFolder const folder;
    std::string const path = folder.write("log", "1\n");
    accelStandIns::Guard const guard;
    accelStandIns::hooks().fstatfs = [](int, struct statfs*) { return -1; };
    EXPECT_FALSE(answered("wc -l " + path));
}

TEST(AccelWcSed, AnswerManyThreadsAtOnce)
{
    ScratchFolder const folder;
    std::string const path = folder.write("log", "1\n2\n3\n");
    std::string const other = folder.write("other", "x\n");
    auto const ask = [&] {
        for (int i = 0; i < 200; ++i) {
            EXPECT_EQ(answered("wc -l " + path), "3 " + path + "\n");
            EXPECT_EQ(answered(sedCommand(2, path)), "2\n");
            EXPECT_EQ(answered("wc -l " + other), "1 " + other + "\n");
            EXPECT_TRUE(answered("date"));
            EXPECT_FALSE(answered("wc -l /nonexistent"));
        }
    };
    std::vector<std::thread> threads;
    for (int i = 0; i < 4; ++i)
        threads.emplace_back(ask);
    for (std::thread& thread : threads)
        thread.join();
}

TEST(AccelWcSed, HoldNoLockWhileAStreamIsWithItsReader)
{
    ScratchFolder const folder;
    std::string const path = folder.write("log", "1\n2\n3\n");
    FILE* const count = miaccel::openAnswer(("wc -l " + path).c_str(), "r");
    FILE* const line = miaccel::openAnswer(sedCommand(3, path).c_str(), "r");
    std::thread([&] { EXPECT_EQ(answered(sedCommand(1, path)), "1\n"); }).join();
    EXPECT_EQ(bothways::readAll(line), "3\n");
    EXPECT_EQ(bothways::readAll(count), "3 " + path + "\n");
    std::fclose(line);
    std::fclose(count);
}

} // namespace
