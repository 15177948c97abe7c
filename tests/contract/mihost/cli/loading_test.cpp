#include "TestPaths.h"
#include "tests/support/Mihost.h"

#include <cstdlib>
#include <unistd.h>

namespace loading_test
{

TEST(LoadingThePlugin, NamesTheFileAndWhatIsWrongWithIt)
{
    struct Row {
        std::string file;
        char const* reason;
        char const* oddity = "";
    };
    for (Row const& row :
         {Row{"/nonexistent/plugin.so", "No such file or directory"},
          Row{"/etc/passwd", "invalid ELF header"},
          Row{PLUGIN_WITHOUT_ENTRY_POINT, "it has no entry point OpenMI"},
          Row{PLUGIN_THAT_WANTS_MORE, "undefined symbol: hostOperationFromTheFuture"},
          Row{PLUGIN_THAT_IS_ODD, "OpenMI returned 7", "answer"},
          Row{PLUGIN_THAT_IS_ODD, "OpenMI returned no interface", "interface"}}) {
        setenv("ODD", row.oddity, 1);
        Outcome const outcome = mihostRun({"--plugin", row.file, "tree"});
        EXPECT_EQ(outcome.code, 3);
        EXPECT_EQ(outcome.out, "");
        EXPECT_EQ(linesOf(outcome.err).size(), 1U) << outcome.err;
        EXPECT_TRUE(holds(outcome.err, "'" + row.file + "'"));
        EXPECT_TRUE(holds(outcome.err, row.reason));
    }
}

TEST(LoadingThePlugin, ReportsWhyAPluginDidNotStart)
{
    setenv("ODD", "start", 1);
    EXPECT_EQ(mihostRun({"--plugin", PLUGIN_THAT_IS_ODD, "tree"}),
              failed(1, "the plug-in did not start: status 5: no reason"));
}

TEST(LoadingThePlugin, ShowsButNeverWritesANodeOfUnknownKind)
{
    EXPECT_EQ(mihostRun({"--plugin", PLUGIN_THAT_IS_ODD, "tree", "--all"}).out,
              "2 #2\n        7 7  seven\n");
    EXPECT_EQ(mihostRun({"--plugin", PLUGIN_THAT_IS_ODD, "set", "2", "7", "eight"}),
              failed(4, "set: unknown property '7' of node '2' (see 'mihost properties')"));
}

TEST(LoadingThePlugin, ReportsAMissingTemporaryDirectory)
{
    setenv("TMPDIR", "/nonexistent", 1);
    EXPECT_EQ(mihostRun({"tree"}), failed(3, "cannot create a private directory in '/nonexistent': "
                                             "No such file or directory"));
}

TEST(LoadingThePlugin, FindsItBesideTheProgramOrByARelativePath)
{
    EXPECT_EQ(mihostRun({"get", "os"}).code, 0);
    std::string const file = PLUGIN_FILE;
    std::size_t const slash = file.rfind('/');
    ASSERT_EQ(chdir(file.substr(0, slash).c_str()), 0);
    EXPECT_EQ(mihostRun({"--plugin", file.substr(slash + 1), "get", "os"}).code, 0);
}

} // namespace loading_test
