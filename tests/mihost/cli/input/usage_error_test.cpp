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

TEST(UsageError, NamesTheMissingValueOfAnOption)
{
    EXPECT_EQ(refusalOf({"-H"}), "--host: no value given (write --host [USER@]HOST)");
    EXPECT_EQ(refusalOf({"list", "log", "-n"}), "list: --lines: no value given (write --lines N)");
    EXPECT_EQ(refusalOf({"--color"}), "--color: no value given (write --color auto|always|never)");
    EXPECT_EQ(refusalOf({"list", "users", "--where"}),
              "list: --where: no value given (write --where COLUMN=VALUE|COLUMN~TEXT)");
}

TEST(UsageError, NamesAnOptionThatIsRepeated)
{
    EXPECT_EQ(refusalOf({"-o", "json", "-o", "yaml", "version"}),
              "version: --output-format: given more than once (see 'mihost version --help')");
    EXPECT_EQ(refusalOf({"--json", "-o", "yaml", "version"}),
              "version: --json and -o cannot be combined (see 'mihost version --help')");
}

TEST(UsageError, NamesAFlagWithAValue)
{
    EXPECT_EQ(refusalOf({"--sandbox=x", "tree"}),
              "tree: --sandbox takes no value (see 'mihost tree --help')");
    EXPECT_EQ(refusalOf({"user", "add", "jdoe", "--password=secret"}),
              "user add: --password takes no value (see 'mihost user add --help')");
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

TEST(UsageError, AsksForAnAccountOrATask)
{
    EXPECT_EQ(refusalOf({"user"}),
              "user: USER or a command is required (see 'mihost user --help')");
    EXPECT_EQ(refusalOf({"user", "jdoe", "lock"}),
              "user: unexpected argument 'lock' (see 'mihost user --help')");
}

TEST(UsageError, SuggestsWhatWasMeant)
{
    EXPECT_EQ(refusalOf({"doctr"}), "no command 'doctr' (did you mean doctor?)");
    EXPECT_EQ(refusalOf({"tree", "--jsno"}), "tree: no option '--jsno' (did you mean --json?)");
    EXPECT_EQ(refusalOf({"user", "set-shel", "jdoe"}),
              "user: no command 'set-shel' (did you mean set-shell?)");
}

} // namespace usage_error_test
