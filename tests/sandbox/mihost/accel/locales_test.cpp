// date in locales and time zones that the machine does not have yet.

#include "TestPaths.h"
#include "tests/support/BothWays.h"
#include "tests/support/Machine.h"
#include "tests/support/Program.h"

#include <cstdlib>
#include <filesystem>
#include <gtest/gtest.h>

namespace locales_test
{

void makeLocale(std::string const& name)
{
    std::string const command =
        "localedef -i " + name + " -f UTF-8 " + name + ".UTF-8 2>/dev/null || test $? = 1";
    ASSERT_EQ(std::system(command.c_str()), 0) << name;
}

/**
 * What a fresh process gets for date the second time, when it is not run to compare. It says on
 * standard error how it came by that.
 */
Outcome acceleratedDate()
{
    Outcome before;
    Outcome between;
    do {
        before = runToEnd({PROBE_FILE, "date", "date"});
        between = runToEnd({ACCEL_PROBE_FILE, "date", "date"});
    } while (before.out != runToEnd({PROBE_FILE, "date", "date"}).out);
    EXPECT_EQ(between.out, before.out);
    return between;
}

class AccelLocale : public testing::TestWithParam<char const*>
{
};

TEST_P(AccelLocale, GivesTheDateThatDateGives)
{
    makeLocale(GetParam());
    unsetenv("LC_ALL");
    setenv("LC_TIME", (std::string(GetParam()) + ".UTF-8").c_str(), 1);
    setenv("TZ", "America/St_Johns", 1);
    acceleratedDate();
}

INSTANTIATE_TEST_SUITE_P(Languages, AccelLocale,
                         testing::Values("en_GB", "ru_RU", "ja_JP", "th_TH", "fa_IR", "ar_SA"));

TEST(AccelLocales, AreFollowedInTheProcess)
{
    for (char const* locale : {"en_US", "de_DE"}) {
        makeLocale(locale);
        setenv("LC_ALL", (std::string(locale) + ".UTF-8").c_str(), 1);
        EXPECT_NE(acceleratedDate().err.find("date 1 1\n"), std::string::npos) << locale;
    }
}

TEST(AccelZones, FollowTheSystemsOwnZoneFile)
{
    unsetenv("TZ");
    setenv("LC_ALL", "C", 1);
    for (char const* zone : {"Asia/Kolkata", "America/St_Johns", "Europe/Berlin"}) {
        machine::remove("/etc/localtime");
        std::filesystem::create_symlink(std::string("/usr/share/zoneinfo/") + zone,
                                        "/etc/localtime");
        bothways::answered("date"); // runs it
        std::string before;
        std::optional<std::string> between;
        do {
            before = bothways::real("date");
            between = bothways::answered("date");
        } while (before != bothways::real("date"));
        EXPECT_EQ(between, before);
    }
    EXPECT_GE(bothways::countOf("date").answered, 3U);
}

} // namespace locales_test
