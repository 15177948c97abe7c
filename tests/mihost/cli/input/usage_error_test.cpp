// What is said about a command line that cannot be parsed.

#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/input/CommandLine.h"
#include "tests/mihost/cli/Refusal.h"

#include <gtest/gtest.h>

namespace usage_error_test
{

using Words = std::vector<std::string>;

std::string refusalOf(Words const& words)
{
    return refusal([&words] { mihost::CommandLine(mihost::commandTable()).parse(words); });
}

TEST(UsageError, SaysWhatIsWrongAndWhatToWrite)
{
    struct Row {
        Words words;
        char const* message;
    };
    for (Row const& row : std::initializer_list<Row>{
             // an option without its value, a repeated one, and a flag with a value
             {{"-H"}, "--host: no value given (write --host [USER@]HOST)"},
             {{"list", "log", "-n"}, "list: --lines: no value given (write --lines N)"},
             {{"--color"}, "--color: no value given (write --color auto|always|never)"},
             {{"list", "users", "--where"},
              "list: --where: no value given (write --where COLUMN=VALUE|COLUMN~TEXT)"},
             {{"-o", "json", "-o", "yaml", "version"},
              "version: --output-format: given more than once (see 'mihost version --help')"},
             {{"--json", "-o", "yaml", "version"},
              "version: --json and -o cannot be combined (see 'mihost version --help')"},
             {{"--sandbox=x", "tree"}, "tree: --sandbox takes no value (see 'mihost tree --help')"},
             {{"user", "add", "jdoe", "--password=secret"},
              "user add: --password takes no value (see 'mihost user add --help')"},
             // arguments
             {{"get"}, "get: NODE is required (see 'mihost get --help')"},
             {{"set", "os"}, "set: PROPERTY is required (see 'mihost set --help')"},
             {{"user"}, "user: USER or a command is required (see 'mihost user --help')"},
             {{"user", "set-shell", "jdoe"},
              "user set-shell: SHELL is required (see 'mihost user set-shell --help')"},
             {{"tree", "os", "extra"},
              "tree: unexpected argument 'extra' (see 'mihost tree --help')"},
             {{"user", "jdoe", "lock"},
              "user: unexpected argument 'lock' (see 'mihost user --help')"},
             {{"user", "jdoe", "delete", "jdoe"},
              "user delete: unexpected argument 'jdoe' (see 'mihost user delete --help')"},
             {{"user", "delete", "jdoe", "staff"},
              "user delete: unexpected argument 'staff' (see 'mihost user delete --help')"},
             {{"watch", "os", "108", "--interval", "nan"},
              "watch: --interval: 'nan' is not a number from 0 to 86400 (see 'mihost watch "
              "--help')"},
             // unknown names
             {{"doctr"}, "no command 'doctr' (did you mean doctor?)"},
             {{"user", "set-shel", "jdoe"},
              "user: no command 'set-shel' (did you mean set-shell?)"},
             {{"--timng", "tree"}, "tree: no option '--timng' (did you mean --timing?)"},
             {{"list", "users", "--colums=id"},
              "list: no option '--colums=id' (did you mean --columns?)"},
             {{"user", "add", "asmith", "--shel", "/bin/sh"},
              "user add: no option '--shel' (did you mean --shell?)"},
             {{"tree", "--nothing"}, "tree: no option '--nothing' (see 'mihost tree --help')"},
             {{"--nothing"}, "no option '--nothing' (see 'mihost --help')"},
             {{"power", "hatl"}, "power: ACTION: unknown value 'hatl' (did you mean halt?)"}})
        EXPECT_EQ(refusalOf(row.words), row.message);
    EXPECT_EQ(refusalOf({"nonsense"}).rfind("no command 'nonsense' (use tree, list, ", 0), 0U);
}

TEST(UsageError, SaysWhichNumbersAnOptionTakes)
{
    for (char const* text : {"x", "1.5", "-1", "010", "70000000000", "0x1f", ""})
        EXPECT_EQ(refusalOf({"list", "log", "--lines", text}),
                  "list: --lines: '" + std::string(text) +
                      "' is not a whole number from 0 to 1000000000 (see 'mihost list --help')");
    EXPECT_EQ(refusalOf({"check", "--rounds", "0"}),
              "check: --rounds: '0' is not a whole number from 1 to 1000 (see 'mihost check "
              "--help')");
    EXPECT_EQ(refusalOf({"--lock-timeout", "0.5", "refresh"}),
              "refresh: --lock-timeout: '0.5' is not a whole number from 0 to 86400 (see 'mihost "
              "refresh --help')");
}

} // namespace usage_error_test
