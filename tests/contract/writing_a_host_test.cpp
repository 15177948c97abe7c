#include "tests/support/Lines.h"
#include "tests/support/Program.h"

#include <gtest/gtest.h>

namespace
{

TEST(MinimalHost, StandsInTheDocumentWordForWord)
{
    std::string const program = contentOf(DOCS_DIR "/examples/minimal_host.cpp");
    ASSERT_FALSE(program.empty());
    EXPECT_NE(contentOf(DOCS_DIR "/writing-a-host.md").find("```cpp\n" + program + "```"),
              std::string::npos);
}

TEST(MinimalHost, PrintsTheTreeFromTheTop)
{
    std::string const tree = runToEnd({MINIMAL_HOST, PLUGIN_FILE}).out;
    EXPECT_EQ(tree.find("1 OsSw Management Interface\n"
                        "  2 ROOT Node\n"
                        "    3 Computer\n"
                        "      4 Operating System\n"),
              0U)
        << tree;
}

} // namespace
