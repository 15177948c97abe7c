// How the files that `cmake --install` writes are divided among the packages.

#include "TestPaths.h"
#include "tests/support/Lines.h"
#include "tests/support/Program.h"
#include "tests/support/ScratchFolder.h"

#include <filesystem>
#include <gtest/gtest.h>
#include <set>

namespace packages_test
{

namespace fs = std::filesystem;

std::string const packaging = TESTS_DIR "/../packaging/";

/** The names of the packages in Debian's control file. */
std::set<std::string> packages()
{
    std::string const key = "Package: ";
    std::set<std::string> names;
    for (std::string const& line : linesOf(contentOf(packaging + "debian/control")))
        if (line.rfind(key, 0) == 0)
            names.insert(line.substr(key.size()));
    return names;
}

/** The files that an installation puts below an empty directory. */
std::set<std::string> installed(std::vector<std::string> const& options)
{
    ScratchFolder const folder;
    fs::path const prefix = folder.name();
    std::vector<std::string> command = {"/usr/bin/env", "cmake",    "--install",
                                        BUILD_DIR,      "--prefix", prefix / "tree"};
    command.insert(command.end(), options.begin(), options.end());
    Outcome const outcome = runToEnd(command);
    EXPECT_EQ(outcome.code, 0) << outcome.out << outcome.err;
    std::set<std::string> files;
    if (fs::exists(prefix / "tree"))
        for (fs::directory_entry const& entry : fs::recursive_directory_iterator(prefix / "tree"))
            if (!entry.is_directory())
                files.insert(fs::relative(entry.path().parent_path(), prefix / "tree") /
                             entry.path().filename());
    return files;
}

TEST(Packages, HoldEveryInstalledFileOnce)
{
    std::set<std::string> packed;
    for (std::string const& package : packages())
        for (std::string const& file : installed({"--component", package}))
            EXPECT_TRUE(packed.insert(file).second) << file << " is in two packages";
    EXPECT_EQ(packed, installed({}));
    EXPECT_FALSE(packed.empty());
}

} // namespace packages_test
