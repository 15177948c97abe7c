// Whenever the shell could run something else, the real popen is called.

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

namespace fs = std::filesystem;

/** A file whose lines wc counts, run or answered by the accelerator. */
class AccelTrust : public testing::Test
{
protected:
    /** @param variable  NAME=VALUE, set until the test ends */
    bool isAnsweredWith(std::string const& variable) const
    {
        std::size_t const end = variable.find('=');
        setenv(variable.substr(0, end).c_str(), variable.substr(end + 1).c_str(), 1);
        return answered(wc_).has_value();
    }

    ScratchFolder const folder_;
    std::string const log_ = folder_.write("log", "1\n2\n");
    std::string const wc_ = "wc -l " + log_;
};

TEST_F(AccelTrust, EndsWhenPathFindsTheToolElsewhereFirst)
{
    EXPECT_EQ(answered(wc_), real(wc_));
    std::string const tool = folder_.write("bin/wc", "#!/bin/sh\necho fake\n");
    fs::permissions(tool, fs::perms::owner_all);
    EXPECT_TRUE(isAnsweredWith("PATH=/nonexistent:" + log_ + ":/usr/bin:" + folder_.path("bin")));
    EXPECT_EQ(answered(wc_), real(wc_));
    EXPECT_FALSE(isAnsweredWith("PATH=" + folder_.path("bin") + ":/usr/bin:/bin"));
    EXPECT_EQ(real(wc_), "fake\n");
    EXPECT_EQ(reasonOf("wc"), "PATH does not find the tool in a system directory");
    EXPECT_TRUE(answered("date"));
    fs::remove(tool);
    EXPECT_TRUE(answered(wc_));
    fs::copy_file("/usr/bin/wc", tool);
    EXPECT_FALSE(answered(wc_));
    fs::remove(tool);
    fs::create_symlink("/usr/bin/wc", tool);
    EXPECT_FALSE(answered(wc_));
    fs::remove(tool);
    fs::create_directory(tool);
    EXPECT_FALSE(answered(wc_));
}

TEST_F(AccelTrust, EndsForARelativeOrOddPath)
{
    for (char const* path : {"PATH=", "PATH=:", "PATH=:/usr/bin", "PATH=.:/usr/bin",
                             "PATH=bin:/usr/bin", "PATH=~/bin:/usr/bin", "PATH=/nonexistent",
                             "PATH=/x%func:/usr/bin", "PATH=/nonexistent:"})
        EXPECT_FALSE(isAnsweredWith(path)) << path;
    unsetenv("PATH");
    EXPECT_FALSE(answered(wc_));
    EXPECT_TRUE(isAnsweredWith("PATH=/nonexistent:/usr/bin"));
}

TEST_F(AccelTrust, EndsWithAVariableThatChangesWhatRuns)
{
    for (std::string const variable :
         {"ENV=/tmp/x", "BASH_ENV=/tmp/x", "BASH_FUNC_wc%%=() { echo x; }", "wc=() { echo x; }",
          "SHELLOPTS=noexec", "BASHOPTS=extdebug", "LD_PRELOAD=/nonexistent.so",
          "LD_LIBRARY_PATH=/opt/agent/lib", "LD_AUDIT=/tmp/x.so"}) {
        EXPECT_FALSE(isAnsweredWith(variable)) << variable;
        unsetenv(variable.substr(0, variable.find('=')).c_str());
        EXPECT_TRUE(answered(wc_)) << variable;
    }
}

TEST_F(AccelTrust, StaysWithVariablesThatChangeNothing)
{
    folder_.append("log", "3");
    std::string const sed = "sed -n '2p' " + log_;
    for (char const* variable :
         {"POSIXLY_CORRECT=1", "LANG=de_DE.UTF-8", "TZ=A", "IFS=w", "ENVIRONMENT=x",
          "OLD_PRELOAD=x", "GLIBC_TUNABLES=glibc.malloc.check=3", "LDAP=x"}) {
        EXPECT_TRUE(isAnsweredWith(variable)) << variable;
        EXPECT_EQ(answered(wc_), real(wc_)) << variable;
        EXPECT_EQ(answered(sed), real(sed)) << variable;
    }
}

TEST_F(AccelTrust, EndsInAProcessWithTwoIdentities)
{
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
    EXPECT_EQ(countOf("wc").ran, wc.ran + 1);
    EXPECT_EQ(reasonOf("wc"), "the file cannot be read");
    EXPECT_EQ(countOf("sed").answered, sed.answered);
    EXPECT_EQ(countOf("sed").ran, sed.ran);
    EXPECT_EQ(countOf("other").ran, other.ran + 1);
}

TEST(AccelCounts, HaveAFixedOrderAndStopAtTheCallersLimit)
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
    unsigned long const before = countOf("wc").ran;
    EXPECT_EQ(miaccel_enable(0), 1);
    EXPECT_FALSE(answered(wc_));
    EXPECT_EQ(countOf("wc").ran, before);
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
