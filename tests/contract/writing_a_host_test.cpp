// The programs of docs/writing-a-host.md: they are in the page, and do what it says.

#include "TestPaths.h"
#include "tests/support/Lines.h"
#include "tests/support/Program.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <filesystem>

namespace writing_a_host_test
{

namespace fs = std::filesystem;

Outcome run(std::string const& example, std::vector<std::string> arguments = {})
{
    fs::path const programs = fs::path(MIHOST_FILE).parent_path();
    arguments.insert(arguments.begin(), {programs / ("example_" + example), PLUGIN_FILE});
    return runToEnd(arguments);
}

TEST(ExampleHosts, AreAllInThePageWordForWord)
{
    std::string const page = contentOf(DOCS_DIR "/writing-a-host.md");
    std::size_t files = 0;
    for (fs::directory_entry const& entry : fs::directory_iterator(DOCS_DIR "/examples")) {
        std::string const program = contentOf(entry.path());
        ASSERT_FALSE(program.empty());
        EXPECT_NE(page.find("```cpp\n" + program + "```"), std::string::npos) << entry.path();
        EXPECT_NE(page.find('`' + entry.path().filename().string() + '`'), std::string::npos);
        ++files;
    }
    EXPECT_EQ(files, 7U);
}

TEST(MinimalHost, PrintsTheTreeFromTheTop)
{
    std::string const tree = run("minimal_host").out;
    EXPECT_EQ(tree.find("1 OsSw Management Interface\n"
                        "  2 ROOT Node\n"
                        "    3 Computer\n"
                        "      4 Operating System\n"),
              0U)
        << tree;
}

TEST(LiveReadHost, ReadsMemoryAndAMissingProperty)
{
    Outcome const outcome = run("live_read");
    EXPECT_EQ(outcome.code, 0);
    EXPECT_EQ(outcome.out.find("free now: "), 0U) << outcome.out;
    EXPECT_NE(outcome.out.find(" KiB\nfree at the start: "), std::string::npos);
    EXPECT_NE(outcome.out.find("no such property: status 1\n"), std::string::npos);
}

TEST(LoadCallbackHost, IsCalledOnlyByARebuild)
{
    Outcome const outcome = run("load_callback");
    EXPECT_EQ(outcome.code, 0);
    EXPECT_EQ(outcome.out.find("calls at the start: 0\ncalls of the rebuild: "), 0U) << outcome.out;
    EXPECT_EQ(outcome.out.find("calls of the rebuild: 0\n"), std::string::npos); // at least root
}

TEST(MethodCallHost, ShowsWhyACallWasRefused)
{
    Outcome const outcome = run("method_call", {"Nonsense"});
    EXPECT_EQ(outcome.code, 1);
    // Error messages of the commands that build the tree may come first.
    std::string const reason = "refused with status 1\nUnknown method: Nonsense\n";
    EXPECT_NE(outcome.err.find(reason), std::string::npos) << outcome.err;
    EXPECT_NE(contentOf(DOCS_DIR "/writing-a-host.md").find("```\n" + reason + "```"),
              std::string::npos);
}

TEST(MethodCallHost, NeedsACall)
{
    EXPECT_EQ(run("method_call").code, 2);
}

TEST(ThreadsHost, ReadsEveryUser)
{
    Outcome const outcome = run("threads");
    EXPECT_EQ(outcome.code, 0);
    unsigned int named = 0;
    unsigned int of = 1;
    EXPECT_EQ(std::sscanf(outcome.out.c_str(), "users with a name: %u of %u", &named, &of), 2);
    EXPECT_EQ(named, of);
    EXPECT_GE(named, 1U); // root
}

} // namespace writing_a_host_test
