// The distribution's name and version, from its release files.

#include "sysdata/osInfo_linux.h"

#include "tests/interpose/Libc.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/LastOpened.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <cstring>
#include <string>
#include <sys/utsname.h>
#include <unistd.h>
#include <vector>

namespace os_release_test
{

using NQ::OsInfo;

constexpr char const* vmwareCommand = " cat /etc/vmware-release  | tr -d '[:alpha:][:space:][()]'";
constexpr char const* redhatCommand = "cat /etc/redhat-release  | tr -d '[:alpha:][:space:][()]'";
constexpr char const* suseCommand =
    "echo $(cat /etc/SuSE-release | tr '\\n' ' ' | cut -d ' ' -f 9)."
    "$(cat /etc/SuSE-release | tr '\\n' ' ' | cut -d ' ' -f 12) | tr -d [:space:]";

/** A machine with its own release files, and commands with given output. */
class ReleaseFiles : public testing::Test
{
protected:
    std::string name()
    {
        std::string out = "before";
        EXPECT_TRUE(OsInfo().getOSName(out));
        return out;
    }

    /** The version; "none" if there is none, which also leaves the caller's text unchanged. */
    std::string version()
    {
        std::string out = "before";
        if (OsInfo().getOSVersion(out))
            return out;
        EXPECT_EQ(out, "before");
        return "none";
    }

