// Runs the examples of the help texts.

#include "TestPaths.h"
#include "mihost/cli/commands/CommandRows.h"
#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"

#include <algorithm>
#include <filesystem>

namespace examples_test
{

/** The first words of the lines below a heading of a help text, up to two blanks. */
Lines listedIn(std::string const& help, std::string const& heading)
{
    Lines listed;
    bool isBelow = false;
    for (std::string const& line : linesOf(help)) {
        isBelow = line == heading || (isBelow && line.rfind("  ", 0) == 0);
        if (isBelow && line != heading && line[2] != ' ') // not the rest of a text
            listed.push_back(line.substr(2, line.find("  ", 2) - 2));
    }
    return listed;
}

/** The help of the command and of all commands below it. */
std::vector<std::pair<Lines, std::string>> allHelp(Lines const& command)
{
    Lines words = {"help"};
    words.insert(words.end(), command.begin(), command.end());
    std::string const help = mihostRun(words).out;
    std::vector<std::pair<Lines, std::string>> all = {{command, help}};
    for (std::string const& name : listedIn(help, "Commands:")) {
        Lines below = command;
        below.push_back(name);
        for (auto const& each : allHelp(below))
            all.push_back(each);
    }
    return all;
}

/** A machine with the accounts, files and program that the examples name. */
void makeMachineOfTheExamples()
{
    machine::lay("plain");
    machine::writeIdRanges();
    machine::write("/etc/release", "Example Linux\nVERSION = 1\nPATCHLEVEL = 0\n");
    machine::write("/root/secret", "Secret-1\n", 0600);
    machine::write("/etc/shells", "/bin/sh\n/bin/bash\n");
    std::filesystem::create_directories("/var/lib/prometheus/node-exporter");
    machine::write("/var/log/messages", "Jan  2 03:04:05 host line\n");
    for (char const* line : {"groupadd staff", "groupadd crew", "useradd -m -U -G crew jdoe"})
        ASSERT_EQ(runToEnd({"/bin/sh", "-c", line}).code, 0) << line;
    std::filesystem::path const directory = std::filesystem::path(MIHOST_FILE).parent_path();
    setenv("LANG", "C.UTF-8", 1); // doctor misses it
    setenv("PATH", (directory.string() + ":" + getenv("PATH")).c_str(), 1);
}

/** Each runs in its own sandbox and answers yes; the input is for those that read a password. */
void runExamples(std::string const& help, std::string const& input)
{
    Lines const examples = listedIn(help, "Examples:");
    EXPECT_EQ(examples.size(), 2U) << help;
    for (std::string const& example : examples) {
        std::size_t const at = example.find("mihost ");
        ASSERT_NE(at, std::string::npos) << example;
        std::string line = example;
        line.insert(at + 7, "--sandbox --yes ");
        Outcome const outcome = runToEnd({"/bin/sh", "-c", line}, input);
        EXPECT_EQ(outcome.code, 0) << line << '\n' << outcome.out << outcome.err;
    }
}

class Examples : public testing::TestWithParam<mihost::CommandRow const*>
{
};

TEST(ExamplesOfTheProgram, Work)
{
    makeMachineOfTheExamples();
    runExamples(mihostRun({"--help"}).out, "");
}

TEST_P(Examples, OfEachCommandWork)
{
    makeMachineOfTheExamples();
    bool const isShell = GetParam() == &mihost::commandRows::shell;
    std::string const input = isShell ? "" : "Secret-1\n";
    for (auto const& [command, help] : allHelp({GetParam()->name}))
        runExamples(help, input);
}

INSTANTIATE_TEST_SUITE_P(All, Examples, testing::ValuesIn(mihost::commandTable()),
                         [](auto const& row) {
                             std::string name = row.param->name;
                             name.erase(std::remove(name.begin(), name.end(), '-'), name.end());
                             return name;
                         });

} // namespace examples_test
