// The commands in the README print what it shows.

#include "TestPaths.h"
#include "tests/contract/mihost/cli/NeedsSandbox.h"
#include "tests/support/Lines.h"
#include "tests/support/Program.h"

namespace readme_test
{

struct Step {
    std::string command;
    Lines output; // a line of dots matches any lines
};

std::vector<Step> readSession()
{
    std::vector<Step> steps;
    bool inSession = false;
    for (std::string const& line : linesOf(contentOf(DOCS_DIR "/../README.md")))
        if (line.rfind("```", 0) == 0)
            inSession = line == "```console";
        else if (inSession && line.rfind("$ ", 0) == 0)
            steps.push_back({line.substr(2), {}});
        else if (inSession)
            steps.back().output.push_back(line);
    return steps;
}

/** Whether the lines are those shown, some of them left out. */
bool matches(Lines const& lines, std::size_t line, Lines const& shown, std::size_t at)
{
    if (at == shown.size())
        return line == lines.size();
    if (shown[at] == "...") {
        for (std::size_t rest = line; rest <= lines.size(); ++rest)
            if (matches(lines, rest, shown, at + 1))
                return true;
        return false;
    }
    return line < lines.size() && lines[line] == shown[at] &&
           matches(lines, line + 1, shown, at + 1);
}

using ReadmeSession = NeedsSandbox;

TEST_F(ReadmeSession, IsWhatTheProgramPrints)
{
    std::vector<Step> const steps = readSession();
    ASSERT_GT(steps.size(), 5U);
    std::string before =
        std::string("cd ") + DOCS_DIR + "/..\nshopt -s expand_aliases\nexec 2>&1\n";
    for (Step const& step : steps) {
        std::string command = step.command;
        std::string const program = "build/bin/mihost";
        if (std::size_t const at = command.find(program); at != std::string::npos)
            command.replace(at, program.size(), MIHOST_FILE);
        if (command.rfind("alias ", 0) == 0) {
            before += command + '\n';
            continue;
        }
        std::string const said =
            runToEnd({"/usr/bin/env", "LC_ALL=C.UTF-8", "/bin/bash", "-c", before + command}).out;
        EXPECT_TRUE(matches(linesOf(said), 0, step.output, 0)) << step.command << '\n' << said;
    }
}

} // namespace readme_test