    libc::HookGuard const guard_;
    FakeFiles const files_;
    FakeCommands commands_;
};

class OSReleaseName : public ReleaseFiles
{
protected:
    std::string of(std::string const& text)
    {
        files_.write("/etc/release", text);
        std::string out = "before";
        EXPECT_TRUE(OsInfo().getOSReleaseName("/etc/release", out));
        return out;
    }
};

TEST_F(OSReleaseName, IsTheFirstLineUnchanged)
{
    EXPECT_EQ(of("  Kesto Linux 10.2 \t\r\nsecond\n"), "  Kesto Linux 10.2 \t\r");
    EXPECT_EQ(of("Kesto Linux"), "Kesto Linux");
    EXPECT_EQ(of(std::string(5000, 'x') + "\n"), std::string(5000, 'x'));
}

TEST_F(OSReleaseName, IsEmptyForAnEmptyFirstLine)
{
    EXPECT_EQ(of("\nsecond\n"), "");
}

TEST_F(OSReleaseName, FailsAndKeepsTheCallersTextWithoutALine)
{
    std::string out = "before";
    EXPECT_FALSE(OsInfo().getOSReleaseName("/etc/release", out));
    files_.write("/etc/release", "");
    EXPECT_FALSE(OsInfo().getOSReleaseName("/etc/release", out));
    EXPECT_EQ(out, "before");
}

class OSName : public ReleaseFiles
{
};

TEST_F(OSName, IsLinuxWithoutAReleaseFile)
{
    EXPECT_EQ(name(), "Linux");
}

TEST_F(OSName, ComesFromTheFirstReleaseFileThereIs)
{
    std::vector<std::string> const paths{"/etc/release", "/etc/vmware-release",
                                         "/etc/redhat-release", "/etc/SuSE-release",
                                         "/etc/UnitedLinux-release"};
    for (std::string const& path : paths)
        files_.write(path, "from " + path + "\n");
    for (std::string const& path : paths) {
        EXPECT_EQ(name(), "from " + path);
        files_.remove(path);
    }
    EXPECT_EQ(name(), "Linux");
}

TEST_F(OSName, SkipsAReleaseFileWithoutALine)
{
    files_.write("/etc/release", "");
    files_.write("/etc/SuSE-release", "SUSE Linux\n");
    EXPECT_EQ(name(), "SUSE Linux");
}

TEST_F(OSName, IsEmptyIfTheFirstLineIs)
{
    files_.write("/etc/release", "\n");
    EXPECT_EQ(name(), "");
}

class KestoVersion : public ReleaseFiles
{
protected:
    /** The version; "none" if there is none, which also leaves the caller's text unchanged. */
    std::string of(std::string const& text)
    {
        files_.write("/etc/release", text);
        std::string out = "before";
        if (OsInfo().getKestoVersion("/etc/release", out))
            return out;
        EXPECT_EQ(out, "before");
        return "none";
    }
};

TEST_F(KestoVersion, JoinsTheNumbersOfTheSecondAndThirdLine)
{
    EXPECT_EQ(of("Kesto Linux\nVERSION = 10\nPATCHLEVEL = 2\n"), "10.2");
    EXPECT_EQ(of("Kesto Linux\nVERSION = 10\nPATCHLEVEL = 2"), "10.2");
}

TEST_F(KestoVersion, IgnoresTheFirstLine)
{
    EXPECT_EQ(of("\nVERSION = 10\nPATCHLEVEL = 2\n"), "10.2");
    EXPECT_EQ(of("VERSION = 9\nVERSION = 10\nPATCHLEVEL = 2\nVERSION = 11\n"), "10.2");
}

TEST_F(KestoVersion, NeedsASecondLineOfMoreThan9Characters)
{
    EXPECT_EQ(of("Kesto\nVERSIO=10\nPATCHLEVEL = 2\n"), "none");
    EXPECT_EQ(of("Kesto\nVERSION=10\nPATCHLEVEL = 2\n"), "10.2");
}

TEST_F(KestoVersion, NeedsAThirdLineOfAtLeast13Characters)
{
    EXPECT_EQ(of("Kesto\nVERSION = 10\nPATCHLEVEL=2\n"), "none");
    EXPECT_EQ(of("Kesto\nVERSION = 10\nPATCHLEVEL= 2\n"), "10.2");
}

TEST_F(KestoVersion, CutsAtTheLastEqualsSign)
{
    EXPECT_EQ(of("Kesto\nVERSION = 9 = 10\nPATCHLEVEL = 1 = 2\n"), "10.2");
}

TEST_F(KestoVersion, UsesAWholeLineWithoutAnEqualsSign)
{
    EXPECT_EQ(of("Kesto\n VERSION: 10 \n PATCHLEVEL: 2 \n"), "VERSION: 10.PATCHLEVEL: 2");
}

TEST_F(KestoVersion, KeepsAllButOneOfTheBlanksOfABlankValue)
{
    EXPECT_EQ(of("Kesto\nVERSION  =   \nPATCHLEVEL   =\n"), "  .");
}

TEST_F(KestoVersion, FailsWithoutTheFileOrWithoutThreeLines)
{
    std::string out = "before";
    EXPECT_FALSE(OsInfo().getKestoVersion("/etc/release", out));
    EXPECT_EQ(out, "before");
    EXPECT_EQ(of(""), "none");
    EXPECT_EQ(of("Kesto Linux\n"), "none");
    EXPECT_EQ(of("Kesto Linux\nVERSION = 10\n"), "none");
}

class OSVersion : public ReleaseFiles
{
protected:
    OSVersion()
    {
        libc::hooks().uname = [this](utsname* system) {
            ++unameCalls_;
            std::strcpy(system->release, "6.1.0-37-amd64");
            return unameFails_ ? -1 : 0;
        };
    }

    void writeCommandFiles() const
    {
        for (char const* path : {"/etc/vmware-release", "/etc/redhat-release", "/etc/SuSE-release"})
            files_.write(path, "a line\n");
    }

