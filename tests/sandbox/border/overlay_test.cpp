// The directory laid over a copy, and the reasons to refuse a copy.

#include "tests/interpose/Libc.h"
#include "tests/sandbox/border/Caller.h"
#include "tests/support/Lines.h"
#include "tests/support/ScratchFolder.h"

#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

namespace overlay_test
{

constexpr unsigned int modeBits = 07777;

struct stat statusOf(std::string const& path)
{
    struct stat status {
    };
    lstat(path.c_str(), &status);
    return status;
}

/** One line for each path: mode, owner, and the text or the link's target. */
std::string describe(std::initializer_list<char const*> paths)
{
    std::string lines;
    for (char const* path : paths) {
        struct stat const status = statusOf(path);
        char head[64];
        std::snprintf(head, sizeof head, "%o %u:%u ", status.st_mode & modeBits, status.st_uid,
                      status.st_gid);
        lines += head;
        if (S_ISLNK(status.st_mode)) {
            char target[256] = "";
            lines += readlink(path, target, sizeof target - 1) > 0 ? target : "?";
        } else if (S_ISREG(status.st_mode)) {
            lines += contentOf(path);
        }
        lines += '\n';
    }
    return lines;
}

class Overlay : public BorderTest
{
protected:
    /** The content of a copy with the overlay. */
    std::string laid(std::initializer_list<char const*> paths) const
    {
        Caller caller(
            [&paths] {
                Caller::say(describe(paths));
                return 0;
            },
            folder.name());
        std::string said = caller.hearAll();
        caller.wait();
        return said;
    }

    /** The reason why no copy can be made with these options. */
    static std::string reason(
        std::string const& overlay, std::function<void()> const& before = [] {})
    {
        Caller caller([] { return 0; }, overlay, before);
        std::string said = caller.hearAll();
        EXPECT_NE(caller.wait(), 0);
        return said;
    }

