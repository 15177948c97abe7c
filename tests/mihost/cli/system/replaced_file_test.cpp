// A file that is replaced as a whole or not at all.

#include "mihost/cli/system/Failure.h"
#include "mihost/cli/system/ReplacedFile.h"
#include "mihost/cli/system/TextFile.h"
#include "tests/support/ScratchFolder.h"

#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <sys/stat.h>

namespace replaced_file_test
{

namespace fs = std::filesystem;

std::size_t entriesOf(std::string const& folder)
{
    return static_cast<std::size_t>(
        std::distance(fs::directory_iterator(folder), fs::directory_iterator()));
}

std::string problemWith(std::string const& path)
{
    try {
        mihost::replaceFile(path, "new\n", "writing it");
    } catch (mihost::Failure const& failure) {
        EXPECT_EQ(failure.code(), mihost::BadUsage);
        return failure.what();
    }
    return "";
}

TEST(ReplacedFile, IsNewAndReadableByEverybody)
{
    ScratchFolder const folder;
    mode_t const before = umask(077);
    mihost::replaceFile(folder.path("file"), "text\n", "writing it");
    umask(before);
    EXPECT_EQ(mihost::contentOf(folder.path("file")), "text\n");
    struct stat status {
    };
    ASSERT_EQ(stat(folder.path("file").c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 07777U, 0644U);
    EXPECT_EQ(entriesOf(folder.name()), 1U);
}

TEST(ReplacedFile, LeavesAReaderTheOldText)
{
    ScratchFolder const folder;
    folder.write("file", "old\n");
    std::ifstream reader(folder.path("file"));
    mihost::replaceFile(folder.path("file"), "new\n", "writing it");
    std::string line;
    std::getline(reader, line);
    EXPECT_EQ(line, "old");
    EXPECT_EQ(mihost::contentOf(folder.path("file")), "new\n");
}

TEST(ReplacedFile, SaysWhyItCannotBeMade)
{
    ScratchFolder const folder;
    std::string const path = folder.path("none") + "/file";
    EXPECT_EQ(problemWith(path), "writing it '" + path + "': No such file or directory");
}

TEST(ReplacedFile, LeavesNothingIfItCannotBePutInPlace)
{
    ScratchFolder const folder;
    folder.write("taken/file", "x"); // a directory, which no file replaces
    EXPECT_EQ(problemWith(folder.path("taken")),
              "writing it '" + folder.path("taken") + "': Is a directory");
    EXPECT_EQ(entriesOf(folder.name()), 1U);
}

} // namespace replaced_file_test