    bool unameFails_ = false;
    int unameCalls_ = 0;
};

TEST_F(OSVersion, FailsWithoutAReleaseFile)
{
    EXPECT_EQ(version(), "none");
    EXPECT_TRUE(commands_.ran.empty());
    EXPECT_EQ(unameCalls_, 0);
}

TEST_F(OSVersion, ComesFromTheKeyValueFileFirst)
{
    files_.write("/etc/UnitedLinux-release", "UnitedLinux 1.0\n");
    writeCommandFiles();
    files_.write("/etc/release", "Kesto Linux\nVERSION = 10\nPATCHLEVEL = 2\n");
    EXPECT_EQ(version(), "10.2");
    EXPECT_EQ(unameCalls_, 0);
    EXPECT_TRUE(commands_.ran.empty());
}

TEST_F(OSVersion, IsTheKernelsReleaseOnUnitedLinux)
{
    files_.write("/etc/UnitedLinux-release", "UnitedLinux 1.0\n");
    writeCommandFiles();
    EXPECT_EQ(version(), "6.1.0-37-amd64");
    EXPECT_TRUE(commands_.ran.empty());
}

TEST_F(OSVersion, ClosesTheUnitedLinuxFileInAnyCase)
{
    files_.write("/etc/UnitedLinux-release", "UnitedLinux 1.0\n");
    for (bool const fails : {false, true}) {
        unameFails_ = fails;
        LastOpened const probe;
        version();
        EXPECT_NE(probe.descriptor(), -1);
        EXPECT_FALSE(isOpen(probe.descriptor()));
    }
}

TEST_F(OSVersion, FailsOnUnitedLinuxIfUnameFails)
{
    files_.write("/etc/UnitedLinux-release", "UnitedLinux 1.0\n");
    writeCommandFiles();
    unameFails_ = true;
    EXPECT_EQ(version(), "none");
    EXPECT_EQ(unameCalls_, 1);
    EXPECT_TRUE(commands_.ran.empty());
}

TEST_F(OSVersion, TriesTheOtherFilesIfAKeyValueLineIsTooShort)
{
    files_.write("/etc/release", "Kesto Linux\nVERSION = 10\nPATCHLEVEL=2\n");
    files_.write("/etc/SuSE-release", "SUSE Linux Enterprise Server 11 (x86_64)\n");
    commands_.answers[suseCommand] = "11.3";
    EXPECT_EQ(version(), "11.3");
}

TEST_F(OSVersion, ComesFromTheCommandOfTheFirstFileThereIs)
{
    struct {
        char const* path;
        char const* command;
    } const files[] = {{"/etc/vmware-release", vmwareCommand},
                       {"/etc/redhat-release", redhatCommand},
                       {"/etc/SuSE-release", suseCommand}};
    writeCommandFiles();
    for (auto const& file : files) {
        commands_.answers = {{file.command, "5.4"}};
        commands_.ran.clear();
        EXPECT_EQ(version(), "5.4") << file.path;
        EXPECT_EQ(commands_.ran, std::vector<std::string>{file.command});
        files_.remove(file.path);
    }
    EXPECT_EQ(version(), "none");
}

TEST_F(OSVersion, IsCutAt9Characters)
{
    writeCommandFiles();
    commands_.answers[vmwareCommand] = "123456789";
    EXPECT_EQ(version(), "123456789");
    commands_.answers[vmwareCommand] = "1234567890";
    EXPECT_EQ(version(), "123456789");
}

TEST_F(OSVersion, IsOneLineWithItsEnd)
{
    writeCommandFiles();
    commands_.answers[vmwareCommand] = "5.4\n6.0\n";
    EXPECT_EQ(version(), "5.4\n");
}

TEST_F(OSVersion, FailsWhenTheCommandCannotBeStarted)
{
    writeCommandFiles();
    EXPECT_EQ(version(), "none");
    // The other files are not tried.
    EXPECT_EQ(commands_.ran, std::vector<std::string>{vmwareCommand});
}

/** How the command's stream is treated; the stream is a file, so both ways of closing it work. */
class OSVersionStream : public OSVersion
{
protected:
    void answer(std::string const& text)
    {
        files_.write("/etc/redhat-release", "a line\n");
        files_.write("/output", text);
        libc::hooks().fopen = [this, below = libc::hooks().fopen.answer()](char const* path,
                                                                           char const* mode) {
            FILE* const stream = below(path, mode);
            if (std::string(path) == "/etc/redhat-release")
                probe_ = fileno(stream);
            return stream;
        };
        libc::hooks().popen = [this](char const*, char const* mode) {
            probeWasOpen_ = isOpen(probe_);
            mode_ = mode;
            FILE* const stream = interpose::real(fopen)(files_.realPath("/output").c_str(), "r");
            pipe_ = fileno(stream);
            return stream;
        };
        libc::hooks().pclose = [this](FILE* stream) {
            ++pcloseCalls_;
            return std::fclose(stream);
        };
    }