    ScratchFolder const folder;
};

TEST_F(Overlay, FilesBelongToRootAndKeepTheirModes)
{
    chmod(folder.write("etc/oswmi/file", "text").c_str(), 0751);
    ASSERT_EQ(chown(folder.path("etc/oswmi/file").c_str(), 12, 34), 0);
    EXPECT_EQ(laid({"/etc/oswmi/file"}), "751 0:0 text\n");
}

TEST_F(Overlay, ReplacesFilesAndLinksOfTheMachine)
{
    folder.write("etc/passwd", "root:x:0:0::/root:/bin/sh\n");
    folder.write("etc/mtab", "none"); // a link on most machines
    folder.write("run/oswmi", "run");
    folder.write("dev/shm/oswmi", "shm");
    EXPECT_EQ(laid({"/etc/passwd", "/etc/mtab", "/run/oswmi", "/dev/shm/oswmi"}),
              "644 0:0 root:x:0:0::/root:/bin/sh\n\n644 0:0 none\n"
              "644 0:0 run\n644 0:0 shm\n");
}

TEST_F(Overlay, KeepsSymbolicLinks)
{
    folder.write("etc/oswmi/file", "text");
    ASSERT_EQ(symlink("no/such/place", folder.path("etc/oswmi/link").c_str()), 0);
    EXPECT_EQ(laid({"/etc/oswmi/link"}), "777 0:0 no/such/place\n");
}

TEST_F(Overlay, SetsTheModesOfNewDirectoriesOnly)
{
    folder.write("tmp/oswmi-new/file", "");
    ASSERT_EQ(chmod(folder.path("tmp/oswmi-new").c_str(), 02750), 0);
    ASSERT_EQ(chmod(folder.path("tmp").c_str(), 0700), 0);
    EXPECT_EQ(laid({"/tmp", "/tmp/oswmi-new"}), "1777 0:0 \n2750 0:0 \n");
}

TEST_F(Overlay, FollowsTheMachinesLinksToDirectories)
{
    ASSERT_EQ(statusOf("/bin").st_mode & S_IFMT, static_cast<unsigned int>(S_IFLNK));
    chmod(folder.write("bin/oswmi", "text").c_str(), 0755);
    EXPECT_EQ(laid({"/usr/bin/oswmi"}), "755 0:0 text\n");
}

TEST_F(Overlay, MakesWorldReadableShadowFilesPrivate)
{
    chmod(folder.write("etc/shadow", "").c_str(), 0644);
    chmod(folder.write("etc/gshadow", "").c_str(), 0640);
    EXPECT_EQ(laid({"/etc/shadow", "/etc/gshadow"}), "600 0:0 \n640 0:0 \n");
    chmod(folder.path("etc/shadow").c_str(), 0640);
    chmod(folder.path("etc/gshadow").c_str(), 0604);
    EXPECT_EQ(laid({"/etc/shadow", "/etc/gshadow"}), "640 0:0 \n600 0:0 \n");
}

TEST_F(Overlay, DoesNotRestoreThePowerCommands)
{
    chmod(folder.write("sbin/shutdown", "the real one").c_str(), 0755);
    EXPECT_NE(laid({"/sbin/shutdown"}), "755 0:0 the real one\n");
}

TEST_F(Overlay, IsRefusedIfItIsMissingOrAFile)
{
    std::string const path = folder.path("file");
    EXPECT_EQ(reason(path), "cannot open the directory " + path + ": No such file or directory");
    folder.write("file", "");
    EXPECT_EQ(reason(path), "cannot open the directory " + path + ": Not a directory");
}

TEST_F(Overlay, RefusesOtherThanFilesLinksAndDirectories)
{
    folder.write("etc/file", "");
    ASSERT_EQ(mkfifo(folder.path("etc/pipe").c_str(), 0600), 0);
    EXPECT_EQ(reason(folder.name()), "cannot lay over /etc/pipe, neither a file nor a link nor "
                                     "a directory: Invalid argument");
}

TEST_F(Overlay, DoesNotFollowALinkThatReplacesADirectory)
{
    ScratchFolder const elsewhere;
    folder.write("etc/file", "");
    libc::hooks().fstatat = [&](int directory, char const* path, struct stat* status, int flags) {
        int const result = interpose::real(::fstatat)(directory, path, status, flags);
        if (std::string(path) == "etc") { // seen as a directory, not opened yet
            renameat(directory, path, directory, "old");
            EXPECT_EQ(symlinkat(elsewhere.name().c_str(), directory, path), 0);
        }
        return result;
    };
    EXPECT_EQ(reason(folder.name()), "cannot read the directory for /etc: Not a directory");
}

TEST_F(Overlay, IsRefusedIfAFileWouldReplaceADirectory)
{
    folder.write("etc", "");
    EXPECT_EQ(reason(folder.name()), "cannot replace /etc: Directory not empty");
}

TEST_F(Overlay, ARefusalDoesNotMoveTheCaller)
{
    ASSERT_EQ(mkfifo(folder.path("pipe").c_str(), 0600), 0);
    std::string const before = contentOf("/proc/self/mountinfo");
    pid_t const child = fork();
    if (child == 0) {
        bool const wasRefused = mihost::enterSandbox(folder.name()).has_value();
        bool const here = contentOf("/proc/self/mountinfo") == before && !mihost::inSandbox();
        // Its next children are processes of the machine again.
        pid_t const next = fork();
        if (next == 0)
            _exit(getpid() > 1 && getppid() != 0 ? 0 : 1);
        int status = 1;
        waitpid(next, &status, 0);
        _exit(wasRefused && here && status == 0 ? 0 : 1);
    }
    int status = 1;
    waitpid(child, &status, 0);
    EXPECT_EQ(status, 0);
}

TEST_F(Overlay, WithoutPrivilegesTheReasonSaysWhatIsNeeded)
{
    EXPECT_EQ(reason("",
                     [] {
                         if (setuid(65534) != 0)
                             _exit(1);
                     }),
              "cannot create a process namespace: Operation not permitted (root's privileges are "
              "needed)");
}

TEST_F(Overlay, LayingOverTheMachineItselfIsRefused)
{
    EXPECT_THROW(mihost::layOver(folder.name()), std::logic_error);
}

} // namespace overlay_test
