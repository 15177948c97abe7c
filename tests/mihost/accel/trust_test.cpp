// Whenever the shell could run something else, the real popen is called.

#include "tests/interpose/Libc.h"
#include "tests/support/BothWays.h"
#include "tests/support/ScratchFolder.h"

#include <cstdlib>
#include <filesystem>
#include <gtest/gtest.h>

namespace trust_test
{

using bothways::answered;
using bothways::countOf;
using bothways::real;
using bothways::reasonOf;

/** A file whose lines are counted in both ways. */
class AccelTrust : public testing::Test
{
protected:
    /** A script in wc's place. @return its folder */
    std::string fakeWc() const
    {
        folder_.write("bin/wc", "#!/bin/sh\necho fake\n");
        std::filesystem::permissions(folder_.path("bin/wc"), std::filesystem::perms::owner_all);
        return folder_.path("bin");
    }

    ScratchFolder const folder_;
    std::string const wc_ = "wc -l " + folder_.write("log", "1\n2\n");
};

TEST_F(AccelTrust, IsThereOnTheMachineAsItIs)
{
    EXPECT_EQ(answered(wc_), real(wc_));
}

TEST_F(AccelTrust, EndsWhenPathFindsTheToolElsewhereFirst)
{
    setenv("PATH", (fakeWc() + ":/usr/bin:/bin").c_str(), 1);
    EXPECT_EQ(real(wc_), "fake\n");
    EXPECT_FALSE(answered(wc_));
    EXPECT_EQ(reasonOf("wc"), "PATH does not find the tool in a system directory");
    EXPECT_TRUE(answered("date"));
}

TEST_F(AccelTrust, StaysWhenPathFindsTheToolElsewhereLater)
{
    setenv("PATH", ("/nonexistent:" + folder_.path("log") + ":/usr/bin:" + fakeWc()).c_str(), 1);
    EXPECT_EQ(answered(wc_), real(wc_));
}

TEST_F(AccelTrust, EndsForTheToolsNameElsewhere)
{
    std::filesystem::create_directory(folder_.path("bin"));
    std::string const wc = folder_.path("bin/wc");
    setenv("PATH", (folder_.path("bin") + ":/usr/bin").c_str(), 1);
    std::filesystem::copy_file("/usr/bin/wc", wc);
    EXPECT_FALSE(answered(wc_));
    std::filesystem::remove(wc);
    std::filesystem::create_symlink("/usr/bin/wc", wc);
    EXPECT_FALSE(answered(wc_));
    std::filesystem::remove(wc);
    EXPECT_TRUE(answered(wc_));
    std::filesystem::create_directory(wc);
    EXPECT_FALSE(answered(wc_));
}

TEST_F(AccelTrust, EndsForAPathThatIsNotPlainlyAbsolute)
{
    for (char const* path : {"", ":", ":/usr/bin", ".:/usr/bin", "bin:/usr/bin", "~/bin:/usr/bin",
                             "/nonexistent", "/x%func:/usr/bin", "/nonexistent:"}) {
        setenv("PATH", path, 1);
        EXPECT_FALSE(answered(wc_)) << path;
    }
    unsetenv("PATH");
    EXPECT_FALSE(answered(wc_));
    setenv("PATH", "/nonexistent:/usr/bin", 1);
    EXPECT_TRUE(answered(wc_));
}

struct Variable {
    char const* name;
    char const* value;
};

TEST_F(AccelTrust, EndsWithAVariableThatChangesWhatRuns)
{
    for (Variable const& variable :
         {Variable{"ENV", "/tmp/x"}, Variable{"BASH_ENV", "/tmp/x"},
          Variable{"BASH_FUNC_wc%%", "() { echo x; }"}, Variable{"wc", "() { echo x; }"},
          Variable{"SHELLOPTS", "noexec"}, Variable{"BASHOPTS", "extdebug"},
          Variable{"LD_PRELOAD", "/nonexistent.so"}, Variable{"LD_LIBRARY_PATH", "/opt/agent/lib"},
          Variable{"LD_AUDIT", "/tmp/x.so"}}) {
        setenv(variable.name, variable.value, 1);
        EXPECT_FALSE(answered(wc_)) << variable.name;
        unsetenv(variable.name);
        EXPECT_TRUE(answered(wc_)) << variable.name;
    }
}

TEST_F(AccelTrust, StaysWithVariablesThatChangeNothing)
{
    folder_.append("log", "3");
    std::string const sed = "sed -n '2p' " + folder_.path("log");
    for (Variable const& variable :
         {Variable{"POSIXLY_CORRECT", "1"}, Variable{"LANG", "de_DE.UTF-8"}, Variable{"TZ", "A"},
          Variable{"IFS", "w"}, Variable{"ENVIRONMENT", "x"}, Variable{"OLD_PRELOAD", "x"},
          Variable{"GLIBC_TUNABLES", "glibc.malloc.check=3"}, Variable{"LDAP", "x"}}) {
        setenv(variable.name, variable.value, 1);
        EXPECT_EQ(answered(wc_), real(wc_)) << variable.name;
        EXPECT_EQ(answered(sed), real(sed)) << variable.name;
        unsetenv(variable.name);
    }
}

TEST_F(AccelTrust, EndsInAProcessWithTwoIdentities)
{
    libc::HookGuard const guard;
    libc::hooks().geteuid = [] { return getuid() + 1; };
    EXPECT_FALSE(answered(wc_));
}

TEST_F(AccelTrust, IsCountedForEachCommandWithItsReason)
{
    miaccel_count const wc = countOf("wc");
    miaccel_count const sed = countOf("sed");
    miaccel_count const other = countOf("other");
    answered(wc_);
    answered(wc_);
    answered("wc -l /nonexistent");
    answered("chage -l root");
    EXPECT_EQ(countOf("wc").answered, wc.answered + 2);
    EXPECT_EQ(countOf("wc").handed_on, wc.handed_on + 1);
    EXPECT_EQ(reasonOf("wc"), "the file cannot be read");
    EXPECT_EQ(countOf("sed").answered, sed.answered);
    EXPECT_EQ(countOf("sed").handed_on, sed.handed_on);
    EXPECT_EQ(countOf("other").handed_on, other.handed_on + 1);
}

TEST(AccelCounts, AreInAFixedOrderAndAsManyAsThereIsRoomFor)
{
    EXPECT_EQ(miaccel_counts(nullptr, 0), 6U);
    miaccel_count counts[6] = {};
    miaccel_counts(counts, 2);
    EXPECT_EQ(counts[2].command, nullptr);
    miaccel_counts(counts, 6);
    char const* const names[] = {"wc", "sed", "date", "lsmod", "modinfo", "other"};
    for (std::size_t row = 0; row < 6; ++row)
        EXPECT_STREQ(counts[row].command, names[row]);
}

TEST_F(AccelTrust, IsNeitherUsedNorCountedWhileTurnedOff)
{
    unsigned long const before = countOf("wc").handed_on;
    EXPECT_EQ(miaccel_enable(0), 1);
    EXPECT_FALSE(answered(wc_));
    EXPECT_EQ(countOf("wc").handed_on, before);
    EXPECT_EQ(miaccel_enable(1), 0);
    EXPECT_TRUE(answered(wc_));
}

TEST_F(AccelTrust, IsUsedForReadingOnly)
{
    for (char const* mode : {"w", "r+", ""})
        EXPECT_FALSE(miaccel::openAnswer(wc_.c_str(), mode));
    FILE* const stream = miaccel::openAnswer(wc_.c_str(), "re");
    ASSERT_TRUE(stream);
    std::fclose(stream);
}

} // namespace trust_test
