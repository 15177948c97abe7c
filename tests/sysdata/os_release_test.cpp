// The distribution's name and version, from its release files.

#include "sysdata/osInfo_linux.h"

#include "tests/interpose/Libc.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/LastOpened.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <cstring>
#include <string>
#include <sys/utsname.h>
#include <unistd.h>
#include <utility>

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
    EXPECT_EQ(of("\nsecond\n"), "");
}

TEST_F(OSReleaseName, FailsAndKeepsTheCallersTextWithoutALine)
{
    std::string out = "before";
    EXPECT_FALSE(OsInfo().getOSReleaseName("/etc/release", out));
    EXPECT_FALSE(OsInfo().getKestoVersion("/etc/release", out));
    files_.write("/etc/release", "");
    EXPECT_FALSE(OsInfo().getOSReleaseName("/etc/release", out));
    EXPECT_EQ(out, "before");
}

class OSName : public ReleaseFiles
{
};

TEST_F(OSName, ComesFromTheFirstReleaseFileThereIs)
{
    Lines const paths{"/etc/release", "/etc/vmware-release", "/etc/redhat-release",
                      "/etc/SuSE-release", "/etc/UnitedLinux-release"};
    for (std::string const& path : paths)
        files_.write(path, "from " + path + "\n");
    for (std::string const& path : paths) {
        EXPECT_EQ(name(), "from " + path);
        files_.remove(path);
    }
    EXPECT_EQ(name(), "Linux");
}

TEST_F(OSName, SkipsAReleaseFileWithoutALineButNotAnEmptyLine)
{
    files_.write("/etc/release", "");
    files_.write("/etc/SuSE-release", "SUSE Linux\n");
    EXPECT_EQ(name(), "SUSE Linux");
    files_.write("/etc/release", "\n");
    EXPECT_EQ(name(), "");
}

class KestoVersion : public ReleaseFiles
{
protected:
    /** The version; "none" if there is none, which also leaves the caller's text unchanged. */
    std::string of(std::string const& text)
    {
        files_.write("/etc/kesto", text);
        std::string out = "before";
        if (OsInfo().getKestoVersion("/etc/kesto", out))
            return out;
        EXPECT_EQ(out, "before");
        return "none";
    }
};

