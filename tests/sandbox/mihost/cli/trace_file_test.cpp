// The file that --trace writes: who can read it, and which files it does not replace.

#include "mihost/sandbox/Descriptor.h"
#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace trace_file_test
{

constexpr char file[] = "/tmp/trace";
constexpr uid_t somebody = 65534;

class MihostTraceFile : public testing::Test
{
protected:
    MihostTraceFile()
    {
        machine::lay("plain");
        umask(0);
    }
};

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

testing::AssertionResult isTrace(std::string const& text)
{
    return holds(text, "initialize: entry");
}

void expectRefused(std::string const& reason)
{
    EXPECT_EQ(traced(), failed(2, "cannot write the trace '/tmp/trace': " + reason));
}

TEST_F(MihostTraceFile, IsReadableByItsOwnerOnly)
{
    EXPECT_EQ(traced().code, 0);
    EXPECT_EQ(modeOf(file), 0600U);
    EXPECT_TRUE(isTrace(machine::read(file)));
}

TEST_F(MihostTraceFile, IsANewOneIfOthersMayHaveTheOldOneOpen)
{
    machine::write(file, "old");
    mihost::Descriptor const reader(open(file, O_RDONLY));
    EXPECT_EQ(traced().code, 0);
    EXPECT_EQ(modeOf(file), 0600U);
    EXPECT_TRUE(isTrace(machine::read(file)));
    char text[16] = "";
    EXPECT_EQ(read(reader.get(), text, sizeof text), 3);
}

TEST_F(MihostTraceFile, IsTruncatedIfOnlyItsOwnerCanReadIt)
{
    machine::write(file, std::string(1 << 20, 'x'), 0600);
    ino_t const before = statusOf(file).st_ino;
    EXPECT_EQ(traced().code, 0);
    EXPECT_EQ(statusOf(file).st_ino, before);
    EXPECT_EQ(machine::read(file).front(), '{');
    EXPECT_FALSE(holds(machine::read(file), 'x' + std::string("xx")));
}

TEST_F(MihostTraceFile, IsNotAnotherUsers)
{
    machine::write(file, "theirs");
    ASSERT_EQ(chown(file, somebody, somebody), 0);
    expectRefused("it belongs to another user (name another file)");
    EXPECT_EQ(machine::read(file), "theirs");
}

TEST_F(MihostTraceFile, IsNotInAMissingDirectory)
{
    EXPECT_EQ(mihostRun({"--trace", "/none/file", "get", "os", "108"}),
              failed(2, "cannot write the trace '/none/file': No such file or directory"));
}

TEST_F(MihostTraceFile, IsNotWhereAnotherUsersLinkLeads)
{
    machine::write("/etc/victim", "precious", 0600);
    ASSERT_EQ(symlink("/etc/victim", file), 0);
    ASSERT_EQ(lchown(file, somebody, somebody), 0);
    expectRefused("the link belongs to another user (name another file)");
    EXPECT_EQ(machine::read("/etc/victim"), "precious");
}

TEST_F(MihostTraceFile, IsWhereTheOwnersLinkLeads)
{
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

TEST_F(MihostTraceFile, DoesNotChangeAFileWithAnotherName)
{
    machine::write("/etc/victim", "precious", 0600);
    ASSERT_EQ(link("/etc/victim", file), 0);
    EXPECT_EQ(traced().code, 0);
    EXPECT_EQ(machine::read("/etc/victim"), "precious");
    EXPECT_TRUE(isTrace(machine::read(file)));
}

TEST_F(MihostTraceFile, MayBeAPipeOrAStream)
{
    for (char const* line : {"$mihost --trace /dev/stderr get os 108 2>&1 >/dev/null | cat",
                             "$mihost --trace /dev/stdout get os 108 | cat",
                             "$mihost --trace /dev/fd/3 get os 108 3>&1 >/dev/null | cat",
                             "mkfifo /tmp/pipe; cat /tmp/pipe & "
                             "$mihost --trace /tmp/pipe get os 108; wait"})
        EXPECT_TRUE(isTrace(bashRun(line).out)) << line;
    EXPECT_EQ(bashRun("$mihost --trace /dev/null get os 108 >&-").code, 2);
    EXPECT_EQ(modeOf("/dev/null"), 0666U);
}

TEST_F(MihostTraceFile, AppendsToAStandardStream)
{
    machine::write("/tmp/log", "first line\n");
    EXPECT_EQ(bashRun("$mihost --trace /dev/stderr get os 108 2>>/tmp/log").code, 0);
    std::string const log = machine::read("/tmp/log");
    EXPECT_TRUE(startsWith(log, "first line\n{"));
    EXPECT_TRUE(isTrace(log));
    EXPECT_EQ(modeOf("/tmp/log"), 0644U); // unchanged: the caller opened it
}

} // namespace trace_file_test
