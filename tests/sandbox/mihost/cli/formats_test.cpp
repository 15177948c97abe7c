// Every output format, and the options that choose and order rows.

#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"
#include "tests/support/TerminalRun.h"

#include <cstdlib>
#include <filesystem>

namespace formats_test
{

class MihostFormats : public testing::Test
{
protected:
    MihostFormats()
    {
        setenv("LC_ALL", "C.UTF-8", 1);
        machine::lay("plain");
        machine::fake("/usr/sbin/lsmod", "echo 'Module Size'\necho 'ext4 1'\n");
        machine::fake("/usr/sbin/modinfo", "echo 'version: 1.0'\n");
        machine::write("/etc/passwd", "root:x:0:0:Super:/root:/bin/sh\n"
                                      "anna:x:1001:100:Anna, \"A\":/home/anna:/bin/bash\n"
                                      "ben:x:2000:100::/home/ben:/bin/bash\n");
        machine::write("/etc/shadow",
                       "root:*:19000:0:99999:7:::\nanna:!:19001:0:99999:7:::\n"
                       "ben:!:19002:0:99999:7:::\n",
                       0600);
        machine::write("/etc/group", "root:x:0:\nusers:x:100:anna\n");
    }
};

std::string outOf(Lines const& arguments)
{
    Outcome const outcome = mihostRun(arguments);
    EXPECT_EQ(outcome.code, 0) << arguments[0] << outcome.err;
    EXPECT_EQ(outcome.err, "") << arguments[0];
    return outcome.out;
}

TEST_F(MihostFormats, PrintsTablesWithoutAnyUtf8Locale)
{
    machine::write("/etc/passwd", "root:x:0:0:Bj\u00F6rn:/root:/bin/sh\n");
    std::filesystem::remove_all("/usr/lib/locale");
    setenv("LC_ALL", "C", 1);
    EXPECT_EQ(outOf({"list", "users", "--columns", "user-name,full-name", "--no-headers"}),
              "root  Bj?rn\n");
    EXPECT_TRUE(holds(outOf({"tree"}), "user:root"));
    EXPECT_EQ(outOf({"get", "user:root", "full-name", "-o", "value"}), "Bj\u00F6rn\n");
}

TEST_F(MihostFormats, PrintsABareValue)
{
    EXPECT_EQ(outOf({"get", "user:anna", "full-name", "-o", "value"}), "Anna, \"A\"\n");
    EXPECT_EQ(outOf({"-o", "value", "get", "user:ben", "user-id", "full-name"}), "2000\n\n");
    EXPECT_EQ(outOf({"get", "user:anna", "password", "-o", "value"}), "(hidden)\n");
}

TEST_F(MihostFormats, PrintsChosenRowsInOrderAsCsvAndAsValues)
{
    auto const shown = [](Lines const& format) {
        Lines words = {
            "list",   "users",    "--where",   "login-shell=/bin/bash",  "--where", "user-name~n",
            "--sort", "-user-id", "--columns", "user-name,311,full-name"};
        words.insert(words.end(), format.begin(), format.end());
        return outOf(words);
    };
    std::string const rows = "ben,100,\nanna,100,\"Anna, \"\"A\"\"\"\n";
    EXPECT_EQ(shown({"-o", "csv"}), "user-name,group-id,full-name\n" + rows);
    EXPECT_EQ(shown({"-o", "csv", "--no-headers"}), rows);
    EXPECT_EQ(shown({"-o", "value"}), "ben\t100\t\nanna\t100\tAnna, \"A\"\n");
    EXPECT_EQ(Json::parse(shown({"--json"}))[0]["properties"]["user-name"].dump(),
              R"({"id":108,"kind":"text","flag":true,"value":"ben"})");
}

TEST_F(MihostFormats, PrintsTheSameDocumentAsJsonLinesAndYaml)
{
    Json const list = Json::parse(outOf({"--json", "list", "users"}));
    Lines const lines = linesOf(outOf({"-o", "jsonl", "list", "users"}));
    ASSERT_EQ(lines.size(), list.size());
    for (std::size_t at = 0; at < lines.size(); ++at)
        EXPECT_EQ(Json::parse(lines[at]), list[at]);
    EXPECT_TRUE(startsWith(outOf({"get", "user:anna", "user-id", "-o", "yaml"}), "---\nid: "));
    EXPECT_TRUE(holds(outOf({"get", "user:anna", "full-name", "-o", "yaml"}),
                      "\n  full-name:\n    id: 312\n    kind: text\n    flag: true\n"
                      "    value: \"Anna, \\\"A\\\"\"\n"));
}

TEST_F(MihostFormats, AreAvailableForEveryCommandThatPrints)
{
    for (Lines const& command : {Lines{"tree"}, Lines{"list", "users"}, Lines{"get", "os"},
                                 Lines{"version"}, Lines{"properties"}, Lines{"properties", "user"},
                                 Lines{"methods"}, Lines{"methods", "UserAdd"}, Lines{"doctor"}})
        for (char const* format : {"table", "json", "jsonl", "yaml", "csv", "value"}) {
            Lines words = command;
            words.insert(words.end(), {"-o", format});
            Outcome const outcome = mihostRun(words);
            EXPECT_LE(outcome.code, 1) << command[0] << ' ' << format << outcome.err;
            EXPECT_NE(outcome.out, "") << command[0] << ' ' << format;
            EXPECT_EQ(outcome.err, "") << command[0] << ' ' << format;
        }
}

TEST_F(MihostFormats, RefusesRowFormatsOfAChangeBeforeItRuns)
{
    for (Lines const& command :
         {Lines{"call", "UserDel", "UserName=anna"}, Lines{"set", "user:anna", "full-name", "x"},
          Lines{"power", "halt", "-y"}, Lines{"refresh"}, Lines{"clear-log", "-y"}})
        for (char const* format : {"csv", "value"}) {
            Lines words = command;
            words.insert(words.end(), {"-o", format});
            EXPECT_EQ(mihostRun(words),
                      failed(2, command[0] + ": -o " + format +
                                    " is not supported (use table, json, jsonl or yaml)"));
        }
    EXPECT_EQ(machine::entry("/etc/passwd", "anna").at(0), "anna");
    EXPECT_EQ(mihostRun({"-o", "xml", "tree"}).code, 2);
    EXPECT_EQ(mihostRun({"-o", "csv", "--json", "tree"}).code, 2);
}

TEST_F(MihostFormats, ReportsChangesInEveryDocumentFormat)
{
    for (char const* format : {"json", "jsonl", "yaml"}) {
        Outcome const outcome = mihostRun(
            {"-o", format, "call", "UserSetScriptPath", "UserName=ben", "ScriptPath=/bin/sh"});
        EXPECT_EQ(outcome.code, 0) << outcome.err;
        EXPECT_TRUE(holds(outcome.out, "changed"));
        EXPECT_FALSE(holds(outcome.out, "ran  "));
    }
}

TEST_F(MihostFormats, IsQuietOnDemand)
{
    machine::write("/var/log/messages", "");
    EXPECT_EQ(mihostRun({"list", "log"}).err,
              "mihost: nothing to list under log (see 'mihost doctor')\n");
    for (char const* option : {"-q", "--json"})
        EXPECT_EQ(mihostRun({option, "list", "log"}).err, "") << option;
    EXPECT_EQ(linesOf(mihostRun({"-q", "get", "none"}).err).size(), 1U); // errors stay
    EXPECT_EQ(atTerminal({"-q", "get", "os", "os-name"}), printed("108 os-name  Linux\r\n"));
}

TEST_F(MihostFormats, ColoursWarningsAndErrorsAtATerminal)
{
    machine::write("/var/log/messages", "");
    EXPECT_TRUE(
        holds(atTerminal({"list", "log"}).out, "\x1b[33mmihost: nothing to list under log"));
    EXPECT_TRUE(holds(atTerminal({"get", "none"}).out, "\x1b[31mmihost: no node 'none'"));
}

} // namespace formats_test
