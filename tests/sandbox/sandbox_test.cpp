// A copy of the machine, seen from inside.

#include "mihost/sandbox/Sandbox.h"
#include "tests/support/Machine.h"

#include <cctype>
#include <cerrno>
#include <cstdlib>
#include <fcntl.h>
#include <filesystem>
#include <gtest/gtest.h>
#include <linux/capability.h>
#include <linux/netlink.h>
#include <sched.h>
#include <set>
#include <signal.h>
#include <sys/klog.h>
#include <sys/prctl.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <sys/wait.h>
#include <unistd.h>

namespace sandbox_test
{

std::set<std::string> namesIn(char const* folder)
{
    std::set<std::string> names;
    for (auto const& entry : std::filesystem::directory_iterator(folder))
        names.insert(entry.path().filename());
    return names;
}

TEST(Copy, KnowsThatItIsOne)
{
    EXPECT_TRUE(mihost::inSandbox());
}

TEST(Copy, ShowsItsOwnProcessesOnly)
{
    std::set<std::string> processes;
    for (std::string const& name : namesIn("/proc"))
        if (std::isdigit(static_cast<unsigned char>(name.front())) != 0)
            processes.insert(name);
    EXPECT_EQ(processes, (std::set<std::string>{"1", std::to_string(getpid())}));
}

TEST(Copy, HasAnEmptyRunDirectoryAndHarmlessDevicesOnly)
{
    EXPECT_EQ(namesIn("/run"), std::set<std::string>());
    EXPECT_EQ(namesIn("/dev"),
              (std::set<std::string>{"fd", "full", "null", "ptmx", "pts", "random", "shm", "stderr",
                                     "stdin", "stdout", "tty", "urandom", "zero"}));
    EXPECT_EQ(std::system("echo text >/dev/null && head -c 4 /dev/zero >/dev/null"), 0);
    EXPECT_EQ(chmod("/dev/null", 0600), -1);
    EXPECT_EQ(errno, EROFS);
}

TEST(Copy, HasItsOwnTerminals)
{
    int const terminal = posix_openpt(O_RDWR | O_NOCTTY);
    ASSERT_GE(terminal, 0);
    EXPECT_STREQ(ptsname(terminal), "/dev/pts/0");
    close(terminal);
}

TEST(Copy, HasKernelFilesThatCannotBeWritten)
{
    for (char const* file : {"/proc/sys/kernel/panic", "/proc/sys/kernel/hostname", "/proc/irq",
                             "/sys", "/sys/kernel"}) {
        EXPECT_EQ(access(file, W_OK), -1) << file;
        EXPECT_EQ(errno, EROFS) << file;
    }
}

TEST(Copy, LacksPrivilegesInEverySet)
{
    __user_cap_header_struct header{_LINUX_CAPABILITY_VERSION_3, 0};
    __user_cap_data_struct data[_LINUX_CAPABILITY_U32S_3]{};
    ASSERT_EQ(syscall(SYS_capget, &header, data), 0);
    for (unsigned int const privilege :
         {CAP_SYS_BOOT, CAP_SYS_MODULE, CAP_SYS_TIME, CAP_SYS_RAWIO, CAP_MKNOD, CAP_NET_ADMIN,
          CAP_AUDIT_WRITE, CAP_AUDIT_CONTROL, CAP_AUDIT_READ, CAP_SYSLOG, CAP_SYS_PACCT,
          CAP_SYS_TTY_CONFIG, CAP_MAC_ADMIN, CAP_MAC_OVERRIDE, CAP_WAKE_ALARM, CAP_BLOCK_SUSPEND,
          CAP_BPF, CAP_PERFMON}) {
        __user_cap_data_struct const& word = data[CAP_TO_INDEX(privilege)];
        EXPECT_EQ((word.effective | word.permitted | word.inheritable) & CAP_TO_MASK(privilege), 0U)
            << privilege;
        EXPECT_EQ(prctl(PR_CAPBSET_READ, privilege, 0, 0, 0), 0) << privilege;
        EXPECT_EQ(prctl(PR_CAP_AMBIENT, PR_CAP_AMBIENT_IS_SET, privilege, 0, 0), 0) << privilege;
    }
}

TEST(Copy, DoesNotReachTheKernelsLog)
{
    constexpr int readAll = 3;
    constexpr int clear = 5;
    char text[16] = "";
    EXPECT_EQ(klogctl(readAll, text, sizeof text), -1);
    EXPECT_EQ(errno, EPERM);
    EXPECT_EQ(klogctl(clear, nullptr, 0), -1);
    EXPECT_EQ(errno, EPERM);
}

TEST(Copy, LooksLikeAMachineWithoutAuditing)
{
    EXPECT_EQ(socket(AF_NETLINK, SOCK_RAW, NETLINK_AUDIT), -1);
    EXPECT_EQ(errno, EAFNOSUPPORT);
    EXPECT_EQ(socket(AF_NETLINK, SOCK_RAW | SOCK_CLOEXEC, NETLINK_AUDIT), -1);
    EXPECT_EQ(errno, EAFNOSUPPORT);
    EXPECT_GE(socket(AF_NETLINK, SOCK_RAW, NETLINK_ROUTE), 0);
}

TEST(Copy, LetsACommandBecomeAnotherUser)
{
    EXPECT_EQ(std::system("su -s /bin/sh -c 'test $(id -un) = nobody' nobody"), 0);
}

TEST(Copy, LetsRootAdministerAccounts)
{
    EXPECT_EQ(std::system("useradd -m jdoe && chage -M 90 jdoe && echo jdoe:pw | chpasswd && "
                          "printf 'pw\\npw\\n' | passwd jdoe && groupadd staffers && usermod -G "
                          "staffers jdoe && userdel -r jdoe"),
              0);
}

TEST(Copy, ReapsProcessesWhoseParentIsGone)
{
    int number[2];
    int life[2];
    ASSERT_EQ(pipe(number), 0);
    ASSERT_EQ(pipe(life), 0);
    pid_t const child = fork();
    if (child == 0) {
        pid_t const orphan = fork();
        if (orphan == 0) {
            // Ends when no process can write any more: its parent has ended and the test closes its
            // end.
            char end = 0;
            close(life[1]);
            _exit(read(life[0], &end, 1) == 0 ? 0 : 1);
        }
        _exit(write(number[1], &orphan, sizeof orphan) == sizeof orphan ? 0 : 1);
    }
    pid_t orphan = 0;
    ASSERT_EQ(read(number[0], &orphan, sizeof orphan), static_cast<ssize_t>(sizeof orphan));
    waitpid(child, nullptr, 0);
    close(life[1]);
    while (kill(orphan, 0) == 0) // a process that is not reaped keeps its number
        sched_yield();
    EXPECT_EQ(errno, ESRCH);
}

class PowerCommand : public testing::TestWithParam<char const*>
{
};

TEST_P(PowerCommand, OnlyPrintsAndRecordsItsArguments)
{
    std::string const path = GetParam();
    if (!std::filesystem::exists(std::filesystem::symlink_status(path)))
        GTEST_SKIP() << path << " is not on this machine";
    ASSERT_EQ(machine::read(path).rfind("#!/bin/sh\n", 0), 0U);
    EXPECT_EQ(std::system((path + " -x 'two words' 2>/tmp/said").c_str()), 0);
    std::system(path.c_str());
    EXPECT_EQ(mihost::refusedPowerCommands(), (Lines{path + " -x two words", path}));
    EXPECT_EQ(machine::read("/tmp/said"),
              "sandbox: the machine itself would run: " + path + " -x two words\n");
}

INSTANTIATE_TEST_SUITE_P(All, PowerCommand,
                         testing::Values("/sbin/shutdown", "/usr/sbin/shutdown", "/sbin/reboot",
                                         "/sbin/halt", "/sbin/poweroff"));

TEST(Copy, HasAShutdownCommandInPath)
{
    EXPECT_EQ(mihost::refusedPowerCommands(), Lines());
    std::system("shutdown -h now");
    ASSERT_EQ(mihost::refusedPowerCommands().size(), 1U);
    EXPECT_EQ(mihost::refusedPowerCommands().front().rfind("shutdown -h now"),
              mihost::refusedPowerCommands().front().size() - 15);
}

} // namespace sandbox_test
