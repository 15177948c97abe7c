// What must hold between a copy of the machine and the machine itself, seen from the machine.

#include "tests/sandbox/border/Caller.h"
#include "tests/support/Lines.h"
#include "tests/support/ScratchFolder.h"

#include <csignal>
#include <cstdio>
#include <fcntl.h>
#include <fstream>
#include <net/if.h>
#include <netinet/in.h>
#include <sys/mount.h>
#include <sys/shm.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <sys/utsname.h>
#include <sys/wait.h>
#include <unistd.h>

namespace border_test
{

std::string mountTable()
{
    return contentOf("/proc/self/mountinfo");
}

std::string hostName()
{
    utsname system{};
    uname(&system);
    return system.nodename;
}

/** Writes a file. @return whether it then has the text */
bool wrote(std::string const& path, std::string const& text)
{
    std::ofstream(path) << text;
    return contentOf(path) == text;
}

class Border : public BorderTest
{
};

TEST_F(Border, ChangesInsideDoNotReachTheMachinesFiles)
{
    ScratchFolder const folder;
    folder.write("changed", "before");
    folder.write("removed", "before");
    std::string const accounts = contentOf("/etc/passwd");
    std::string const name = "/oswmi-border-" + std::to_string(getpid());
    Lines const folders = {"/etc", "/tmp", "/var/tmp", "/dev/shm", "/run", "/root"};
    Caller caller([&] {
        for (std::string const& path : folders)
            if (!wrote(path + name, "new"))
                return 1;
        if (!wrote(folder.path("changed"), "after"))
            return 2;
        if (unlink(folder.path("removed").c_str()) != 0 || exists(folder.path("removed")))
            return 3;
        return system("/usr/sbin/useradd -M oswmiborder") == 0 ? 0 : 4;
    });
    EXPECT_EQ(caller.wait(), 0);
    for (std::string const& path : folders)
        EXPECT_FALSE(exists(path + name)) << path;
    EXPECT_EQ(contentOf(folder.path("changed")), "before");
    EXPECT_EQ(contentOf(folder.path("removed")), "before");
    EXPECT_EQ(contentOf("/etc/passwd"), accounts);
}

TEST_F(Border, MountsOfTheMachineAreUnchangedDuringACopy)
{
    std::string const before = mountTable();
    Caller caller([]() -> int {
        if (mount("tmpfs", "/mnt", "tmpfs", 0, "") != 0)
            return 1;
        Caller::sayAndWait();
    });
    ASSERT_EQ(caller.hear(1), ".");
    EXPECT_EQ(mountTable(), before);
    caller.send(SIGTERM);
    caller.wait();
    EXPECT_EQ(mountTable(), before);
}

TEST_F(Border, ACrashInsideLeavesNothingAndIsReported)
{
    std::string const mounts = mountTable();
    ScratchFolder const folder;
    folder.write("file", "before");
    Caller caller([&folder]() -> int {
        wrote(folder.path("file"), "after");
        if (fork() == 0)
            pause();
        abort();
    });
    EXPECT_EQ(caller.hearAll(), ""); // ends once the forgotten process has gone, too
    int const status = caller.wait();
    ASSERT_TRUE(WIFSIGNALED(status));
    EXPECT_EQ(WTERMSIG(status), SIGABRT);
    EXPECT_EQ(mountTable(), mounts);
    EXPECT_EQ(contentOf(folder.path("file")), "before");
}

TEST_F(Border, TheExitCodeInsideIsThatOfTheCaller)
{
    Caller caller([] { return 42; });
    int const status = caller.wait();
    ASSERT_TRUE(WIFEXITED(status));
    EXPECT_EQ(WEXITSTATUS(status), 42);
}

class ForwardedSignals : public BorderTest, public testing::WithParamInterface<int>
{
};

TEST_P(ForwardedSignals, EndTheSandboxedProcessAndTheCaller)
{
    Caller caller([]() -> int { Caller::sayAndWait(); });
    ASSERT_EQ(caller.hear(1), ".");
    caller.send(GetParam());
    EXPECT_EQ(caller.hearAll(), "");
    int const status = caller.wait();
    ASSERT_TRUE(WIFSIGNALED(status));
    EXPECT_EQ(WTERMSIG(status), GetParam());
}

TEST_P(ForwardedSignals, CanBeHandledInside)
{
    Caller caller([]() -> int {
        std::signal(GetParam(), [](int) { _exit(5); });
        Caller::sayAndWait();
    });
    ASSERT_EQ(caller.hear(1), ".");
    caller.send(GetParam());
    int const status = caller.wait();
    ASSERT_TRUE(WIFEXITED(status));
    EXPECT_EQ(WEXITSTATUS(status), 5);
}

INSTANTIATE_TEST_SUITE_P(All, ForwardedSignals,
                         testing::Values(SIGHUP, SIGINT, SIGQUIT, SIGTERM, SIGUSR1, SIGUSR2));

TEST_F(Border, ATerminalsInterruptReachesTheSandboxedProcessOnce)
{
    mihost::Descriptor const terminal(posix_openpt(O_RDWR | O_NOCTTY));
    ASSERT_EQ(grantpt(terminal.get()), 0);
    ASSERT_EQ(unlockpt(terminal.get()), 0);
    std::string const name = ptsname(terminal.get());
    Caller caller(
        []() -> int {
            std::signal(SIGINT, [](int) { Caller::say("i"); });
            Caller::sayAndWait();
        },
        "",
        [&name] {
            setsid();
            // The first terminal that a session's leader opens is the session's own.
            if (open(name.c_str(), O_RDWR) < 0)
                _exit(1);
        });
    ASSERT_EQ(caller.hear(1), ".");
    char const interrupt = '\x03';
    ASSERT_EQ(write(terminal.get(), &interrupt, 1), 1);
    EXPECT_EQ(caller.hear(1), "i");
    caller.send(SIGTERM); // arrives after everything that the interrupt causes
    EXPECT_EQ(caller.hearAll(), "");
}

TEST_F(Border, EverythingInsideDiesWithTheCaller)
{
    Caller caller([]() -> int {
        for (int const signal : {SIGHUP, SIGINT, SIGQUIT, SIGTERM, SIGUSR1, SIGUSR2})
            std::signal(signal, SIG_IGN);
        Caller::sayAndWait();
    });
    ASSERT_EQ(caller.hear(1), ".");
    caller.send(SIGKILL);
    EXPECT_EQ(caller.hearAll(), "");
    caller.wait();
}

TEST_F(Border, WorksIfTheCallerIgnoresItsChildren)
{
    Caller caller([] { return 42; }, "", [] { std::signal(SIGCHLD, SIG_IGN); });
    EXPECT_EQ(WEXITSTATUS(caller.wait()), 42);
}

TEST_F(Border, BufferedTextOfTheCallerIsWrittenOnce)
{
    ScratchFolder const folder;
    std::string const path = folder.path("out");
    FILE* out = nullptr;
    Caller caller(
        [&out] {
            std::fputs("inside ", out);
            std::exit(0);
            return 0;
        },
        "",
        [&out, &path] {
            // On the real file: a path would lead into the copy.
            out = std::fopen(path.c_str(), "w");
            std::fputs("before ", out);
        });
    caller.wait();
    EXPECT_EQ(contentOf(path), "before inside ");
}

TEST_F(Border, SharedMemoryMadeInsideDoesNotShowOnTheMachine)
{
    key_t const key = 0x4f530000 + getpid();
    Caller caller([key]() -> int {
        if (shmget(key, 4096, IPC_CREAT | IPC_EXCL | 0600) < 0)
            return 1;
        Caller::sayAndWait();
    });
    ASSERT_EQ(caller.hear(1), ".");
    EXPECT_LT(shmget(key, 4096, 0600), 0);
}

/** Binds an abstract socket or connects to it. @return 0 for success */
template <class Call> int abstractSocket(std::string const& name, Call call)
{
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    name.copy(address.sun_path + 1, sizeof address.sun_path - 1);
    int const socket = ::socket(AF_UNIX, SOCK_DGRAM | SOCK_CLOEXEC, 0);
    return call(socket, reinterpret_cast<sockaddr const*>(&address), sizeof address);
}

TEST_F(Border, AbstractSocketsOfTheMachineAreNotVisibleInside)
{
    std::string const name = "oswmi-border-" + std::to_string(getpid());
    Caller caller(
        [&name] { return abstractSocket(name, connect) != 0 && errno == ECONNREFUSED ? 0 : 1; }, "",
        [&name] {
            if (abstractSocket(name, bind) != 0 || abstractSocket(name, connect) != 0)
                _exit(2);
        });
    EXPECT_EQ(caller.wait(), 0);
}

TEST_F(Border, TheNetworkInsideIsOnlyItsOwnLoopback)
{
    Caller caller([] {
        std::string said;
        struct if_nameindex* const all = if_nameindex();
        for (auto const* interface = all; interface && interface->if_name; ++interface)
            said += interface->if_name + std::string(" ");
        if_freenameindex(all);
        Caller::say(said);
        // A listener on the loopback can be reached.
        int const listener = socket(AF_INET, SOCK_STREAM, 0);
        sockaddr_in address{};
        address.sin_family = AF_INET;
        address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
        socklen_t length = sizeof address;
        auto* const place = reinterpret_cast<sockaddr*>(&address);
        if (bind(listener, place, length) != 0 || listen(listener, 1) != 0 ||
            getsockname(listener, place, &length) != 0)
            return 1;
        return connect(socket(AF_INET, SOCK_STREAM, 0), place, length) == 0 ? 0 : 2;
    });
    EXPECT_EQ(caller.hearAll(), "lo ");
    EXPECT_EQ(caller.wait(), 0);
}

TEST_F(Border, TheHostNameInsideIsNotTheMachines)
{
    std::string const before = hostName();
    Caller caller([] { return sethostname("copy", 4) == 0 && hostName() == "copy" ? 0 : 1; });
    EXPECT_EQ(caller.wait(), 0);
    EXPECT_EQ(hostName(), before);
}

TEST_F(Border, OtherFileSystemsAreCopiedOnWriteToo)
{
    ScratchFolder const folder;
    std::string const file = folder.path("disk/sub folder,:\\/file");
    // A second file system, in the caller's own mount namespace.
    Caller caller(
        [&file] {
            Caller::say(contentOf(file));
            return wrote(file, "after") ? 0 : 1;
        },
        "",
        [&folder, &file] {
            folder.write("disk/none", "");
            std::string const disk = folder.path("disk");
            mountOwnDisk(disk);
            folder.write("disk/sub folder,:\\/file", "outer");
            mount("tmpfs", (disk + "/sub folder,:\\").c_str(), "tmpfs", 0, "");
            folder.write("disk/sub folder,:\\/file", "before");
            // From here on, the machine is what this process sees.
            continueInChild([&file] { Caller::say(" " + contentOf(file)); });
        });
    EXPECT_EQ(caller.hearAll(), "before before");
    EXPECT_EQ(caller.wait(), 0);
}

TEST_F(Border, ShowsAnUnsuitableFileSystemReadOnly)
{
    ScratchFolder const folder;
    std::string const disk = folder.path("disk");
    Caller caller(
        [&disk] {
            bool const canBeRead = contentOf(disk + "/file") == "before";
            return canBeRead && access(disk.c_str(), W_OK) != 0 && errno == EROFS ? 0 : 1;
        },
        "",
        [&folder, &disk] {
            folder.write("disk/none", "");
            mountOwnDisk(disk);
            // Overlays can be stacked, but only a few deep.
            if (chdir(disk.c_str()) != 0)
                _exit(1);
            for (char const* part : {"0", "1", "2", "u1", "u2", "w1", "w2"})
                mkdir(part, 0755);
            folder.write("disk/0/file", "before");
            if (mount("overlay", "1", "overlay", 0, "lowerdir=0,upperdir=u1,workdir=w1") != 0 ||
                mount("overlay", "2", "overlay", 0, "lowerdir=1,upperdir=u2,workdir=w2") != 0 ||
                mount("2", disk.c_str(), nullptr, MS_BIND, nullptr) != 0 || chdir("/") != 0)
                _exit(1);
        });
    EXPECT_EQ(caller.wait(), 0);
}

TEST_F(Border, AFileMountedOverAnotherIsCopiedWithItsOwnerAndMode)
{
    ScratchFolder const folder;
    chmod(folder.write("over", "over").c_str(), 0640);
    chmod(folder.write("below", "below").c_str(), 0644);
    Caller caller(
        [&folder] {
            struct stat status {
            };
            stat(folder.path("below").c_str(), &status);
            return contentOf(folder.path("below")) == "over" && (status.st_mode & 07777) == 0640 &&
                           status.st_uid == 12 && status.st_gid == 34 &&
                           wrote(folder.path("below"), "after")
                       ? 0
                       : 1;
        },
        "",
        [&folder] {
            if (chown(folder.path("over").c_str(), 12, 34) != 0)
                _exit(1);
            ownMounts();
            mount(folder.path("over").c_str(), folder.path("below").c_str(), nullptr, MS_BIND,
                  nullptr);
        });
    EXPECT_EQ(caller.wait(), 0);
    EXPECT_EQ(contentOf(folder.path("over")), "over");
    EXPECT_EQ(contentOf(folder.path("below")), "below");
}

TEST_F(Border, KeepsTheWorkingDirectory)
{
    ScratchFolder const folder;
    Caller caller(
        [] {
            Caller::sayWorkingDirectory();
            return 0;
        },
        "",
        [&folder] {
            if (chdir(folder.name().c_str()) != 0)
                _exit(1);
        });
    EXPECT_EQ(caller.hearAll(), folder.name());
}

TEST_F(Border, GoesToTheRootIfTheCopyLacksTheWorkingDirectory)
{
    Caller caller(
        [] {
            Caller::sayWorkingDirectory();
            return 0;
        },
        "",
        [] {
            mountOwnDisk("/run");
            mkdir("/run/folder", 0700);
            if (chdir("/run/folder") != 0)
                _exit(1);
        });
    EXPECT_EQ(caller.hearAll(), "/");
}

} // namespace border_test
