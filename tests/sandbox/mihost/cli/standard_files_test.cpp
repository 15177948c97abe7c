// mihost started without some standard streams: files that it opens must not take their places.

#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"

namespace standard_files_test
{

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
    Outcome const traced = bashRun("$mihost --trace /tmp/trace tree >&-");
    EXPECT_EQ(traced.code, 2);
    EXPECT_EQ(traced.err, badOutput);
    expectJsonLinesOnly("/tmp/trace");
    for (char const* command : {"tree", "--help", "__complete get ''", "shell <<<tree"}) {
        Outcome const outcome = bashRun("$mihost " + std::string(command) + " >&-");
        EXPECT_EQ(outcome.code, 2) << command;
        EXPECT_TRUE(holds(outcome.err, "Bad file descriptor"));
    }
}

TEST(MihostStandardFiles, KeepMessagesOutOfTheTrace)
{
    machine::lay("plain");
    EXPECT_EQ(bashRun("$mihost --trace /tmp/trace tree 2>&-").code, 0);
    expectJsonLinesOnly("/tmp/trace");
    EXPECT_EQ(bashRun("$mihost --trace /tmp/trace get user:none 2>&-").code, 4);
    expectJsonLinesOnly("/tmp/trace");
}

TEST(MihostStandardFiles, WithoutInputTheTreeIsTheSame)
{
    machine::lay("plain");
    std::string const tree = bashRun("$mihost tree </dev/null").out;
    Outcome const outcome = bashRun("$mihost --trace /tmp/trace tree <&-");
    EXPECT_EQ(outcome.out, tree);
    EXPECT_EQ(outcome.err, "");
    Outcome const script = bashRun("$mihost shell <&-");
    EXPECT_EQ(script.code, 0) << script.err;
}

TEST(MihostStandardFiles, WithoutInputAPasswordIsRefused)
{
    machine::lay("plain");
    Outcome const outcome = bashRun("$mihost call UserSetPassword UserName=root Password=- <&-");
    EXPECT_EQ(outcome.code, 2);
    EXPECT_TRUE(holds(outcome.err, "standard input is empty"));
}

TEST(MihostStandardFiles, WithoutAnyTheTraceIsComplete)
{
    machine::lay("plain");
    EXPECT_EQ(bashRun("$mihost --trace /tmp/trace tree <&- >&- 2>&-").code, 2);
    expectJsonLinesOnly("/tmp/trace");
}

} // namespace standard_files_test
