// The helpers that the other tests of this tier use.

#include "tests/support/Machine.h"

#include <cstdlib>
#include <gtest/gtest.h>
#include <sys/stat.h>

namespace harness_test
{

TEST(ShellRecorder, RecordsCommandLinesExactlyAndRunsThem)
{
    machine::recordShell();
    std::system("printf '%s' 'a  \"b\"' >/tmp/said; # end\n");
    EXPECT_EQ(WEXITSTATUS(std::system("exit 3")), 3);
    EXPECT_EQ(machine::ran(), (Lines{"printf '%s' 'a  \"b\"' >/tmp/said; # end\n", "exit 3"}));
    EXPECT_EQ(machine::read("/tmp/said"), "a  \"b\"");
}

TEST(ShellRecorder, DoesNotRecordTheShellsOfScripts)
{
    machine::fake("/usr/local/bin/script", "echo \"$1\" >/tmp/said\n");
    machine::recordShell();
    std::system("true");
    machine::forget();
    std::system("script word");
    EXPECT_EQ(machine::ran(), Lines{"script word"});
    EXPECT_EQ(machine::read("/tmp/said"), "word\n");
}

TEST(ToolRecorder, RecordsEachArgumentUnchanged)
{
    machine::record("/usr/bin/printf");
    std::system("/usr/bin/printf '' a\\ b \"\" >/dev/null");
    EXPECT_EQ(machine::calls("/usr/bin/printf"), (std::vector<Lines>{{"", "a b", ""}}));
}

TEST(Machine, LaysFilesOverTheCopyOwnedByRoot)
{
    machine::lay("plain");
    EXPECT_EQ(machine::entry("/etc/passwd", "root").at(5), "/root");
    struct stat status {
    };
    ASSERT_EQ(stat("/etc/passwd", &status), 0);
    EXPECT_EQ(status.st_uid, 0U);
    EXPECT_EQ(status.st_mode & 07777U, 0644U);
}

TEST(Machine, FindsAccountRecordsByTheirWholeName)
{
    machine::write("/etc/group", "staffer:x:5:\nstaff:x:6:joe,\n");
    EXPECT_EQ(machine::entry("/etc/group", "staff"), (Lines{"staff", "x", "6", "joe,"}));
    EXPECT_EQ(machine::entry("/etc/group", "sta"), Lines());
}

} // namespace harness_test
