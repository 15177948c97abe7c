// The file that --trace writes: who can read it, and which files it does not replace.

#include "TestPaths.h"
#include "mihost/sandbox/Descriptor.h"
#include "tests/support/Machine.h"
#include "tests/support/Program.h"

#include <fcntl.h>
#include <filesystem>
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

namespace trace_file_test
{

constexpr char file[] = "/tmp/trace";
constexpr uid_t somebody = 65534;

Outcome bash(std::string const& line)
{
    return runToEnd({"/bin/bash", "-c", "mihost=$1; umask 0; " + line, "bash", MIHOST_FILE});
}

/** A machine without a trace of an earlier test. */
void layMachineWithoutTraces()
{
    machine::lay("plain");
    for (char const* path : {file, "/etc/victim", "/var/tmp/real", "/tmp/pipe"})
        machine::remove(path);
}

Outcome traced()
{
    return mihostRun({"--trace", file, "get", "os", "108"});
}

struct stat statusOf(std::string const& path)
{
    struct stat status {
    };
    EXPECT_EQ(lstat(path.c_str(), &status), 0) << path;
    return status;
}

unsigned int modeOf(std::string const& path)
{
    return statusOf(path).st_mode & 07777;
}

bool isTrace(std::string const& text)
{
    return text.find("initialize: entry") != std::string::npos;
}

void expectRefused(std::string const& reason)
{
    Outcome const outcome = traced();
    EXPECT_EQ(outcome.code, 2);
    EXPECT_EQ(outcome.out, "");
    EXPECT_EQ(outcome.err, "mihost: cannot write the trace '/tmp/trace': " + reason + "\n");
}

TEST(MihostTraceFile, IsReadableByItsOwnerOnly)
{
    layMachineWithoutTraces();
    EXPECT_EQ(bash("$mihost --trace /tmp/trace get os 108").code, 0);
    EXPECT_EQ(modeOf(file), 0600U);
    EXPECT_TRUE(isTrace(machine::read(file)));
}

TEST(MihostTraceFile, IsANewOneIfOthersMayHaveTheOldOneOpen)
{
    layMachineWithoutTraces();
    machine::write(file, "old");
    mihost::Descriptor const reader(open(file, O_RDONLY));
    EXPECT_EQ(traced().code, 0);
    EXPECT_EQ(modeOf(file), 0600U);
    EXPECT_TRUE(isTrace(machine::read(file)));
    char text[16] = "";
    EXPECT_EQ(read(reader.get(), text, sizeof text), 3);
}

TEST(MihostTraceFile, IsTruncatedIfOnlyItsOwnerCanReadIt)
{
    layMachineWithoutTraces();
    machine::write(file, std::string(1 << 20, 'x'), 0600);
    ino_t const before = statusOf(file).st_ino;
    EXPECT_EQ(traced().code, 0);
    EXPECT_EQ(statusOf(file).st_ino, before);
    EXPECT_EQ(machine::read(file).front(), '{');
    EXPECT_EQ(machine::read(file).find('x' + std::string("xx")), std::string::npos);
}

TEST(MihostTraceFile, IsNotAnotherUsers)
{
    layMachineWithoutTraces();
    machine::write(file, "theirs");
    ASSERT_EQ(chown(file, somebody, somebody), 0);
    expectRefused("it belongs to another user (name another file)");
    EXPECT_EQ(machine::read(file), "theirs");
}

TEST(MihostTraceFile, IsNotWhereAnotherUsersLinkLeads)
{
    layMachineWithoutTraces();
    machine::write("/etc/victim", "precious", 0600);
    ASSERT_EQ(symlink("/etc/victim", file), 0);
    ASSERT_EQ(lchown(file, somebody, somebody), 0);
    expectRefused("the link belongs to another user (name another file)");
    EXPECT_EQ(machine::read("/etc/victim"), "precious");
}

TEST(MihostTraceFile, IsWhereTheOwnersLinkLeads)
{
    layMachineWithoutTraces();
    machine::write("/var/tmp/real", "old");
    ASSERT_EQ(symlink("/var/tmp/real", file), 0);
    EXPECT_EQ(traced().code, 0);
    EXPECT_TRUE(S_ISLNK(statusOf(file).st_mode));
    EXPECT_EQ(modeOf("/var/tmp/real"), 0600U);
    EXPECT_TRUE(isTrace(machine::read("/var/tmp/real")));
    machine::remove("/var/tmp/real");
    EXPECT_EQ(traced().code, 0);
    EXPECT_EQ(modeOf("/var/tmp/real"), 0600U);
}

TEST(MihostTraceFile, DoesNotChangeAFileWithAnotherName)
{
    layMachineWithoutTraces();
    machine::write("/etc/victim", "precious", 0600);
    ASSERT_EQ(link("/etc/victim", file), 0);
    EXPECT_EQ(traced().code, 0);
    EXPECT_EQ(machine::read("/etc/victim"), "precious");
    EXPECT_TRUE(isTrace(machine::read(file)));
}

TEST(MihostTraceFile, MayBeAPipeOrAStream)
{
    layMachineWithoutTraces();
    EXPECT_TRUE(isTrace(bash("$mihost --trace /dev/stderr get os 108 2>&1 >/dev/null | cat").out));
    EXPECT_TRUE(isTrace(bash("$mihost --trace /dev/stdout get os 108 | cat").out));
    EXPECT_TRUE(isTrace(bash("$mihost --trace /dev/fd/3 get os 108 3>&1 >/dev/null | cat").out));
    EXPECT_TRUE(isTrace(bash("mkfifo /tmp/pipe; cat /tmp/pipe & "
                             "$mihost --trace /tmp/pipe get os 108; wait")
                            .out));
    EXPECT_EQ(bash("$mihost --trace /dev/null get os 108 >&-").code, 2);
    EXPECT_EQ(modeOf("/dev/null"), 0666U);
}

TEST(MihostTraceFile, AppendsToAStandardStream)
{
    layMachineWithoutTraces();
    machine::write("/tmp/log", "first line\n");
    EXPECT_EQ(bash("$mihost --trace /dev/stderr get os 108 2>>/tmp/log").code, 0);
    std::string const log = machine::read("/tmp/log");
    EXPECT_EQ(log.rfind("first line\n{", 0), 0U);
    EXPECT_TRUE(isTrace(log));
    EXPECT_EQ(modeOf("/tmp/log"), 0644U); // unchanged: the caller opened it
}

} // namespace trace_file_test
