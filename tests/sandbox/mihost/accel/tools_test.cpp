// Machines with other shells, tools, locales and zones: the accelerator does not answer, or it
// prints what the tool of that machine prints.

#include "TestPaths.h"
#include "tests/support/ComparedLog.h"
#include "tests/support/KernelModules.h"
#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"

#include <cstdlib>

namespace tools_test
{

using bothways::answered;
using bothways::real;
using bothways::reasonOf;

char const* const count = "wc -l /etc/passwd";
char const* const script = "the shell or the tool is a script";
char const* const replaceable = "users other than root can replace the shell or the tool";
char const* const notRunnable = "the shell or the tool cannot be run";
char const* const notFound = "PATH does not find the tool in a system directory";
char const* const unknownShell = "/bin/sh is not dash, bash or, for some tools, busybox";
char const* const notKmod = "the tool is not a link to kmod";

void run(std::string const& command)
{
    machine::run(command);
}

/** A machine on which everything is answered at first. */
class AccelTools : public testing::Test
{
protected:
    AccelTools()
    {
        setenv("PATH", "/usr/local/bin:/usr/sbin:/usr/bin", 1);
        kernelModules::load({});
        kernelModules::install({{"some.ko", {"version=1"}}});
        for (char const* command : {count, "date", "lsmod", "modinfo some"})
            EXPECT_TRUE(answered(command)) << command;
    }
};

struct Change {
    char const* command; // makes it
    char const* asked;
    char const* reason;
};

class AccelChangedTools : public AccelTools, public testing::WithParamInterface<Change>
{
};

TEST_P(AccelChangedTools, AreRunForTheirReason)
{
    auto const [command, asked, reason] = GetParam();
    run(command);
    EXPECT_FALSE(answered(asked)) << command;
    std::string const line = asked;
    EXPECT_EQ(reasonOf(line.substr(0, line.find(' '))), reason) << command;
}

INSTANTIATE_TEST_SUITE_P(
    Tools, AccelChangedTools,
    testing::Values(Change{"echo '#!/bin/sh' > /usr/bin/wc", count, script},
                    Change{"chown 1000 /usr/bin/wc", count, replaceable},
                    Change{"chmod g+w /usr/bin/wc", count, replaceable},
                    Change{"chmod o+w /usr/bin/wc", count, replaceable},
                    Change{"chmod g+w /usr/bin", count, replaceable},
                    Change{"chmod o+w /usr/bin", count, replaceable},
                    Change{"chmod 400 /usr/bin/wc", count, notRunnable},
                    Change{"rm /usr/bin/wc", count, notFound},
                    Change{"cp /usr/bin/wc /usr/local/bin", count, notFound},
                    Change{"ln -sf /usr/bin/busybox /usr/sbin/lsmod", "lsmod", notKmod},
                    Change{"rm /usr/sbin/lsmod && cp /usr/bin/kmod /usr/sbin/lsmod", "lsmod",
                           notKmod},
                    Change{"rm /usr/sbin/modinfo && cp /usr/bin/ldd /usr/sbin/modinfo",
                           "modinfo some", script}));

INSTANTIATE_TEST_SUITE_P(
    Shells, AccelChangedTools,
    testing::Values(Change{"chmod g+w /bin/dash", count, replaceable},
                    Change{"chmod o+w /bin/dash", count, replaceable},
                    Change{"rm /bin/sh", count, notRunnable},
                    Change{"ln -sf /usr/bin/ldd /bin/sh", count, script},
                    Change{"cp /bin/dash /bin/other && ln -sf other /bin/sh", count, unknownShell},
                    Change{"cp /bin/dash /bin/other && ln -sf other /bin/sh", "date", unknownShell},
                    Change{"ln -sf busybox /bin/sh", "lsmod", unknownShell}));

TEST_F(AccelTools, AreAnsweredUnlessALinkLeadsToAWritableDirectory)
{
    run("mkdir /opt/tools && cp /usr/bin/wc /opt/tools && ln -sf /opt/tools/wc /usr/bin/wc");
    EXPECT_TRUE(answered(count));
    run("chmod o+w /opt/tools");
    EXPECT_FALSE(answered(count));
    EXPECT_EQ(reasonOf("wc"), replaceable);
    EXPECT_TRUE(answered("date"));
    run("chmod o-w /opt/tools");
    EXPECT_TRUE(answered(count));
}

TEST_F(AccelTools, AreAnsweredWhenTheShellIsBashOrBusybox)
{
    for (char const* shell : {"busybox", "bash"}) {
        run(std::string("ln -sf /usr/bin/") + shell + " /bin/sh");
        EXPECT_EQ(answered(count), real(count)) << shell;
    }
    setenv("BASH_FUNC_wc%%", "() { echo function; }", 1);
    EXPECT_EQ(real(count), "function\n");
    EXPECT_FALSE(answered(count));
}

/** A machine whose tools are those of busybox, as symbolic or as hard links. */
class AccelBusybox : public testing::TestWithParam<char const*>
{
protected:
    AccelBusybox()
    {
        for (std::string const tool : {"wc", "sed", "date"})
            run(std::string(GetParam()) + " /usr/bin/busybox /usr/bin/" + tool);
    }
};

INSTANTIATE_TEST_SUITE_P(Kinds, AccelBusybox, testing::Values("ln -sf", "ln -f"));

TEST_P(AccelBusybox, ReadsAChangingLogAsTheAcceleratorDoes)
{
    EXPECT_TRUE(holds(real("sed --help"), "BusyBox"));
    EXPECT_GT(percentOfSedsAnswered(8, 30), 50U);
}

TEST_P(AccelBusybox, PrintsTheDateThatIsAnsweredInEveryZone)
{
    setenv("LC_ALL", "C", 1);
    for (char const* zone : {"UTC0", "Asia/Kolkata", "America/St_Johns", "Europe/Nowhere",
                             "<+03>-3", "CET-1CEST,M3.5.0,M10.5.0/3", ""}) {
        setenv("TZ", zone, 1);
        answered("date"); // runs it
        auto const [expected, found] = bothways::dates();
        EXPECT_EQ(found.value_or(expected), expected) << zone;
    }
    EXPECT_GE(bothways::countOf("date").answered, 5U);
}

TEST_P(AccelBusybox, IsRunForADateInALocaleThatItIgnores)
{
    run("localedef -i de_DE -f UTF-8 de_DE.UTF-8");
    setenv("LC_ALL", "de_DE.UTF-8", 1);
    EXPECT_TRUE(answered("date")); // runs it
    EXPECT_FALSE(answered("date"));
    EXPECT_EQ(reasonOf("date"), "date printed an unexpected text");
}

class AccelLocale : public testing::TestWithParam<char const*>
{
};

INSTANTIATE_TEST_SUITE_P(Languages, AccelLocale,
                         testing::Values("ar_SA", "de_DE", "en_GB", "en_US", "fa_IR", "ja_JP",
                                         "ru_RU", "th_TH"));

/** In a new process, which has its locale from the start. date is run first, then answered. */
TEST_P(AccelLocale, GivesTheDateThatDatePrints)
{
    std::string const name = GetParam();
    run("localedef -i " + name + " -f UTF-8 " + name + ".UTF-8 2>/dev/null || test $? = 1");
    unsetenv("LC_ALL");
    setenv("TZ", "America/St_Johns", 1);
    for (char const* variable : {"LC_TIME", "LC_ALL"}) {
        setenv(variable, (name + ".UTF-8").c_str(), 1);
        std::string before;
        Outcome between;
        do {
            before = runToEnd({PROBE_FILE, "date", "date"}).out;
            between = runToEnd({ACCEL_PROBE_FILE, "date", "date"});
        } while (before != runToEnd({PROBE_FILE, "date", "date"}).out);
        EXPECT_EQ(between.out, before) << variable;
        EXPECT_TRUE(holds(between.err, "date 1 1\n"));
    }
}

TEST(AccelZones, FollowTheSystemsOwnZoneFile)
{
    unsetenv("TZ");
    setenv("LC_ALL", "C", 1);
    for (char const* zone : {"Asia/Kolkata", "America/St_Johns", "Europe/Berlin"}) {
        run(std::string("ln -sf /usr/share/zoneinfo/") + zone + " /etc/localtime");
        bothways::answered("date"); // runs it
        auto const [expected, found] = bothways::dates();
        EXPECT_EQ(found, expected) << zone;
    }
    EXPECT_GE(bothways::countOf("date").answered, 2U); // the hour may change
}

} // namespace tools_test
