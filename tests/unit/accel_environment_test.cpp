// Where the shell could run something else, or the command print something else, the real popen
// is asked.

#include "mihost/accel/Accel.h"
#include "mihost/accel/Environment.h"
#include "tests/support/BothWays.h"
#include "tests/support/ScratchFolder.h"
#include "tests/unit/AccelStandIns.h"

#include <cstdlib>
#include <filesystem>
#include <gtest/gtest.h>

namespace
{

using bothways::answered;
using bothways::real;

/** A file whose lines are counted in both ways. */
class AccelEnvironment : public testing::Test
{
protected:
    std::string command() const
    {
        return "wc -l " + log_;
    }

    ScratchFolder folder_;
    std::string log_ = folder_.write("log", "1\n2\n");
};

/** A script in the place of wc. */
std::string standIn(ScratchFolder const& folder, std::string const& name)
{
    std::string bin = folder.path(name);
    std::filesystem::create_directory(bin);
    folder.write(name + "/wc", "#!/bin/sh\necho stand-in\n");
    std::filesystem::permissions(bin + "/wc", std::filesystem::perms::owner_all);
    return bin;
}

TEST_F(AccelEnvironment, IsFineAsItIs)
{
    EXPECT_EQ(answered(command()), real(command()));
}

TEST_F(AccelEnvironment, WithAStandInAheadInPathLetsItWin)
{
    setenv("PATH", (standIn(folder_, "bin") + ":/usr/bin:/bin").c_str(), 1);
    EXPECT_EQ(real(command()), "stand-in\n");
    EXPECT_FALSE(answered(command()));
    EXPECT_TRUE(answered("date"));
}

TEST_F(AccelEnvironment, WithAStandInBehindTheToolDoesNotMatter)
{
    setenv("PATH", ("/usr/bin:" + standIn(folder_, "bin")).c_str(), 1);
    EXPECT_EQ(answered(command()), real(command()));
}

TEST_F(AccelEnvironment, WithALinkToTheToolLeadsToTheTool)
{
    std::filesystem::create_directory(folder_.path("bin"));
    std::filesystem::create_symlink("/usr/bin/wc", folder_.path("bin/wc"));
    setenv("PATH", (folder_.path("bin") + ":/usr/bin").c_str(), 1);
    EXPECT_EQ(answered(command()), real(command()));
}

TEST_F(AccelEnvironment, WithALinkToAnotherToolLeadsThere)
{
    std::filesystem::create_directory(folder_.path("bin"));
    std::filesystem::create_symlink("/usr/bin/date", folder_.path("bin/wc"));
    setenv("PATH", (folder_.path("bin") + ":/usr/bin").c_str(), 1);
    EXPECT_FALSE(answered(command()));
}

TEST_F(AccelEnvironment, WithACopyOfTheToolIsNotTheTool)
{
    std::filesystem::create_directory(folder_.path("bin"));
    std::filesystem::copy_file("/usr/bin/wc", folder_.path("bin/wc"));
    setenv("PATH", (folder_.path("bin") + ":/usr/bin").c_str(), 1);
    EXPECT_FALSE(answered(command()));
}

TEST_F(AccelEnvironment, WithSomethingInTheWayThatIsNoProgramIsLeftToTheShell)
{
    std::filesystem::create_directories(folder_.path("bin/wc"));
    setenv("PATH", (folder_.path("bin") + ":/usr/bin").c_str(), 1);
    EXPECT_FALSE(answered(command()));
}

TEST_F(AccelEnvironment, WithFoldersThatAreNotThereGoesOnToTheNext)
{
    setenv("PATH", ("/nonexistent:" + log_ + ":/usr/bin").c_str(), 1);
    EXPECT_EQ(answered(command()), real(command()));
}

TEST_F(AccelEnvironment, WithAPathThatIsNotPlainlyAbsoluteIsLeftToTheShell)
{
    for (char const* path :
         {"", ":", ":/usr/bin", ".:/usr/bin", "bin:/usr/bin", "~/bin:/usr/bin", "/nonexistent",
          "/x%func:/usr/bin", "/usr/bin%builtin", "/nonexistent:"}) {
        setenv("PATH", path, 1);
        EXPECT_FALSE(answered("date")) << path;
    }
    setenv("PATH", "/nonexistent:/usr/bin", 1);
    EXPECT_TRUE(answered("date"));
}

TEST_F(AccelEnvironment, WithoutPathIsLeftToTheShell)
{
    unsetenv("PATH");
    EXPECT_FALSE(answered(command()));
}

TEST_F(AccelEnvironment, WithAVariableThatChangesShellOrToolsIsLeftToTheShell)
{
    struct Variable {
        char const* name;
        char const* value;
    };
    for (Variable const& variable : {Variable{"ENV", "/tmp/x"},
                                     Variable{"BASH_ENV", "/tmp/x"},
                                     Variable{"BASH_FUNC_wc%%", "() { echo x; }"},
                                     Variable{"wc", "() { echo x; }"},
                                     Variable{"SHELLOPTS", "xtrace"},
                                     Variable{"BASHOPTS", "extglob"},
                                     Variable{"POSIXLY_CORRECT", ""},
                                     Variable{"POSIXLY_CORRECT", "1"},
                                     Variable{"LD_PRELOAD", "libfaketime.so.1"},
                                     Variable{"LD_PRELOAD", "/nonexistent.so"},
                                     Variable{"LD_LIBRARY_PATH", "/opt/agent/lib"},
                                     Variable{"LD_AUDIT", "/tmp/x.so"},
                                     Variable{"LD_DEBUG", "all"},
                                     Variable{"GLIBC_TUNABLES", "glibc.malloc.check=3"},
                                     Variable{"MALLOC_CHECK_", "3"},
                                     Variable{"GCONV_PATH", "/tmp"},
                                     Variable{"LOCPATH", "/tmp"},
                                     Variable{"NLSPATH", "/tmp"},
                                     Variable{"TZDIR", "/tmp"},
                                     Variable{"KMOD_LOG", "debug"}}) {
        setenv(variable.name, variable.value, 1);
        EXPECT_FALSE(answered("date")) << variable.name;
        EXPECT_FALSE(answered(command())) << variable.name;
        unsetenv(variable.name);
        EXPECT_TRUE(answered("date")) << variable.name;
    }
}

TEST_F(AccelEnvironment, WithOrdinaryVariablesIsFine)
{
    for (char const* variable :
         {"LANG=de_DE.UTF-8", "HOME=/", "ENVIRONMENT=x", "OLD_PRELOAD=x", "LDAP=x", "X=ENV="})
        EXPECT_FALSE(miaccel::isDisturbing(variable)) << variable;
}

TEST_F(AccelEnvironment, OfAProcessWithTwoIdentitiesIsLeftToTheShell)
{
    accelStandIns::Guard const guard;
    accelStandIns::hooks().geteuid = [] { return getuid() + 1; };
    EXPECT_FALSE(answered(command()));
}

miaccel_count countOf(std::string const& command)
{
    miaccel_count counts[16];
    std::size_t const rows = miaccel_counts(counts, std::size(counts));
    for (std::size_t row = 0; row < rows; ++row)
        if (command == counts[row].command)
            return counts[row];
    throw std::out_of_range(command);
}

TEST(AccelCounts, TellHowEachCommandWasAnswered)
{
    ScratchFolder const folder;
    answered("wc -l " + folder.write("log", ""));
    answered("wc -l " + folder.path("log"));
    answered("wc -l /nonexistent");
    answered("chage -l root");
    EXPECT_EQ(countOf("wc").answered, 2U);
    EXPECT_EQ(countOf("wc").handed_on, 1U);
    EXPECT_STREQ(countOf("wc").reason, "the file cannot be read");
    EXPECT_EQ(countOf("date").answered, 0U);
    EXPECT_EQ(countOf("date").handed_on, 0U);
    EXPECT_EQ(countOf("date").reason, nullptr);
    EXPECT_EQ(countOf("other").answered, 0U);
    EXPECT_EQ(countOf("other").handed_on, 1U);
}

TEST(AccelCounts, NameTheCommandsInAFixedOrder)
{
    miaccel_count counts[6];
    ASSERT_EQ(miaccel_counts(counts, 6), 6U);
    char const* const names[] = {"wc", "sed", "date", "lsmod", "modinfo", "other"};
    for (std::size_t row = 0; row < 6; ++row)
        EXPECT_STREQ(counts[row].command, names[row]);
}

TEST(AccelCounts, WriteNoMoreRowsThanThereIsRoomFor)
{
    miaccel_count counts[3] = {};
    EXPECT_EQ(miaccel_counts(counts, 2), 6U);
    EXPECT_STREQ(counts[1].command, "sed");
    EXPECT_EQ(counts[2].command, nullptr);
    EXPECT_EQ(miaccel_counts(nullptr, 0), 6U);
}

TEST(AccelEnabling, LeavesAndCountsNothingWhileItIsOff)
{
    EXPECT_EQ(miaccel_enable(0), 1);
    EXPECT_FALSE(answered("date"));
    EXPECT_EQ(countOf("date").handed_on, 0U);
    EXPECT_EQ(miaccel_enable(1), 0);
    EXPECT_TRUE(answered("date"));
    EXPECT_EQ(countOf("date").answered, 1U);
}

TEST(AccelModes, AreThoseOfReading)
{
    EXPECT_FALSE(miaccel::openAnswer("date", "w"));
    EXPECT_FALSE(miaccel::openAnswer("date", "r+"));
    EXPECT_FALSE(miaccel::openAnswer("date", ""));
    FILE* const stream = miaccel::openAnswer("date", "re");
    ASSERT_TRUE(stream);
    std::fclose(stream);
}

} // namespace
