// The tree that `cmake --install` makes, used as docs/writing-a-host.md shows.

#include "TestPaths.h"
#include "tests/support/Lines.h"
#include "tests/support/Program.h"
#include "tests/support/ScratchFolder.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>

namespace installed_tree_test
{

namespace fs = std::filesystem;

/** The block of writing-a-host.md in this language that holds this text. */
std::string blockOf(std::string const& language, std::string const& text)
{
    std::string const page = contentOf(DOCS_DIR "/writing-a-host.md");
    std::size_t const start = page.rfind("```" + language + '\n', page.find(text));
    std::size_t const first = page.find('\n', start) + 1;
    return page.substr(first, page.find("```", first) - first);
}

/** An installed tree that was moved after installing; made on first use. */
fs::path prefix()
{
    static ScratchFolder const folder;
    static bool const isInstalled = [] {
        std::string const first = folder.path("first");
        Outcome const outcome =
            runToEnd({"/usr/bin/env", "cmake", "--install", BUILD_DIR, "--prefix", first});
        EXPECT_EQ(outcome.code, 0) << outcome.out << outcome.err;
        fs::rename(first, folder.path("tree"));
        return true;
    }();
    EXPECT_TRUE(isInstalled);
    return folder.path("tree");
}

fs::path libraries()
{
    return prefix() / LIBRARY_DIR;
}

/** That tree, and a working directory for a host. */
class InstalledTree : public testing::Test
{
protected:
    InstalledTree()
    {
        fs::copy(prefix() / "share/doc/mihost/examples", work());
    }

    fs::path work() const
    {
        return folder_.path("work");
    }

    /** Runs shell lines of the page; the first failure ends them and is reported. */
    std::string shell(std::string const& lines) const
    {
        Outcome const outcome =
            runToEnd({"/bin/sh", "-ec", "cd '" + work().string() + "'\n" + lines});
        EXPECT_EQ(outcome.code, 0) << lines << outcome.out << outcome.err;
        return outcome.out;
    }

private:
    ScratchFolder const folder_;
};

constexpr char topOfTheTree[] = "1 OsSw Management Interface\n"
                                "  2 ROOT Node\n"
                                "    3 Computer\n"
                                "      4 Operating System\n";

TEST_F(InstalledTree, HasTheUsualDirectories)
{
    for (char const* file :
         {"include/mihost/host/OpenMI.h", "include/mihost/host/Properties.h",
          "include/mihost/host/Methods.h", "include/mihost/mihost/runtime/Runtime.h",
          "share/man/man7/libzorvvxicosswmi.7", "share/man/man7/libmihostcheck.7"})
        EXPECT_TRUE(fs::is_regular_file(prefix() / file)) << file;
    for (char const* file :
         {"libzorvvxicosswmi.so.1", "libmihost.so", "libmihost.so.0", "libmihostcheck.so",
          "pkgconfig/mihost.pc", "pkgconfig/mihost-headers.pc"})
        EXPECT_TRUE(fs::is_regular_file(libraries() / file)) << file;
}

#ifdef HAS_MIHOST
TEST_F(InstalledTree, RunsMihostWithItsOwnPlugin)
{
    for (char const* file : {"bin/mihost", "share/man/man1/mihost.1"})
        EXPECT_TRUE(fs::is_regular_file(prefix() / file)) << file;
    Outcome const outcome = runToEnd({prefix() / "bin/mihost", "get", "os", "os-name"});
    EXPECT_EQ(outcome.code, 0) << outcome.err;
    EXPECT_NE(outcome.out, "");
}
#else
TEST_F(InstalledTree, LacksTheProgramsFilesIfItIsNotBuilt)
{
    for (char const* file :
         {"bin", "share/man/man1", "share/bash-completion", "share/zsh", "share/fish"})
        EXPECT_FALSE(fs::exists(prefix() / file)) << file;
}
#endif

#ifdef ACCEL_FILE
TEST_F(InstalledTree, RunsMihostWithItsOwnAccelerator)
{
    EXPECT_TRUE(fs::is_regular_file(libraries() / "libmiaccel.so"));
    EXPECT_TRUE(fs::is_regular_file(prefix() / "include/mihost/mihost/accel/Accel.h"));
    Outcome const outcome = runToEnd({prefix() / "bin/mihost", "--timing", "get", "os", "os-name"});
    EXPECT_EQ(outcome.code, 0) << outcome.err;
}
#endif

/** Runs the page's lines for a compiler and pkg-config, with the compiler of this build. */
class PkgConfig : public InstalledTree
{
protected:
    PkgConfig()
    {
        setenv("PKG_CONFIG_PATH", (libraries() / "pkgconfig").c_str(), 1);
        setenv("LD_LIBRARY_PATH", libraries().c_str(), 1);
        std::ofstream(work() / "g++") << "#!/bin/sh\nexec '" << HOST_COMPILER_PROGRAM << "' "
                                      << HOST_COMPILER_FLAGS << " \"$@\"\n";
        fs::permissions(work() / "g++", fs::perms::owner_all);
    }

