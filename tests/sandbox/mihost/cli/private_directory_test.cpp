// The directory that mihost works in may hold a password hash, so nothing of it may stay.

#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"

#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <unistd.h>

namespace private_directory_test
{

namespace fs = std::filesystem;

constexpr char parent[] = "/tmp/private";
constexpr char hash[] = "$6$saltsalt$hashhashhash\n";
constexpr uid_t somebody = 65534;

Outcome bash(std::string const& line)
{
    return bashRun(line, hash);
}

class MihostPrivateDirectory : public testing::Test
{
protected:
    MihostPrivateDirectory()
    {
        machine::lay("small");
        fs::create_directory(parent);
        setenv("TMPDIR", parent, 1);
    }

    static void fakeChpasswd(std::string const& script)
    {
        machine::fake("/usr/sbin/chpasswd", script);
    }

    static std::vector<fs::path> found()
    {
        std::vector<fs::path> paths;
        for (auto const& entry : fs::directory_iterator(parent))
            paths.push_back(entry.path());
        return paths;
    }

    /** A directory that a start of the program left, whose process has ended. */
    static std::string makeLeft(std::string const& name, fs::perms mode = fs::perms::owner_all)
    {
        std::string const path = std::string(parent) + "/" + name;
        fs::create_directory(path);
        fs::permissions(path, mode);
        machine::write(path + "/mihost.lock", "");
        machine::write(path + "/usrandpwd", hash);
        return path;
    }

    static void startAgain()
    {
        EXPECT_EQ(mihostRun({"get", "os", "108"}).code, 0);
    }
};

TEST_F(MihostPrivateDirectory, OfAKilledStartIsRemovedByTheNext)
{
    fakeChpasswd("read -r self name state mihost rest </proc/$PPID/stat\n"
                 "kill -9 $mihost $PPID\n");
    EXPECT_EQ(bash("$mihost set user:jdoe password -").code, 128 + SIGKILL);
    ASSERT_EQ(found().size(), 1U);
    EXPECT_EQ(machine::read(found()[0] / "usrandpwd"), std::string("jdoe:") + hash);
    startAgain();
    EXPECT_EQ(found().size(), 0U);
}

TEST_F(MihostPrivateDirectory, OfARunningStartIsKept)
{
    Outcome const outcome = bash("coproc $mihost shell\n"
                                 "echo get os 108 >&${COPROC[1]}; read -u ${COPROC[0]}\n"
                                 "ls $TMPDIR >/tmp/before\n"
                                 "$mihost get os 108\n"
                                 "ls $TMPDIR >/tmp/after\n"
                                 "shell=$COPROC_PID; exec {COPROC[1]}>&-; wait $shell\n");
    EXPECT_EQ(outcome.out, "108 os-name  Linux\n");
    EXPECT_EQ(linesOf(machine::read("/tmp/before")).size(), 1U);
    EXPECT_EQ(machine::read("/tmp/after"), machine::read("/tmp/before"));
}

TEST_F(MihostPrivateDirectory, IsRemovedWithAllItsFiles)
{
    std::string const path = makeLeft("mihost-aB3dE6");
    machine::write(path + "/core", "memory");
    machine::write("/etc/victim", "precious");
    fs::create_symlink("/etc/victim", path + "/link");
    startAgain();
    EXPECT_FALSE(fs::exists(path));
    EXPECT_EQ(machine::read("/etc/victim"), "precious");
}

TEST_F(MihostPrivateDirectory, IsNotAnythingThatOnlyLooksLikeIt)
{
    std::string const open =
        makeLeft("mihost-open00", fs::perms::owner_all | fs::perms::group_exec);
    std::string const theirs = makeLeft("mihost-theirs");
    ASSERT_EQ(chown(theirs.c_str(), somebody, somebody), 0);
    std::string const other = makeLeft("mihost-other0");
    fs::remove(other + "/mihost.lock");
    std::string const elsewhere = makeLeft("elsewhere");
    fs::create_directory_symlink(elsewhere, std::string(parent) + "/mihost-linked");
    startAgain();
    for (std::string const& path : {open, theirs, other, elsewhere})
        EXPECT_TRUE(fs::exists(path + "/usrandpwd")) << path;
}

TEST_F(MihostPrivateDirectory, IsRemovedIfAFileGrowsTooLong)
{
#ifdef __SANITIZE_THREAD__
    GTEST_SKIP() << "this sanitizer makes files of its own before the program starts";
#endif
    for (char const* command : {"tree", "set user:jdoe password -", "--trace /tmp/trace tree"}) {
        Outcome const outcome =
            bash("ulimit -f 0; $mihost " + std::string(command) + " >/root/printed");
        EXPECT_LT(outcome.code, 128) << command;
        EXPECT_EQ(found().size(), 0U) << command;
    }
    Outcome const outcome = bash("(ulimit -f 0; exec $mihost tree 2>&1 >/root/printed) | cat");
    EXPECT_EQ(outcome.out, "mihost: cannot write the output: File too large\n");
}

TEST_F(MihostPrivateDirectory, LeavesTheFileSizeSignalToTheCommands)
{
    fakeChpasswd("grep SigIgn /proc/$$/status >/tmp/ignored\n");
    EXPECT_EQ(bash("$mihost set user:jdoe password -").code, 1); // it sets no password
    std::string const mask = machine::read("/tmp/ignored").substr(sizeof "SigIgn:");
    EXPECT_EQ(std::stoull(mask, nullptr, 16) & (1ULL << (SIGXFSZ - 1)), 0U) << mask;
}

TEST_F(MihostPrivateDirectory, IsRemovedIfDescriptorsRunOut)
{
#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
    GTEST_SKIP() << "a sanitizer needs descriptors for itself, and ends the program without them";
#endif
    for (int limit = 3; limit < 16; ++limit) {
        Outcome const outcome =
            bash("ulimit -n " + std::to_string(limit) + "; exec $mihost set user:jdoe password -");
        EXPECT_LT(outcome.code, 128) << limit << outcome.err;
        EXPECT_EQ(found().size(), 0U) << limit;
    }
}

} // namespace private_directory_test
