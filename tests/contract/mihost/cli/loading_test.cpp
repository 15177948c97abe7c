#include "TestPaths.h"
#include "tests/support/Program.h"

#include <algorithm>
#include <cstdlib>
#include <gtest/gtest.h>
#include <unistd.h>

namespace loading_test
{

void expectOneLine(std::string const& text)
{
    EXPECT_EQ(std::count(text.begin(), text.end(), '\n'), 1) << text;
    EXPECT_EQ(text.back(), '\n') << text;
}

void expectRefused(std::string const& file, std::string const& reason)
{
    Outcome const outcome = mihostRun({"--plugin", file, "tree"});
    EXPECT_EQ(outcome.code, 3);
    EXPECT_EQ(outcome.out, "");
    expectOneLine(outcome.err);
    EXPECT_NE(outcome.err.find("'" + file + "'"), std::string::npos) << outcome.err;
    EXPECT_NE(outcome.err.find(reason), std::string::npos) << outcome.err;
}

TEST(LoadingThePlugin, NamesAFileThatIsMissing)
{
    expectRefused("/nonexistent/plugin.so", "No such file or directory");
}

TEST(LoadingThePlugin, NamesAFileThatIsNotElf)
{
    expectRefused("/etc/passwd", "invalid ELF header");
}

TEST(LoadingThePlugin, NamesALibraryWithoutTheEntryPoint)
{
    expectRefused(PLUGIN_WITHOUT_ENTRY_POINT, "it has no entry point OpenMI");
}

TEST(LoadingThePlugin, NamesTheSymbolThatTheHostLacks)
{
    expectRefused(PLUGIN_THAT_WANTS_MORE, "undefined symbol: hostOperationFromTheFuture");
}

TEST(LoadingThePlugin, ReportsTheEntryPointsStatus)
{
    setenv("ODD", "answer", 1);
    expectRefused(PLUGIN_THAT_IS_ODD, "OpenMI returned 7");
}

TEST(LoadingThePlugin, ReportsAMissingInterface)
{
    setenv("ODD", "interface", 1);
    expectRefused(PLUGIN_THAT_IS_ODD, "OpenMI returned no interface");
}

TEST(LoadingThePlugin, ReportsWhyAPluginDidNotStart)
{
    setenv("ODD", "start", 1);
    Outcome const outcome = mihostRun({"--plugin", PLUGIN_THAT_IS_ODD, "tree"});
    EXPECT_EQ(outcome.code, 1);
    EXPECT_EQ(outcome.out, "");
    EXPECT_EQ(outcome.err, "mihost: the plug-in did not start: status 5: no reason\n");
}

TEST(LoadingThePlugin, ShowsButNeverWritesANodeOfUnknownKind)
{
    EXPECT_EQ(mihostRun({"--plugin", PLUGIN_THAT_IS_ODD, "tree", "--all"}).out,
              "2 #2\n        7 7  seven\n");
    Outcome const outcome = mihostRun({"--plugin", PLUGIN_THAT_IS_ODD, "set", "2", "7", "eight"});
    EXPECT_EQ(outcome.code, 4);
    EXPECT_EQ(outcome.err,
              "mihost: set: unknown property '7' of node '2' (see 'mihost properties')\n");
}

TEST(LoadingThePlugin, ReportsAMissingTemporaryDirectory)
{
    setenv("TMPDIR", "/nonexistent", 1);
    Outcome const outcome = mihostRun({"tree"});
    EXPECT_EQ(outcome.code, 3);
    EXPECT_EQ(outcome.out, "");
    EXPECT_EQ(outcome.err, "mihost: cannot create a private directory in '/nonexistent': "
                           "No such file or directory\n");
}

TEST(LoadingThePlugin, FindsThePluginBesideTheProgram)
{
    EXPECT_EQ(mihostRun({"get", "os"}).code, 0);
}

TEST(LoadingThePlugin, TakesAPathRelativeToTheWorkingDirectory)
{
    std::string const file = PLUGIN_FILE;
    std::size_t const slash = file.rfind('/');
    ASSERT_EQ(chdir(file.substr(0, slash).c_str()), 0);
    EXPECT_EQ(mihostRun({"--plugin", file.substr(slash + 1), "get", "os"}).code, 0);
}

} // namespace loading_test