    std::string build(std::string const& text, std::string const& then = "") const
    {
        return shell("PATH=.:$PATH\n" + blockOf("sh", text) + then);
    }
};

TEST_F(PkgConfig, GivesAHostHeadersAndRuntime)
{
    std::string const tree = build("--libs mihost)");
    EXPECT_EQ(tree.find(topOfTheTree), 0U) << tree;
}

TEST_F(PkgConfig, GivesAFrameworkOnlyTheHeaders)
{
    build("mihost-headers");
    EXPECT_TRUE(fs::is_regular_file(work() / "own_framework.o"));
    EXPECT_EQ(shell("pkg-config --libs mihost-headers"), "\n");
}

#ifdef ACCEL_FILE
TEST_F(PkgConfig, GivesAHostTheAccelerator)
{
    std::string const tree = build("--libs mihost miaccel)", "readelf -d fast_host\n./fast_host\n");
    EXPECT_NE(tree.find("[libmiaccel.so.0]"), std::string::npos) << tree;
    EXPECT_NE(tree.find(topOfTheTree), std::string::npos) << tree;
}
#endif

/** Builds the page's lines for CMake with the compiler of this build. */
class FindPackage : public InstalledTree
{
protected:
    std::string build(std::string const& text, std::string const& then) const
    {
        std::ofstream(work() / "CMakeLists.txt")
            << "cmake_minimum_required(VERSION 3.25)\nproject(host LANGUAGES CXX)\n"
            << blockOf("cmake", text);
        return shell("cmake -G Ninja -S . -B build -DCMAKE_PREFIX_PATH='" + prefix().string() +
                     "' -DCMAKE_CXX_COMPILER='" HOST_COMPILER_PROGRAM
                     "' -DCMAKE_CXX_FLAGS='" HOST_COMPILER_FLAGS
                     "' -DCMAKE_EXE_LINKER_FLAGS='" HOST_LINKER_FLAGS "' >&2\n"
                     "cmake --build build >&2\n" +
                     then);
    }
};

TEST_F(FindPackage, GivesAHostHeadersAndRuntime)
{
    std::string const tree = build("mihost::mihost)", "build/minimal_host");
    EXPECT_EQ(tree.find(topOfTheTree), 0U) << tree;
}

TEST_F(FindPackage, GivesAFrameworkOnlyTheHeaders)
{
    build("mihost::headers)", "test -f build/CMakeFiles/own_framework.dir/own_framework.cpp.o");
}

#ifdef ACCEL_FILE
TEST_F(FindPackage, GivesAHostTheAccelerator)
{
    std::string const tree =
        build("mihost::miaccel)", "readelf -d build/fast_host\nbuild/fast_host\n");
    EXPECT_NE(tree.find("[libmiaccel.so.0]"), std::string::npos) << tree;
    EXPECT_NE(tree.find(topOfTheTree), std::string::npos) << tree;
}
#endif

} // namespace installed_tree_test
