// Completion in real shells: mihost receives what Tab inserts, and no other command runs.

#include "TestPaths.h"
#include "tests/support/Machine.h"
#include "tests/support/TerminalRun.h"

#include <filesystem>
#include <gtest/gtest.h>
#include <unistd.h>

namespace completion_shells_test
{

namespace fs = std::filesystem;

std::string const scripts = std::string(TESTS_DIR) + "/../packaging/completions/";

struct Shell {
    char const* name;
    char const* program;
    std::vector<std::string> arguments;
    std::string start; // typed first; the prompt's text is written so that its echo does not match
};

std::vector<Shell> const shells = {
    {"bash",
     "/bin/bash",
     {"--norc", "--noprofile", "-i"},
     ". " + scripts + "mihost.bash; PS1='re''ady> '\n"},
    {"zsh",
     "/usr/bin/zsh",
     {"-f", "-i"},
     "fpath=(" + scripts + " $fpath); autoload -Uz compinit; compinit -uD; PS1='re''ady> '\n"},
    {"fish",
     "/usr/bin/fish",
     {"--no-config", "-i"},
     "source " + scripts + "mihost.fish; function fish_prompt; printf 're''ady> '; end\n"},
};

/** Names of accounts that a shell would interpret if they were inserted unquoted. */
constexpr char const* hostile[] = {
    "ev`id>x`", "bl ank", "se;id>x", "do$(id>x)", "qu'o\"te", "ba\\ck",  "am&id>x",
    "st*r",     "ti~l",   "ex!cl",   "ha#sh",     "co[m]",    "br{a,b}", "pl+a@i=n",
};

class ShellCompletion : public testing::TestWithParam<Shell>
{
protected:
    ShellCompletion()
    {
        machine::lay("plain");
        std::string accounts = machine::read("/etc/passwd");
        for (char const* name : hostile)
            accounts += std::string(name) + ":x:1500:1500::/:/bin/sh\n";
        for (char const* name : {"tab\tx", "esc\x1B[2Jx", "high\xFFx"})
            accounts += std::string(name) + ":x:1501:1501::/:/bin/sh\n";
        machine::write("/etc/passwd", accounts);
        // Completes as usual, otherwise records its input.
        machine::fake("/usr/local/bin/mihost", std::string("case $1 in\n__complete*) exec ") +
                                                   MIHOST_FILE +
                                                   " \"$@\" ;;\n"
                                                   "esac\n"
                                                   "printf '%s\\n' \"$@\" >>/tmp/got\n"
                                                   "echo ran-mihost\n");
        fs::create_directories("/tmp/here");
        fs::create_directories("/tmp/home");
        fs::current_path("/tmp/here");
        setenv("HOME", "/tmp/home", 1);
        setenv("LC_ALL", "C.UTF-8", 1);
    }

    /** What mihost got when the line was typed, one word a line. */
    std::string got(std::string const& typed)
    {
        machine::write("/tmp/got", "", 0666);
        terminal_.type(typed);
        terminal_.waitFor("ran-mihost");
        return machine::read("/tmp/got");
    }

    void start()
    {
        terminal_.type(GetParam().start);
        terminal_.waitFor("ready> ");
    }

    static bool ranNothing()
    {
        return fs::is_empty("/tmp/here");
    }

private:
    TerminalRun terminal_{GetParam().arguments, 200, GetParam().program};
};

TEST_P(ShellCompletion, InsertsNamesSoThatTheShellReadsThemBack)
{
    start();
    for (std::string const name : hostile) {
        EXPECT_EQ(got("mihost get user:" + name.substr(0, 2) + "\t\n"), "get\nuser:" + name + "\n");
        EXPECT_EQ(got("mihost call UserDel UserName=" + name.substr(0, 2) + "\t\n"),
                  "call\nUserDel\nUserName=" + name + "\n");
        EXPECT_TRUE(ranNothing()) << name;
    }
}

TEST_P(ShellCompletion, InsertsNamesIntoOpenQuotes)
{
    start();
    for (std::string const name : hostile)
        for (char const quote : {'\'', '"'}) {
            EXPECT_EQ(
                got(std::string("mihost get ") + quote + "user:" + name.substr(0, 2) + "\t\n"),
                "get\nuser:" + name + "\n")
                << quote;
            EXPECT_TRUE(ranNothing()) << name;
        }
}

TEST_P(ShellCompletion, ContinuesAfterAQuotedCharacter)
{
    start();
    EXPECT_EQ(got("mihost get user:ev\\`id\\>\t\n"), "get\nuser:ev`id>x`\n");
    EXPECT_TRUE(ranNothing());
}

TEST_P(ShellCompletion, OffersNoNameThatIsNotPlainText)
{
    start();
    for (char const* start : {"tab", "esc", "high"})
        EXPECT_EQ(got(std::string("mihost get user:") + start + "\t\x15mihost none\n"), "none\n");
    EXPECT_TRUE(ranNothing());
}

INSTANTIATE_TEST_SUITE_P(Shells, ShellCompletion, testing::ValuesIn(shells),
                         [](auto const& which) { return which.param.name; });

} // namespace completion_shells_test
