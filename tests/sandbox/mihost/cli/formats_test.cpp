// Every output format, and the options that choose and order rows.

#include "tests/support/Holds.h"
#include "tests/support/Lines.h"
#include "tests/support/Machine.h"
#include "tests/support/Program.h"
#include "tests/support/TerminalRun.h"

#include <cstdlib>
#include <filesystem>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

namespace formats_test
{

using Json = nlohmann::ordered_json;

class MihostFormats : public testing::Test
{
protected:
    MihostFormats()
    {
        setenv("LC_ALL", "C.UTF-8", 1);
        setenv("TERM", "xterm", 1);
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

TEST_F(MihostFormats, PrintsRowsAsCsvAndAsValues)
{
    Lines const list = {"list", "users", "--columns", "user-name,311,full-name"};
    Lines words = list;
    words.insert(words.end(), {"-o", "csv"});
    EXPECT_EQ(outOf(words), "user-name,group-id,full-name\n"
                            "root,0,Super\n"
                            "anna,100,\"Anna, \"\"A\"\"\"\n"
                            "ben,100,\n");
    words.push_back("--no-headers");
    EXPECT_EQ(outOf(words).substr(0, 5), "root,");
    words = list;
    words.insert(words.end(), {"-o", "value"});
    EXPECT_EQ(outOf(words), "root\t0\tSuper\nanna\t100\tAnna, \"A\"\nben\t100\t\n");
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

TEST_F(MihostFormats, ChoosesAndOrdersRows)
{
    EXPECT_EQ(outOf({"list", "users", "--where", "login-shell=/bin/bash", "--sort", "-user-id",
                     "--columns", "user-name", "--no-headers"}),
              "ben\nanna\n");
    EXPECT_EQ(outOf({"list", "users", "--where", "group-id=100", "--where", "user-name~n",
                     "--where", "full-name=", "-o", "value"}),
              "ben\t2000\t100\t/home/ben\t/bin/bash\t\n");
    Json const list =
        Json::parse(outOf({"--json", "list", "users", "--sort=-311", "--columns", "user-name"}));
    ASSERT_EQ(list.size(), 3U);
    EXPECT_EQ(list[0]["properties"].dump(),
              R"({"user-name":{"id":108,"kind":"text","flag":true,"value":"anna"}})");
}

TEST_F(MihostFormats, RefusesMalformedConditionsAndUnknownColumns)
{
    EXPECT_EQ(mihostRun({"list", "users", "--where", "user-name"}).code, 2);
    EXPECT_EQ(mihostRun({"list", "users", "--where", "none=1"}).code, 4);
    EXPECT_EQ(mihostRun({"list", "users", "--sort", "user-nam"}).err,
              "mihost: no column 'user-nam' (did you mean user-name?)\n");
}

TEST_F(MihostFormats, MarksEmptyCells)
{
    EXPECT_EQ(
        outOf({"list", "users", "--where", "user-name=ben", "--columns", "full-name,user-name"}),
        "full-name  user-name\n-          ben\n");
    EXPECT_EQ(outOf({"get", "user:ben", "full-name"}), "312 full-name  -\n");
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
    EXPECT_EQ(mihostRun({"-q", "list", "log"}).err, "");
    EXPECT_EQ(linesOf(mihostRun({"-q", "get", "none"}).err).size(), 1U); // errors stay
    TerminalRun run({"-q", "get", "os", "os-name"});
    EXPECT_EQ(run.end(), 0);
    EXPECT_EQ(run.output(), "108 os-name  Linux\r\n");
}

TEST_F(MihostFormats, ColoursWarningsAndErrorsAtATerminal)
{
    machine::write("/var/log/messages", "");
    TerminalRun warned({"list", "log"});
    warned.end();
    EXPECT_TRUE(holds(warned.output(), "\x1b[33mmihost: nothing to list under log"));
    TerminalRun failed({"get", "none"});
    EXPECT_EQ(failed.end(), 4);
    EXPECT_TRUE(holds(failed.output(), "\x1b[31mmihost: no node 'none'"));
}

TEST_F(MihostFormats, PrintsRecordsOnANarrowTerminal)
{
    TerminalRun run({"--color=never", "-q", "list", "users", "--where", "user-name=anna"}, 40);
    EXPECT_EQ(run.end(), 0);
    EXPECT_EQ(run.output(), "user-name       anna\r\n"
                            "user-id         1001\r\n"
                            "group-id        100\r\n"
                            "home-directory  /home/anna\r\n"
                            "login-shell     /bin/bash\r\n"
                            "full-name       Anna, \"A\"\r\n");
}

} // namespace formats_test