TEST_F(KestoVersion, JoinsTheValuesOfTheSecondAndThirdLine)
{
    struct {
        char const* what;
        char const* text;
        char const* version;
    } const cases[] = {
        {"three lines", "Kesto Linux\nVERSION = 10\nPATCHLEVEL = 2\n", "10.2"},
        {"no line end", "Kesto Linux\nVERSION = 10\nPATCHLEVEL = 2", "10.2"},
        {"an empty first line", "\nVERSION = 10\nPATCHLEVEL = 2\n", "10.2"},
        {"more lines", "VERSION = 9\nVERSION = 10\nPATCHLEVEL = 2\nVERSION = 11\n", "10.2"},
        {"a second line of 9 characters", "Kesto\nVERSIO=10\nPATCHLEVEL = 2\n", "none"},
        {"and of 10", "Kesto\nVERSION=10\nPATCHLEVEL = 2\n", "10.2"},
        {"a third line of 12 characters", "Kesto\nVERSION = 10\nPATCHLEVEL=2\n", "none"},
        {"and of 13", "Kesto\nVERSION = 10\nPATCHLEVEL= 2\n", "10.2"},
        {"the last equals sign", "Kesto\nVERSION = 9 = 10\nPATCHLEVEL = 1 = 2\n", "10.2"},
        {"none", "Kesto\n VERSION: 10 \n PATCHLEVEL: 2 \n", "VERSION: 10.PATCHLEVEL: 2"},
        {"blank values", "Kesto\nVERSION  =   \nPATCHLEVEL   =\n", "  ."},
        {"no lines", "", "none"},
        {"one line", "Kesto Linux\n", "none"},
        {"two lines", "Kesto Linux\nVERSION = 10\n", "none"},
    };
    for (auto const& [what, text, version] : cases)
        EXPECT_EQ(of(text), version) << what;
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

TEST_F(OSVersion, ComesFromTheKeyValueFileIfItsLinesAreLong)
{
    EXPECT_EQ(version(), "none"); // no release file
    files_.write("/etc/UnitedLinux-release", "UnitedLinux 1.0\n");
    writeCommandFiles();
    files_.write("/etc/release", "Kesto Linux\nVERSION = 10\nPATCHLEVEL = 2\n");
    EXPECT_EQ(version(), "10.2");
    EXPECT_EQ(unameCalls_, 0);
    files_.write("/etc/release", "Kesto Linux\nVERSION = 10\nPATCHLEVEL=2\n");
    EXPECT_EQ(version(), "6.1.0-37-amd64");
    EXPECT_TRUE(commands_.ran.empty());
}

TEST_F(OSVersion, IsTheKernelsReleaseOnUnitedLinux)
{
    files_.write("/etc/UnitedLinux-release", "UnitedLinux 1.0\n");
    writeCommandFiles();
    for (bool const fails : {false, true}) {
        unameFails_ = fails;
        LastOpened const probe;
        EXPECT_EQ(version(), fails ? "none" : "6.1.0-37-amd64");
        EXPECT_NE(probe.descriptor(), -1);
        EXPECT_FALSE(isOpen(probe.descriptor()));
    }
    EXPECT_EQ(unameCalls_, 2);
    EXPECT_TRUE(commands_.ran.empty());
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
        EXPECT_EQ(commands_.ran, Lines{file.command});
        files_.remove(file.path);
    }
    EXPECT_EQ(version(), "none");
}

TEST_F(OSVersion, IsTheFirst9CharactersOfOneLineWithItsEnd)
{
    writeCommandFiles();
    for (auto const& [output, found] : {std::pair{"123456789", "123456789"},
                                        {"1234567890", "123456789"},
                                        {"5.4\n6.0\n", "5.4\n"}}) {
        commands_.answers[vmwareCommand] = output;
        EXPECT_EQ(version(), found);
    }
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

TEST_F(OSVersionStream, StartsAfterTheFileIsClosedAndEndsAsAFile)
{
    answer("5.4");
    EXPECT_EQ(version(), "5.4");
    EXPECT_NE(probe_, -1);
    EXPECT_FALSE(probeWasOpen_);
    EXPECT_EQ(mode_, "r");
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

TEST_F(OSVersionCommand, FindsTheVersionInEachFile)
{
    struct {
        char const* path;
        char const* text;
        char const* version;
    } const files[] = {
        {"/etc/SuSE-release",
         "SUSE Linux Enterprise Server 10 (x86_64)\nVERSION = 10\nPATCHLEVEL = 2\n", "10.2"},
        {"/etc/redhat-release", "Red Hat Enterprise Linux Server release 5.4 (Tikanga)\n", "5.4"},
        {"/etc/vmware-release", "VMware ESX Server 3.5 (Dali)\n", "3.5"},
        {"/etc/vmware-release", "VMware ESX Server 3.0.1 [Releasebuild-32039]\n", "3.0.1-320"}};
    for (auto const& file : files) {
        files_.write(file.path, file.text);
        EXPECT_EQ(version(), file.version);
    }
}

TEST_F(OSVersion, FailsWithoutAMessageIfTheCommandCannotBeStarted)
{
    Recording const log;
    writeCommandFiles();
    EXPECT_EQ(version(), "none");
    // The other files are not tried.
    EXPECT_EQ(commands_.ran, Lines{vmwareCommand});
    files_.write("/etc/UnitedLinux-release", "x\n");
    unameFails_ = true;
    EXPECT_EQ(version(), "none");
    EXPECT_TRUE(log.remarks().empty());
}

} // namespace os_release_test
