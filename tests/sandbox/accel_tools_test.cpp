// On a machine whose shell or tools are not as their packages installed them, those that are there
// have the word.

#include "tests/support/BothWays.h"
#include "tests/support/KernelModules.h"
#include "tests/support/Machine.h"

#include <cstdlib>
#include <filesystem>
#include <gtest/gtest.h>

namespace
{

using bothways::answered;
using bothways::real;

namespace fs = std::filesystem;

char const* const count = "wc -l /etc/hostname";

TEST(AccelTools, AnswerOnTheMachineAsItIs)
{
    machine::write("/etc/hostname", "name\n");
    EXPECT_EQ(answered(count), real(count));
    EXPECT_TRUE(answered("date"));
}

TEST(AccelTools, StepAsideForARecordedShell)
{
    ASSERT_TRUE(answered(count));
    machine::recordShell();
    EXPECT_FALSE(answered(count));
    EXPECT_FALSE(answered("date"));
}

TEST(AccelTools, StepAsideForARecordedTool)
{
    ASSERT_TRUE(answered(count));
    machine::record("/usr/bin/wc");
    EXPECT_FALSE(answered(count));
    EXPECT_TRUE(answered("date"));
}

TEST(AccelTools, StepAsideForAToolThatWasChangedInItsPlace)
{
    std::string wc = machine::read("/usr/bin/wc");
    ASSERT_TRUE(answered(count));
    wc.back() = static_cast<char>(wc.back() ^ 1);
    machine::write("/usr/bin/wc", wc, 0755);
    EXPECT_FALSE(answered(count));
}

TEST(AccelTools, AnswerAgainOnceAToolIsItselfAgain)
{
    std::string const wc = machine::read("/usr/bin/wc");
    machine::fake("/usr/bin/wc", "echo stand-in\n");
    EXPECT_FALSE(answered(count));
    machine::write("/usr/bin/wc", wc, 0755);
    EXPECT_EQ(answered(count), real(count));
}

TEST(AccelTools, StepAsideForAToolThatMayNotBeRun)
{
    ASSERT_TRUE(answered(count));
    fs::permissions("/usr/bin/wc", fs::perms::owner_read);
    EXPECT_FALSE(answered(count));
}

TEST(AccelTools, StepAsideForAToolThatIsGone)
{
    machine::remove("/usr/bin/wc");
    EXPECT_FALSE(answered(count));
}

TEST(AccelTools, AnswerWhereTheShellIsBash)
{
    machine::remove("/bin/sh");
    fs::create_symlink("bash", "/bin/sh");
    EXPECT_EQ(answered(count), real(count));
    setenv("BASH_FUNC_wc%%", "() { echo function; }", 1);
    EXPECT_EQ(real(count), "function\n");
    EXPECT_FALSE(answered(count));
}

TEST(AccelTools, StepAsideForAnyOtherShell)
{
    machine::remove("/bin/sh");
    EXPECT_FALSE(answered(count));
    fs::create_symlink("busybox", "/bin/sh");
    EXPECT_FALSE(answered(count));
    machine::write("/usr/bin/busybox", "#!/bin/bash\n", 0755);
    EXPECT_FALSE(answered(count));
}

TEST(AccelTools, StepAsideForToolsOfVersionsThatAreNotKnown)
{
    std::string status = machine::read("/var/lib/dpkg/status");
    std::string const head = "\nPackage: coreutils\n";
    auto const version = status.find("\nVersion: ", status.find(head));
    status.insert(version + 10, "1");
    machine::write("/var/lib/dpkg/status", status);
    EXPECT_FALSE(answered(count));
}

TEST(AccelTools, StepAsideWhereNoPackagesAreKnown)
{
    machine::remove("/var/lib/dpkg/status");
    EXPECT_FALSE(answered(count));
}

TEST(AccelTools, StepAsideForALibraryThatIsPutIntoEveryProgram)
{
    ASSERT_TRUE(answered(count));
    machine::write("/etc/ld.so.preload", "");
    EXPECT_TRUE(answered(count));
    machine::write("/etc/ld.so.preload", "/nonexistent.so\n");
    EXPECT_FALSE(answered(count));
}

TEST(AccelTools, StepAsideForModulesWhereLibkmodChangedSinceTheStart)
{
    kernelModules::load({});
    ASSERT_TRUE(answered("lsmod"));
    ASSERT_EQ(std::system("library=$(readlink -f /usr/lib/*/libkmod.so.2) && "
                          "cp -a $library /tmp/library && mv /tmp/library $library"),
              0);
    EXPECT_FALSE(answered("lsmod"));
    EXPECT_TRUE(answered(count));
}

} // namespace
