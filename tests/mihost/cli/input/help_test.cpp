// The help texts of all commands.

#include "mihost/cli/input/Help.h"

#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/input/CommandLine.h"
#include "tests/support/Lines.h"

#include <CLI/App.hpp>
#include <algorithm>
#include <gtest/gtest.h>

namespace help_test
{

using mihost::CommandLine;

class HelpTexts : public testing::Test
{
protected:
    HelpTexts() : app("", "mihost"), line(mihost::commandTable())
    {
        line.declare(app);
        add(app);
    }

    std::string helpOn(std::vector<std::string> const& words)
    {
        return mihost::helpOn(app, words);
    }

    CLI::App app;
    CommandLine line;
    std::vector<CLI::App const*> all; // the program and every command

private:
    void add(CLI::App& command)
    {
        all.push_back(&command);
        for (CLI::App* below : command.get_subcommands({}))
            add(*below);
    }
};

TEST_F(HelpTexts, NameTheValueOfEachOption)
{
    Lines const meaningless = {"", "TEXT", "INT", "UINT", "FLOAT", "BOOLEAN"};
    std::size_t found = 0;
    for (CLI::App const* command : all)
        for (CLI::Option const* option : command->get_options())
            if (option->nonpositional() && option->get_items_expected_max() > 0) {
                ++found;
                EXPECT_EQ(
                    std::count(meaningless.begin(), meaningless.end(), option->get_type_name()), 0)
                    << command->get_name() << ' ' << option->get_name() << ' '
                    << option->get_type_name();
            }
    EXPECT_GT(found, 25U);
}

TEST_F(HelpTexts, EndWithTwoExamples)
{
    EXPECT_GT(all.size(), 25U);
    for (CLI::App const* command : all) {
        Lines const lines = linesOf(command->help());
        auto const heading = std::find(lines.begin(), lines.end(), "Examples:");
        EXPECT_EQ(lines.end() - heading, 3) << command->help();
    }
}

TEST_F(HelpTexts, ShowBothUsesOfACommandWithTasks)
{
    EXPECT_NE(helpOn({"user"}).find("Usage: mihost user [OPTIONS] USER\n"
                                    "       mihost user [OPTIONS] COMMAND ...\n"),
              std::string::npos)
        << helpOn({"user"});
    EXPECT_NE(helpOn({"get"}).find("Usage: mihost get [OPTIONS] NODE [PROPERTY...]\n"),
              std::string::npos)
        << helpOn({"get"});
    CLI::App inShell;
    CommandLine shell(mihost::commandTable(), CommandLine::Place::Shell);
    shell.declare(inShell);
    std::string const help = mihost::helpOn(inShell, {"group"});
    EXPECT_NE(help.find("Usage: group [OPTIONS] GROUP\n"
                        "       group [OPTIONS] COMMAND ...\n"),
              std::string::npos)
        << help;
}

} // namespace help_test
