#include "sysdata/osInfo_linux.h"

#include "tests/interpose/Libc.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/LastOpened.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <string>

namespace os_install_date_test
{

using NQ::OsInfo;

constexpr char const* suseCommand = "stat /etc/SuSE-release | grep Change";
constexpr char const* unitedLinuxCommand = "stat /etc/UnitedLinux-release | grep Change";
constexpr char const* redhatCommand = "stat /etc/redhat-release | grep Change";

constexpr long hour = 3600;
constexpr long may2010 = 1273659825; // 12 May 2010 10:23:45 UTC

class InstallDate : public testing::Test
{
protected:
    InstallDate()
    {
        setenv("TZ", "UTC0", 1);
    }

    long date()
    {
        long out = 4711;
        EXPECT_TRUE(OsInfo().getInstallDate(out));
        return out;
    }

    /** The date that one line of output yields. */
    long dateOf(std::string const& output)
    {
        files_.write("/etc/redhat-release", "a line\n");
        commands_.answers[redhatCommand] = output;
        return date();
    }

    FakeFiles const files_;
    FakeCommands commands_;
};

TEST_F(InstallDate, IsTheReleaseFilesLastStatusChange)
{
    EXPECT_EQ(dateOf("Change: 2010-05-12 10:23:45.000000000 +0200\n"), may2010);
    EXPECT_EQ(commands_.modes, Lines{"r"});
}

TEST_F(InstallDate, IsReadAsLocalTimeWhateverTheZoneOffset)
{
    setenv("TZ", "CET-1CEST,M3.5.0,M10.5.0/3", 1);
    EXPECT_EQ(dateOf("Change: 2010-05-12 10:23:45.999999999 +0900\n"), may2010 - 2 * hour);
    EXPECT_EQ(dateOf("Change: 2010-01-12 10:23:45.000000000 -0500\n"), 1263291825 - 3600);
}

TEST_F(InstallDate, ComesFromTheCommandOfTheFirstFileThereIs)
{
    struct {
        char const* path;
        char const* command;
    } const files[] = {{"/etc/SuSE-release", suseCommand},
                       {"/etc/UnitedLinux-release", unitedLinuxCommand},
                       {"/etc/redhat-release", redhatCommand}};
    for (auto const& file : files)
        files_.write(file.path, "a line\n");
    for (auto const& file : files) {
        commands_.answers = {{file.command, "Change: 2010-05-12 10:23:45\n"}};
        commands_.ran.clear();
        EXPECT_EQ(date(), may2010) << file.path;
        EXPECT_EQ(commands_.ran, Lines{file.command});
        files_.remove(file.path);
    }
    EXPECT_EQ(date(), 0);
}

TEST_F(InstallDate, IgnoresOtherReleaseFiles)
{
    files_.write("/etc/release", "a line\n");
    files_.write("/etc/vmware-release", "a line\n");
    EXPECT_EQ(date(), 0);
    EXPECT_TRUE(commands_.ran.empty());
}

TEST_F(InstallDate, IsZeroIfTheCommandFailsOrFindsNothing)
{
    files_.write("/etc/SuSE-release", "a line\n");
    files_.write("/etc/redhat-release", "a line\n");
    commands_.answers[redhatCommand] = "Change: 2010-05-12 10:23:45\n";
    Recording const log;
    EXPECT_EQ(date(), 0);
    EXPECT_EQ(commands_.ran, Lines{suseCommand});
    files_.remove("/etc/SuSE-release");
    EXPECT_EQ(dateOf(""), 0);
    EXPECT_EQ(log.remarks(), Lines{});
    EXPECT_EQ(dateOf("stat: cannot stat\n"), 0);
    EXPECT_EQ(log.remarks(), Lines{"Invalid YY: YY = 0"});
    EXPECT_EQ(commands_.open, 0);
}

TEST_F(InstallDate, IsReadFromTheLine)
{
    constexpr long midnight = may2010 - 10 * hour - 23 * 60 - 45;
    std::string const start = "Change:";
    std::string const stamp = "2010-05-12 10:23:45";
    std::string const blanks(1023 - start.size() - stamp.size(), ' ');
    struct {
        char const* what;
        std::string output;
        long date;
    } const cases[] = {
        {"no seconds", "Change: 2010-05-12 10:23\n", may2010 - 45},
        {"no minutes", "Change: 2010-05-12 10\n", midnight + 10 * hour},
        {"no hours", "Change: 2010-05-12\n", midnight},
        {"no day", "Change: 2010-05\n", midnight - 12 * 24 * hour},
        {"no month: 31 December 2009", "Change: 2010\n", 1262217600},
        {"a blank before the word", " Change: 2010-05-12 10:23:45\n", 0},
        {"a longer word", "Changed: 2010-05-12 10:23:45\n", 0},
        {"a hyphen, which stays if it is first", "-Change: 2010-05-12 10:23:45\n", 0},
        {"the first line", "Change: 2010-05-12 10:23:45\nChange: 2011-05-12 10:23:45\n", may2010},
        {"not the second", "Other\nChange: 2010-05-12 10:23:45\n", 0},
        {"1023 characters", start + blanks + stamp + "\n", may2010},
        {"the last 5 is cut off", start + blanks + " " + stamp + "\n", may2010 - 41},
        {"zeros are decimal", "Change: 2010-08-09 08:09:08.000000000 +0200\n", 1281341348},
    };
    for (auto const& [what, output, date] : cases)
        EXPECT_EQ(dateOf(output), date) << what;
    Recording const log;
    dateOf("Change: 2010-05-12 10:23:45\n");
    EXPECT_TRUE(log.has("strreplace: entry", 3000));
}

TEST_F(InstallDate, ClosesTheFileAfterStartingAndBeforeReading)
{
    files_.write("/etc/redhat-release", "a line\n");
    commands_.answers[redhatCommand] = "Change: 2010-05-12 10:23:45\n";
    LastOpened const probe;
    bool openAtStart = false;
    bool openAtRead = true;
    libc::hooks().popen.watch(
        [&](char const*, char const*) { openAtStart = isOpen(probe.descriptor()); });
    libc::hooks().fgets.watch([&](char*, int, FILE*) { openAtRead = isOpen(probe.descriptor()); });
    EXPECT_EQ(date(), may2010);
    EXPECT_TRUE(openAtStart);
    EXPECT_FALSE(openAtRead);
}

} // namespace os_install_date_test
