// date in locales and time zones that the machine does not have yet.

#include "tests/support/BothWays.h"
#include "tests/support/Machine.h"
#include "tests/support/Program.h"

#include <filesystem>
#include <gtest/gtest.h>

namespace
{

/** What a fresh process prints for date, by itself and with the accelerator. */
struct Dates {
    std::string real;
    std::string accelerated;
    bool answered;
};

/** Asked again where the second changed in between. */
Dates dates()
{
    Outcome before;
    Outcome between;
    do {
        before = runToEnd({PROBE_FILE, "date"});
        between = runToEnd({ACCEL_PROBE_FILE, "date"});
    } while (before.out != runToEnd({PROBE_FILE, "date"}).out);
    return {before.out, between.out, between.err.find("date 1 0\n") != std::string::npos};
}

void makeLocale(std::string const& name)
{
    std::string const command =
        "localedef -i " + name + " -f UTF-8 " + name + ".UTF-8 2>/dev/null || test $? = 1";
    ASSERT_EQ(std::system(command.c_str()), 0) << name;
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
    Dates const found = dates();
    EXPECT_EQ(found.accelerated, found.real);
}

INSTANTIATE_TEST_SUITE_P(Languages, AccelLocale,
                         testing::Values("en_US", "en_GB", "de_DE", "ru_RU", "ja_JP", "th_TH",
                                         "fa_IR", "ar_SA"));

TEST(AccelLocales, OfTheUsualEnglishAreAnsweredInTheProcess)
{
    makeLocale("en_US");
    setenv("LC_ALL", "en_US.UTF-8", 1);
    Dates const found = dates();
    EXPECT_TRUE(found.answered);
    EXPECT_EQ(found.accelerated, found.real);
    EXPECT_NE(found.real.find('M'), std::string::npos) << "no AM or PM: " << found.real;
}

TEST(AccelLocales, NewerThanTheProcessAreLeftToDate)
{
    makeLocale("en_US");
    setenv("LC_ALL", "en_US.UTF-8", 1);
    EXPECT_FALSE(bothways::answered("date"));
    setenv("LC_ALL", "C", 1);
    EXPECT_TRUE(bothways::answered("date"));
}

TEST(AccelZones, FollowTheSystemsOwnZoneFile)
{
    unsetenv("TZ");
    setenv("LC_ALL", "C", 1);
    for (char const* zone : {"Asia/Kolkata", "America/St_Johns", "Europe/Berlin"}) {
        machine::remove("/etc/localtime");
        std::filesystem::create_symlink(std::string("/usr/share/zoneinfo/") + zone,
                                        "/etc/localtime");
        std::string before;
        std::optional<std::string> between;
        do {
            before = bothways::real("date");
            between = bothways::answered("date");
        } while (before != bothways::real("date"));
        EXPECT_EQ(between, before);
    }
}

} // namespace