    int probe_ = -1;
    bool probeWasOpen_ = true;
    std::string mode_;
    int pipe_ = -1;
    int pcloseCalls_ = 0;
};

TEST_F(OSVersionStream, StartsAfterTheReleaseFileIsClosed)
{
    answer("5.4");
    EXPECT_EQ(version(), "5.4");
    EXPECT_NE(probe_, -1);
    EXPECT_FALSE(probeWasOpen_);
    EXPECT_EQ(mode_, "r");
}

TEST_F(OSVersionStream, IsClosedAsAFileAndNotAsACommand)
{
    answer("5.4");
    EXPECT_EQ(version(), "5.4");
    EXPECT_FALSE(isOpen(pipe_));
    EXPECT_EQ(pcloseCalls_, 0);
}

TEST_F(OSVersionStream, IsLeftOpenIfNothingCanBeRead)
{
    answer("");
    EXPECT_EQ(version(), "none");
    EXPECT_TRUE(isOpen(pipe_));
    EXPECT_EQ(pcloseCalls_, 0);
    close(pipe_);
}

/** Runs the real commands, redirected to the files written here. */
class OSVersionCommand : public ReleaseFiles
{
protected:
    OSVersionCommand()
    {
        libc::hooks().pclose = nullptr;
        libc::hooks().popen = [this](std::string command, char const* mode) {
            std::string const folder = "/etc/";
            for (auto at = command.find(folder); at != std::string::npos;
                 at = command.find(folder, at)) {
                command.replace(at, folder.size(), files_.realPath(folder));
                at += files_.realPath(folder).size();
            }
            return interpose::real(popen)(command.c_str(), mode);
        };
    }
};

TEST_F(OSVersionCommand, KeepsDigitsDotsAndHyphensOfAVmwareFile)
{
    files_.write("/etc/vmware-release", "VMware ESX Server 3.5 (Dali)\n");
    EXPECT_EQ(version(), "3.5");
    files_.write("/etc/vmware-release", "VMware ESX Server 3.0.1 [Releasebuild-32039]\n");
    EXPECT_EQ(version(), "3.0.1-320");
}

TEST_F(OSVersionCommand, KeepsDigitsAndDotsOfARedhatFile)
{
    files_.write("/etc/redhat-release", "Red Hat Enterprise Linux Server release 5.4 (Tikanga)\n");
    EXPECT_EQ(version(), "5.4");
}

TEST_F(OSVersionCommand, JoinsTheNinthAndTheTwelfthWordOfASuseFile)
{
    files_.write("/etc/SuSE-release",
                 "SUSE Linux Enterprise Server 10 (x86_64)\nVERSION = 10\nPATCHLEVEL = 2\n");
    EXPECT_EQ(version(), "10.2");
}

TEST_F(OSVersion, FailsWithoutAMessage)
{
    Recording const log;
    writeCommandFiles();
    EXPECT_EQ(version(), "none"); // the command cannot be started
    files_.write("/etc/UnitedLinux-release", "x\n");
    unameFails_ = true;
    EXPECT_EQ(version(), "none");
    EXPECT_TRUE(log.remarks().empty());
}

} // namespace os_release_test
