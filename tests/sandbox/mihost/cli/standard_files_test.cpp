// mihost started without some standard streams: files that it opens must not take their places.

#include "TestPaths.h"
#include "tests/support/Lines.h"
#include "tests/support/Machine.h"
#include "tests/support/Program.h"

#include <gtest/gtest.h>

namespace standard_files_test
{

Outcome bash(std::string const& line)
{
    return runToEnd({"/bin/bash", "-c", "mihost=$1; " + line, "bash", MIHOST_FILE});
}

void expectJsonLinesOnly(std::string const& path)
{
    std::vector<std::string> const lines = linesOf(machine::read(path));
    EXPECT_FALSE(lines.empty());
    for (std::string const& line : lines)
        EXPECT_EQ(line.front(), '{') << line;
}

constexpr char badOutput[] = "mihost: cannot write the output: Bad file descriptor\n";

TEST(MihostStandardFiles, FailWithoutOutputAndKeepTheTrace)
{
    machine::lay("plain");
    Outcome const traced = bash("$mihost --trace /tmp/trace tree >&-");
    EXPECT_EQ(traced.code, 2);
    EXPECT_EQ(traced.err, badOutput);
    expectJsonLinesOnly("/tmp/trace");
    for (char const* command : {"tree", "--help", "__complete get ''", "shell <<<tree"}) {
        Outcome const outcome = bash("$mihost " + std::string(command) + " >&-");
        EXPECT_EQ(outcome.code, 2) << command;
        EXPECT_NE(outcome.err.find("Bad file descriptor"), std::string::npos) << outcome.err;
    }
}

TEST(MihostStandardFiles, KeepMessagesOutOfTheTrace)
{
    machine::lay("plain");
    EXPECT_EQ(bash("$mihost --trace /tmp/trace tree 2>&-").code, 0);
    expectJsonLinesOnly("/tmp/trace");
    EXPECT_EQ(bash("$mihost --trace /tmp/trace get user:none 2>&-").code, 4);
    expectJsonLinesOnly("/tmp/trace");
}

TEST(MihostStandardFiles, WithoutInputTheTreeIsTheSame)
{
    machine::lay("plain");
    std::string const tree = bash("$mihost tree </dev/null").out;
    Outcome const outcome = bash("$mihost --trace /tmp/trace tree <&-");
    EXPECT_EQ(outcome.out, tree);
    EXPECT_EQ(outcome.err, "");
    Outcome const script = bash("$mihost shell <&-");
    EXPECT_EQ(script.code, 0) << script.err;
}

TEST(MihostStandardFiles, WithoutInputAPasswordIsRefused)
{
    machine::lay("plain");
    Outcome const outcome = bash("$mihost call UserSetPassword UserName=root Password=- <&-");
    EXPECT_EQ(outcome.code, 2);
    EXPECT_NE(outcome.err.find("standard input is empty"), std::string::npos) << outcome.err;
}

TEST(MihostStandardFiles, WithoutAnyTheTraceIsComplete)
{
    machine::lay("plain");
    EXPECT_EQ(bash("$mihost --trace /tmp/trace tree <&- >&- 2>&-").code, 2);
    expectJsonLinesOnly("/tmp/trace");
}

} // namespace standard_files_test
