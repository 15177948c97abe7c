#include "mihost/cli/shell/HistoryFile.h"

#include "mihost/cli/system/TextFile.h"
#include "tests/support/Lines.h"
#include "tests/support/ScratchFolder.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

namespace history_file_test
{

namespace fs = std::filesystem;
using mihost::HistoryFile;

class HistoryFileTest : public testing::Test
{
protected:
    HistoryFileTest() : path(folder.path("state/mihost/history")) {}

    static mode_t modeOf(std::string const& file)
    {
        struct stat status {
        };
        stat(file.c_str(), &status);
        return status.st_mode & 07777;
    }

    ScratchFolder folder;
    std::string path;
};

TEST_F(HistoryFileTest, KeepsLinesFromOneShellToTheNext)
{
    EXPECT_EQ(HistoryFile(path).lines(), Lines());
    HistoryFile(path).add("get os");
    HistoryFile(path).add("list users");
    EXPECT_EQ(HistoryFile(path).lines(), (Lines{"get os", "list users"}));
}

TEST_F(HistoryFileTest, IsReadableByItsOwnerOnly)
{
    umask(0);
    HistoryFile(path).add("get os");
    umask(022);
    EXPECT_EQ(modeOf(path), 0600U);
    chmod(path.c_str(), 0644);
    HistoryFile(path).add("get os");
    EXPECT_EQ(modeOf(path), 0600U);
}

TEST_F(HistoryFileTest, KeepsTheNewestLinesOnly)
{
    HistoryFile const history(path);
    for (int line = 0; line < mihost::historyLimit + 5; ++line)
        history.add(std::to_string(line));
    Lines const kept = history.lines();
    EXPECT_EQ(kept.size(), static_cast<std::size_t>(mihost::historyLimit));
    EXPECT_EQ(kept.front(), "5");
    EXPECT_EQ(mihost::linesOf(mihost::contentOf(path)), kept);
    EXPECT_EQ(std::distance(fs::directory_iterator(fs::path(path).parent_path()), {}), 1);
}

TEST_F(HistoryFileTest, ReadsNoLineAndNoFileThatIsTooLong)
{
    HistoryFile(path).add("first");
    std::ofstream(path, std::ios::app) << std::string(2'000'000, 'x') << "\nlast\n";
    EXPECT_EQ(HistoryFile(path).lines(), Lines{"last"});
    std::ofstream(path) << std::string(2'000'000, 'x');
    EXPECT_EQ(HistoryFile(path).lines(), Lines());
    HistoryFile(path).add(std::string(4097, 'x'));
    EXPECT_EQ(HistoryFile(path).lines(), Lines());
}

TEST_F(HistoryFileTest, FollowsNoLinkAndOpensNoPipe)
{
    HistoryFile const history(path);
    std::string const target = folder.path("target");
    std::ofstream(target) << "untouched\n";
    fs::create_symlink(target, path);
    history.add("get os");
    EXPECT_EQ(history.lines(), Lines());
    EXPECT_EQ(mihost::contentOf(target), "untouched\n");
    fs::remove(path);
    ASSERT_EQ(mkfifo(path.c_str(), 0600), 0);
    history.add("get os"); // does not wait for a reader
    EXPECT_EQ(history.lines(), Lines());
}

TEST_F(HistoryFileTest, NeedsADirectoryThatOnlyItsUserCanWrite)
{
    HistoryFile(path).add("get os");
    chmod(fs::path(path).parent_path().c_str(), 0777);
    HistoryFile(path).add("list users");
    EXPECT_EQ(mihost::contentOf(path), "get os\n");
}

TEST_F(HistoryFileTest, TouchesNothingInAnotherUsersDirectory)
{
    if (geteuid() != 0)
        GTEST_SKIP() << "needs root";
    ASSERT_EQ(chown(folder.name().c_str(), 65534, 65534), 0);
    HistoryFile(path).add("get os");
    EXPECT_FALSE(fs::exists(folder.path("state")));
}

TEST_F(HistoryFileTest, CanBeMissing)
{
    HistoryFile("").add("get os");
    EXPECT_EQ(HistoryFile("").lines(), Lines());
    std::ofstream(folder.path("state")) << "a file in the way";
    HistoryFile(path).add("get os");
    EXPECT_EQ(HistoryFile(path).lines(), Lines());
}

TEST(HistoryPath, IsInTheStateDirectory)
{
    setenv("HOME", "/home/jdoe", 1);
    setenv("XDG_STATE_HOME", "/state", 1);
    EXPECT_EQ(mihost::historyPath(), "/state/mihost/history");
    setenv("XDG_STATE_HOME", "relative", 1);
    EXPECT_EQ(mihost::historyPath(), "/home/jdoe/.local/state/mihost/history");
    unsetenv("XDG_STATE_HOME");
    EXPECT_EQ(mihost::historyPath(), "/home/jdoe/.local/state/mihost/history");
    unsetenv("HOME");
    EXPECT_EQ(mihost::historyPath(), "");
}

} // namespace history_file_test
