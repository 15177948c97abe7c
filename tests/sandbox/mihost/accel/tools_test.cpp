// On a machine with other shells and tools, answers are those of the ones that are there.

#include "tests/support/ComparedLog.h"
#include "tests/support/KernelModules.h"
#include "tests/support/Machine.h"

#include <cstdlib>
#include <filesystem>
#include <unistd.h>

namespace tools_test
{

using bothways::answered;
using bothways::real;
using bothways::reasonOf;

namespace fs = std::filesystem;

char const* const count = "wc -l /etc/hostname";
char const* const replaceable = "users other than root can replace the shell or the tool";

/** A machine on which everything is answered at first. */
class AccelTools : public testing::Test
{
protected:
    AccelTools()
    {
        machine::write("/etc/hostname", "name\n");
        EXPECT_EQ(answered(count), real(count));
        EXPECT_TRUE(answered("date"));
    }
};

void link(std::string const& program, std::string const& target)
{
    machine::remove(program);
    fs::create_symlink(target, program);
}

TEST_F(AccelTools, AreRunWhenTheyAreScripts)
{
    machine::fake("/usr/bin/wc", "echo fake\n");
    EXPECT_FALSE(answered(count));
    EXPECT_EQ(reasonOf("wc"), "the shell or the tool is a script");
    EXPECT_TRUE(answered("date"));
}

TEST_F(AccelTools, AreRunWhenOthersCanReplaceThem)
{
    ASSERT_EQ(chown("/usr/bin/wc", 1000, 0), 0);
    EXPECT_FALSE(answered(count));
    EXPECT_EQ(reasonOf("wc"), replaceable);
    ASSERT_EQ(chown("/usr/bin/wc", 0, 0), 0);
    for (fs::perms const others : {fs::perms::group_write, fs::perms::others_write})
        for (char const* path : {"/usr/bin/wc", "/usr/bin", "/bin/dash"}) {
            fs::perms const before = fs::status(path).permissions();
            fs::permissions(path, others, fs::perm_options::add);
            EXPECT_FALSE(answered(count)) << path;
            EXPECT_EQ(reasonOf("wc"), replaceable);
            fs::permissions(path, before);
            EXPECT_TRUE(answered(count));
        }
}

TEST_F(AccelTools, AreRunWhenALinkLeadsToAFolderThatOthersCanWrite)
{
    fs::create_directory("/opt/tools");
    fs::copy_file("/usr/bin/wc", "/opt/tools/wc");
    link("/usr/bin/wc", "/opt/tools/wc");
    EXPECT_TRUE(answered(count));
    fs::permissions("/opt/tools", fs::perms::others_write, fs::perm_options::add);
    EXPECT_FALSE(answered(count));
    EXPECT_EQ(reasonOf("wc"), replaceable);
}

TEST_F(AccelTools, AreRunWhenTheyCannotBeRun)
{
    fs::permissions("/usr/bin/wc", fs::perms::owner_read);
    EXPECT_FALSE(answered(count));
    machine::remove("/usr/bin/wc");
    EXPECT_FALSE(answered(count));
}

TEST_F(AccelTools, AreRunByAShellThatIsNotKnown)
{
    machine::recordShell();
    EXPECT_FALSE(answered(count));
    EXPECT_FALSE(answered("date"));
    machine::remove("/bin/sh");
    EXPECT_FALSE(answered(count));
    machine::write("/bin/sh", "#!/bin/bash\n", 0755);
    EXPECT_FALSE(answered(count));
}

TEST_F(AccelTools, AreAnsweredWhenTheShellIsBash)
{
    link("/bin/sh", "bash");
    EXPECT_EQ(answered(count), real(count));
    setenv("BASH_FUNC_wc%%", "() { echo function; }", 1);
    EXPECT_EQ(real(count), "function\n");
    EXPECT_FALSE(answered(count));
}

TEST_F(AccelTools, AreAnsweredWhenTheShellIsBusyboxButForModules)
{
    kernelModules::load({});
    EXPECT_TRUE(answered("lsmod"));
    link("/bin/sh", "busybox");
    EXPECT_EQ(answered(count), real(count));
    EXPECT_FALSE(answered("lsmod"));
}

TEST_F(AccelTools, OfModulesAreRunUnlessTheyAreLinksToKmod)
{
    kernelModules::load({});
    EXPECT_TRUE(answered("lsmod"));
    link("/usr/sbin/lsmod", "/usr/bin/busybox");
    EXPECT_FALSE(answered("lsmod"));
    EXPECT_EQ(reasonOf("lsmod"), "the tool is not a link to kmod");
    machine::remove("/usr/sbin/lsmod");
    fs::copy_file("/usr/bin/kmod", "/usr/sbin/lsmod");
    EXPECT_FALSE(answered("lsmod"));
    machine::fake("/usr/sbin/modinfo", "echo fake\n");
    EXPECT_FALSE(answered("modinfo ext4"));
}

TEST_F(AccelTools, AreRunWhenAnotherComesFirstInPath)
{
    machine::fake("/usr/local/bin/wc", "echo fake\n");
    setenv("PATH", "/usr/local/bin:/usr/sbin:/usr/bin", 1);
    EXPECT_EQ(real(count), "fake\n");
    EXPECT_FALSE(answered(count));
    EXPECT_TRUE(answered("date"));
}

/** A machine whose tools are those of busybox, as links or, hard to tell, as programs. */
class AccelBusybox : public testing::TestWithParam<bool>
{
protected:
    AccelBusybox()
    {
        for (char const* tool : {"/usr/bin/wc", "/usr/bin/sed", "/usr/bin/date"}) {
            machine::remove(tool);
            if (GetParam())
                fs::create_symlink("busybox", tool);
            else
                fs::create_hard_link("/usr/bin/busybox", tool);
        }
    }
};

INSTANTIATE_TEST_SUITE_P(Kinds, AccelBusybox, testing::Bool());

TEST_P(AccelBusybox, ReadsALogAsIsAnsweredWhateverHappensToIt)
{
    EXPECT_NE(real("sed --help").find("BusyBox"), std::string::npos);
    EXPECT_GT(percentOfSedsAnswered(8, 100), 50U);
}

TEST_P(AccelBusybox, PrintsTheDateThatIsAnsweredInEveryZone)
{
    setenv("LC_ALL", "C", 1);
    for (char const* zone : {"UTC0", "Asia/Kolkata", "America/St_Johns", "Europe/Nowhere",
                             "<+03>-3", "CET-1CEST,M3.5.0,M10.5.0/3", ""}) {
        setenv("TZ", zone, 1);
        answered("date"); // runs it
        std::string before;
        std::optional<std::string> between;
        do {
            before = real("date");
            between = answered("date");
        } while (before != real("date"));
        EXPECT_EQ(between.value_or(before), before) << zone;
    }
    EXPECT_GE(bothways::countOf("date").answered, 5U);
}

TEST_P(AccelBusybox, IsRunForADateInALocaleThatItDoesNotFollow)
{
    ASSERT_EQ(std::system("localedef -i de_DE -f UTF-8 de_DE.UTF-8"), 0);
    setenv("LC_ALL", "de_DE.UTF-8", 1);
    EXPECT_TRUE(answered("date")); // runs it
    EXPECT_FALSE(answered("date"));
    EXPECT_EQ(reasonOf("date"), "date printed an unexpected text");
}

} // namespace tools_test
