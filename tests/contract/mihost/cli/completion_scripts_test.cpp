#include "TestPaths.h"
#include "tests/support/Program.h"

#include <gtest/gtest.h>

namespace completion_scripts_test
{

/** The options that bash's completion of a line sets, and the words in COMPREPLY. */
std::string inBash(std::string const& line)
{
    std::string const mihost = MIHOST_FILE;
    Outcome const outcome =
        runToEnd({"/bin/bash", "-uc", R"(
        PATH=$2:$PATH
        compopt() { echo "$@"; }
        . "$1/mihost.bash"
        COMP_LINE=$3 COMP_POINT=${4:-${#3}}
        _mihost mihost "${3##* }"
        printf '%s\n' "${COMPREPLY[@]}")",
                  "bash", COMPLETIONS_DIR, mihost.substr(0, mihost.rfind('/')), line});
    EXPECT_EQ(outcome.err, "");
    return outcome.out;
}

TEST(BashCompletion, OffersWordsAndNothingForAnUnknownCommand)
{
    EXPECT_EQ(inBash("mihost power "), "restart\nhalt\n");
    EXPECT_EQ(inBash("mihost power re"), "restart\n");
    EXPECT_EQ(inBash("mihost nonsense "), "\n");
}

TEST(BashCompletion, AddsWhatTheLineLacks)
{
    EXPECT_EQ(inBash("mihost get us"), "-o nospace\nuser:\n");
    EXPECT_EQ(inBash("mihost call UserDel U"), "-o nospace\nUserName=\n");
    EXPECT_EQ(inBash("mihost get user:roo"), "root\n");
    EXPECT_EQ(inBash("mihost call UserDel UserName=roo"), "root\n");
}

TEST(BashCompletion, OffersFilesAndFolders)
{
    EXPECT_EQ(inBash("mihost --trace /etc/login.d"), "-o filenames\n/etc/login.defs\n");
    EXPECT_EQ(inBash("mihost --overlay /etc/pam"), "-o filenames\n/etc/pam.d\n");
}

} // namespace completion_scripts_test
