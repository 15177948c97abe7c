#include "sysdata/osInfo_linux.h"

#include "tests/interpose/Libc.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/LastOpened.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <string>
#include <vector>

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

    libc::HookGuard const guard_;
    FakeFiles const files_;
    FakeCommands commands_;
};

TEST_F(InstallDate, IsZeroWithoutAReleaseFile)
{
    EXPECT_EQ(date(), 0);
    EXPECT_TRUE(commands_.ran.empty());
}

TEST_F(InstallDate, IsTheReleaseFilesLastStatusChange)
{
    EXPECT_EQ(dateOf("Change: 2010-05-12 10:23:45.000000000 +0200\n"), may2010);
    EXPECT_EQ(commands_.modes, std::vector<std::string>{"r"});
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
        EXPECT_EQ(commands_.ran, std::vector<std::string>{file.command});
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

TEST_F(InstallDate, IsZeroWhenTheCommandCannotBeStarted)
{
    Recording const log;
    files_.write("/etc/SuSE-release", "a line\n");
    files_.write("/etc/redhat-release", "a line\n");
    commands_.answers[redhatCommand] = "Change: 2010-05-12 10:23:45\n";
    EXPECT_EQ(date(), 0);
    EXPECT_EQ(commands_.ran, std::vector<std::string>{suseCommand});
    EXPECT_TRUE(log.remarks().empty());
}

TEST_F(InstallDate, IsZeroWhenTheCommandWritesNothing)
{
    Recording const log;
    EXPECT_EQ(dateOf(""), 0);
    EXPECT_TRUE(log.remarks().empty());
}

TEST_F(InstallDate, IsZeroWhenTheLineHoldsNoDate)
{
    Recording const log;
    EXPECT_EQ(dateOf("stat: cannot stat\n"), 0);
    EXPECT_EQ(log.remarks(), std::vector<std::string>{"Invalid YY: YY = 0"});
}

TEST_F(InstallDate, TreatsMissingFieldsAsZero)
{
    constexpr long midnight = may2010 - 10 * hour - 23 * 60 - 45;
    EXPECT_EQ(dateOf("Change: 2010-05-12 10:23\n"), may2010 - 45);
    EXPECT_EQ(dateOf("Change: 2010-05-12 10\n"), midnight + 10 * hour);
    EXPECT_EQ(dateOf("Change: 2010-05-12\n"), midnight);
    EXPECT_EQ(dateOf("Change: 2010-05\n"), midnight - 12 * 24 * hour);
    EXPECT_EQ(dateOf("Change: 2010\n"), 1262217600); // 31 December 2009
}

TEST_F(InstallDate, NeedsTheLineToBeginWithChange)
{
    EXPECT_EQ(dateOf(" Change: 2010-05-12 10:23:45\n"), 0);
    EXPECT_EQ(dateOf("Changed: 2010-05-12 10:23:45\n"), 0);
}

TEST_F(InstallDate, KeepsTheLinesFirstCharacter)
{
    // A leading hyphen stays, so the line does not begin with the word.
    EXPECT_EQ(dateOf("-Change: 2010-05-12 10:23:45\n"), 0);
    Recording const log;
    dateOf("Change: 2010-05-12 10:23:45\n");
    EXPECT_TRUE(log.has("strreplace: entry", 3000));
}

TEST_F(InstallDate, ComesFromTheFirstLine)
{
    EXPECT_EQ(dateOf("Change: 2010-05-12 10:23:45\nChange: 2011-05-12 10:23:45\n"), may2010);
    EXPECT_EQ(dateOf("Other\nChange: 2010-05-12 10:23:45\n"), 0);
}

TEST_F(InstallDate, ComesFromTheFirst1023CharactersOfTheLine)
{
    std::string const date = "2010-05-12 10:23:45";
    std::string const start = "Change:";
    std::string const blanks(1023 - start.size() - date.size(), ' ');
    EXPECT_EQ(dateOf(start + blanks + date + "\n"), may2010);
    EXPECT_EQ(dateOf(start + blanks + " " + date + "\n"), may2010 - 41); // the last 5 is cut off
}

TEST_F(InstallDate, ClosesTheCommandsStream)
{
    dateOf("Change: 2010-05-12 10:23:45\n");
    EXPECT_EQ(commands_.open, 0);
    dateOf("");
    EXPECT_EQ(commands_.open, 0);
}

TEST_F(InstallDate, KeepsTheReleaseFileOpenUntilTheCommandRuns)
{
    files_.write("/etc/redhat-release", "a line\n");
    LastOpened const probe;
    bool wasOpen = false;
    libc::hooks().popen = [&](char const*, char const*) -> FILE* {
        wasOpen = isOpen(probe.descriptor());
        return nullptr;
    };
    date();
    EXPECT_TRUE(wasOpen);
    EXPECT_FALSE(isOpen(probe.descriptor()));
}

TEST_F(InstallDate, ReadsLeadingZerosAsDecimal)
{
    EXPECT_EQ(dateOf("Change: 2010-08-09 08:09:08.000000000 +0200\n"), 1281341348);
}

TEST_F(InstallDate, ClosesTheReleaseFileBeforeItReadsTheOutput)
{
    files_.write("/etc/redhat-release", "a line\n");
    commands_.answers[redhatCommand] = "Change: 2010-05-12 10:23:45\n";
    LastOpened const probe;
    bool openAtRead = true;
    libc::hooks().fgets = [&](char* buffer, int size, FILE* stream) {
        openAtRead = isOpen(probe.descriptor());
        return interpose::real(fgets)(buffer, size, stream);
    };
    EXPECT_EQ(date(), may2010);
    EXPECT_FALSE(openAtRead);
}

} // namespace os_install_date_test
