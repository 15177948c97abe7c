#include <gtest/gtest.h>

#include <array>
#include <cstdio>
#include <fstream>
#include <memory>
#include <sstream>

namespace
{

std::string contentOf(std::string const& path)
{
    std::ifstream const file(path);
    std::ostringstream text;
    text << file.rdbuf();
    return text.str();
}

struct ClosePipe {
    void operator()(FILE* pipe) const
    {
        pclose(pipe);
    }
};

std::string outputOf(std::string const& command)
{
    std::unique_ptr<FILE, ClosePipe> const pipe(popen(command.c_str(), "r"));
    std::array<char, 4096> piece{};
    std::string text;
    while (std::size_t const length = std::fread(piece.data(), 1, piece.size(), pipe.get()))
        text.append(piece.data(), length);
    return text;
}

TEST(MinimalHost, StandsInTheDocumentWordForWord)
{
    std::string const program = contentOf(DOCS_DIR "/examples/minimal_host.cpp");
    ASSERT_FALSE(program.empty());
    EXPECT_NE(contentOf(DOCS_DIR "/writing-a-host.md").find("```cpp\n" + program + "```"),
              std::string::npos);
}

TEST(MinimalHost, PrintsTheTreeFromTheTop)
{
    std::string const tree = outputOf(MINIMAL_HOST " " PLUGIN_FILE);
    EXPECT_EQ(tree.find("1 OsSw Management Interface\n"
                        "  2 ROOT Node\n"
                        "    3 Computer\n"
                        "      4 Operating System\n"),
              0U)
        << tree;
}

} // namespace
