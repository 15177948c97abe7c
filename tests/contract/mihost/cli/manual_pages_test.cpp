#include "TestPaths.h"
#include "tests/support/Mihost.h"

#include <regex>
#include <set>

namespace manual_pages_test
{

Outcome shell(std::string const& line)
{
    return runToEnd({"/bin/sh", "-c", line});
}

std::string rendered(std::string const& page)
{
    return shell("MANWIDTH=500 man -E ascii --local-file '" + page + "' | col -bx").out;
}

std::set<std::string> matches(std::string const& text, char const* pattern)
{
    std::regex const expression(pattern);
    std::set<std::string> found;
    for (auto at = std::sregex_iterator(text.begin(), text.end(), expression);
         at != std::sregex_iterator(); ++at)
        found.insert((*at)[1]);
    return found;
}

/** The commands that a help text lists. */
std::set<std::string> commandsOf(std::string const& help)
{
    std::string const list = help.substr(help.find("\nCommands:"));
    return matches(list.substr(0, list.find("\nExamples:")), "\n  ([a-z-]+) ");
}

class ManualPage : public testing::TestWithParam<char const*>
{
};

TEST_P(ManualPage, IsRenderedWithoutWarnings)
{
    std::string const page = GetParam();
    Outcome const man =
        shell("man --warnings -E UTF-8 -Tutf8 -Z --local-file '" + page + "' >/dev/null");
    EXPECT_EQ(man.code, 0);
    EXPECT_EQ(man.err, "");
}

TEST_P(ManualPage, PassesMandocsLint)
{
    for (std::string const& note :
         linesOf(shell("mandoc -T lint '" + std::string(GetParam()) + "'").out))
        if (note.find("referenced manual not found") == std::string::npos)
            ADD_FAILURE() << note;
}

char const* const pageNames[] = {"Mihost", "Plugin", "HostCheck", "Ansible", "Exporter", "Cockpit"};

INSTANTIATE_TEST_SUITE_P(All, ManualPage,
                         testing::Values(MIHOST_PAGE, PLUGIN_PAGE, HOSTCHECK_PAGE, ANSIBLE_PAGE,
                                         EXPORTER_PAGE, COCKPIT_PAGE),
                         [](auto const& which) { return std::string(pageNames[which.index]); });

TEST(ManualPageOfMihost, DescribesEveryOption)
{
    char const* const option = "(--[a-z][a-z-]*)";
    auto const described = matches(rendered(MIHOST_PAGE), option);
    std::string help = mihostRun({"--help-all"}).out;
    for (char const* const group : {"user", "group"})
        for (std::string const& task : commandsOf(mihostRun({"help", group}).out))
            help += mihostRun({"help", group, task}).out;
    auto const options = matches(help, option);
    EXPECT_FALSE(options.empty());
    for (std::string const& name : options)
        EXPECT_EQ(described.count(name), 1U) << name;
}

TEST(ManualPageOfMihost, DescribesEveryCommand)
{
    std::string const help = mihostRun({"--help"}).out;
    std::string const page = rendered(MIHOST_PAGE);
    auto commands = commandsOf(help);
    EXPECT_FALSE(commands.empty());
    for (char const* const group : {"user", "group"})
        for (std::string const& task : commandsOf(mihostRun({"help", group}).out))
            commands.insert(group + (" " + task));
    EXPECT_EQ(commands.count("user set-shell"), 1U);
    for (std::string const& command : commands)
        EXPECT_TRUE(std::regex_search(page, std::regex("\n {5,7}" + command + "[ \n]"))) << command;
}

// To update the page: cmake --build --preset dev --target manual_pages
TEST(ManualPageOfThePlugin, IsMadeOfItsTemplateAndTheCatalogue)
{
    Outcome const filled = runToEnd({FILL_PAGE_FILE, PLUGIN_PAGE ".in"});
    EXPECT_EQ(filled.code, 0) << filled.err;
    EXPECT_EQ(filled.out, contentOf(PLUGIN_PAGE));
}

TEST(ManualPageOfThePlugin, HasTheListsOfTheCatalogue)
{
    std::string const page = rendered(PLUGIN_PAGE);
    for (char const* line :
         {"   os (type 17)\n", "     149 physical-memory-free\n", "(number, KiB, live) free RAM\n",
          "     LocalGroupAddUser\n", "             UserName CMPI_string\n"})
        EXPECT_TRUE(holds(page, line));
}

} // namespace manual_pages_test
