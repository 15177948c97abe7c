#include "tests/support/Program.h"

#include <algorithm>
#include <fstream>
#include <gtest/gtest.h>
#include <unistd.h>

namespace
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

TEST(LoadingThePlugin, NamesAFileThatIsNoElfFile)
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

} // namespace
