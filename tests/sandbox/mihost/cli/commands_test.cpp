// The program itself, run on fixture machines as a person or a script runs it.

#include "TestPaths.h"
#include "mihost/cli/input/Day.h"
#include "mihost/sandbox/Sandbox.h"
#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"

#include <ctime>
#include <filesystem>

namespace commands_test
{

TEST(MihostTree, HasALineForEachNodeBelowItsParent)
{
    setenv("LC_ALL", "C.UTF-8", 1);
    machine::lay("small");
    EXPECT_EQ(mihostRun({"tree"}).out,
              "mi #1                   OsSw Management Interface\n"
              "└─root #2               ROOT Node\n"
              "  └─computer #3         Computer: " +
                  mihostRun({"get", "computer", "108", "-o", "value"}).out +
                  "    └─os #4             Operating System: Linux\n"
                  "      ├─driver:ext4 #5  Driver of ext4: 1.0\n"
                  "      ├─driver:xfs #6   Driver of xfs: 1.0\n"
                  "      ├─user:root #7    User Account: Super\n"
                  "      ├─user:jdoe #8    User Account: J. Doe\n"
                  "      ├─group:root #9   Group: root\n"
                  "      ├─group:jdoe #10  Group: jdoe\n"
                  "      └─log #11         OS Log\n"
                  "        ├─log:1 #12     OS LogEntry: *second*\n"
                  "        └─log:2 #13     OS LogEntry: *first line*\n");
    EXPECT_EQ(mihostRun({}), mihostRun({"tree"}));
}

TEST(MihostTree, CanBeginAtAnyNodeAndShowProperties)
{
    machine::lay("small");
    EXPECT_EQ(mihostRun({"tree", "--all", "driver:xfs"}).out,
              "driver:xfs #6  Driver of xfs: 1.0\n"
              "                36 manufacturer    -\n"
              "                70 build-number    -\n"
              "               108 driver-name     xfs\n"
              "               134 driver-version  1.0\n");
}

TEST(MihostTree, AsJsonIsAnArrayInTheOrderOfTheNodeList)
{
    machine::lay("small");
    Json const tree = mihostJson({"tree"});
    Lines kinds;
    for (Json const& node : tree) {
        EXPECT_EQ(node["id"], kinds.size() + 1);
        kinds.push_back(node["kind"]);
    }
    EXPECT_EQ(kinds, (Lines{"mi", "root", "computer", "os", "driver", "driver", "user", "user",
                            "group", "group", "log", "log-entry", "log-entry"}));
    EXPECT_EQ(tree[3]["properties"]["clear-log"].dump(), // not stored, but read
              R"({"id":191,"kind":"number","flag":true,"value":0})");
    EXPECT_EQ(tree[3]["properties"]["requested-state"]["flag"], false);
}

TEST(MihostTree, HasThePropertiesAndKindsThatTheCatalogueNames)
{
    machine::lay("small");
    Json const catalogue = mihostJson({"properties"});
    for (Json const& node : mihostJson({"tree"}))
        for (auto const& [name, property] : node["properties"].items()) {
            std::string expected;
            for (Json const& kind : catalogue)
                for (Json const& row : kind["properties"])
                    if (kind["kind"] == node["kind"] && row["id"] == property["id"] &&
                        row["name"] == name)
                        expected = row["kind"];
            EXPECT_EQ(property["kind"], expected) << node["kind"] << " " << name;
        }
}

TEST(MihostGet, ReadsLivePropertiesLive)
{
    machine::lay("small");
    EXPECT_EQ(mihostRun({"get", "log:1", "message"}), printed(" 81 message  *second*\n"));
    EXPECT_EQ(mihostRun({"get", "os", "191"}), printed("191 clear-log  0\n"));
    EXPECT_EQ(mihostRun({"--json", "get", "os", "108"}), mihostRun({"get", "--json", "os", "108"}));
    Json const entry = mihostJson({"get", "log:2", "index", "81"});
    EXPECT_EQ(entry["kind"], "log-entry");
    EXPECT_EQ(entry["index"], 2);
    EXPECT_EQ(entry["properties"].dump(),
              R"({"index":{"id":89,"kind":"number","flag":true,"value":2},)"
              R"("message":{"id":81,"kind":"text","flag":true,"value":"*first line*"}})");
}

TEST(MihostGet, ExitsWith4ForAnUnknownNodeOrProperty)
{
    machine::lay("small");
    for (Lines const& arguments :
         {Lines{"get", "driver:none"}, Lines{"get", "os", "999"}, Lines{"tree", "user:none"},
          Lines{"set", "os", "none", "1"}, Lines{"list", "log", "--columns", "none"}}) {
        Outcome const outcome = mihostRun(arguments);
        EXPECT_EQ(outcome.code, 4) << arguments[1];
        EXPECT_EQ(outcome.out, "");
        EXPECT_EQ(linesOf(outcome.err).size(), 1U) << outcome.err;
    }
}

TEST(MihostGet, ReportsANodeWithoutPropertiesAndAnUnsetOne)
{
    machine::lay("plain"); // no release file there, so no version is stored
    EXPECT_EQ(mihostRun({"get", "root"}), failed(0, "node 'root' has no properties"));
    EXPECT_EQ(mihostRun({"get", "os", "os-version"}),
              failed(1,
                     "property 'os-version' of node 'os': status 1: property 134 is not set (see "
                     "'mihost doctor')"));
}

TEST(MihostList, IsATableOfTheRequestedColumns)
{
    machine::lay("small");
    EXPECT_EQ(mihostRun({"list", "drivers"}).out, "driver-name  driver-version  description\n"
                                                  "ext4         1.0             Driver of ext4\n"
                                                  "xfs          1.0             Driver of xfs\n");
    EXPECT_EQ(mihostRun({"list", "log", "--columns", "index,81"}).out, "index  message\n"
                                                                       "1      second\n"
                                                                       "2      first line\n");
    Json const list = mihostJson({"list", "log", "--columns", "message"});
    ASSERT_EQ(list.size(), 2U);
    EXPECT_EQ(list[0]["properties"].size(), 1U);
    EXPECT_EQ(list[0]["properties"]["message"]["value"], "*second*");
    EXPECT_EQ(mihostRun({"list", "things"}).code, 2);
}

TEST(MihostTrace, IsJsonLinesInCallOrderWithBothLoggerOperations)
{
    machine::lay("small");
    EXPECT_EQ(mihostRun({"--trace", "/tmp/trace", "version"}).code, 0);
    EXPECT_EQ(machine::read("/tmp/trace"), ""); // nothing was started

    EXPECT_EQ(mihostRun({"--trace", "/tmp/trace", "tree"}).code, 0);
    Lines const lines = linesOf(machine::read("/tmp/trace"));
    EXPECT_EQ(mihostRun({"--trace", "-", "tree"}).err.substr(0, lines.at(0).size()), lines[0]);
    ASSERT_GT(lines.size(), 2U);
    for (std::string const& line : lines)
        EXPECT_TRUE(Json::accept(line)) << line;
    for (std::size_t const at : {0U, 1U}) {
        Json record = Json::parse(lines[at]);
        EXPECT_TRUE(record["line"].is_number());
        record.erase("line");
        EXPECT_EQ(record.dump(), std::string(at == 0 ? R"({"op":"log")" : R"({"op":"trace")") +
                                     R"(,"function":"initialize","file":"OsSwMI",)"
                                     R"("category":"Veltrix.IC.MI.OsSwMI","level":3000,)"
                                     R"("message":"initialize: entry"})");
    }
}

TEST(MihostTiming, ShowsPhasesAndCommandsOfTheStart)
{
    machine::lay("small");
    Outcome const outcome = mihostRun({"--timing", "--json", "get", "os", "108"});
    Json const timing = Json::parse(outcome.err)["timing"];
    std::map<std::string, int> commands;
    for (Json const& row : timing) {
        commands[row["phase"]] = row["commands"];
        EXPECT_GE(row["seconds"], 0);
    }
    EXPECT_EQ(commands["load"], 0);
    EXPECT_EQ(commands["drivers"], 3); // lsmod, and modinfo for each of two modules
    EXPECT_EQ(timing.size(), 10U);
    Outcome const text = mihostRun({"--timing", "--no-accel", "get", "os", "108"});
    EXPECT_EQ(linesOf(text.err).size(), 11U) << text.err; // and the total
}

TEST(MihostWatch, PrintsTheFirstReadingAndThenOnlyWhatChanged)
{
    machine::lay("small");
    long const before = std::time(nullptr);
    std::string const line =
        mihostRun({"watch", "os", "os-name", "--interval", "0", "--count", "3"}).out;
    EXPECT_EQ(line.substr(19), "  108 os-name  Linux\n");
    auto const time = mihost::parseTime(line.substr(0, 19));
    ASSERT_TRUE(time) << line;
    EXPECT_GE(*time, before);
    EXPECT_LE(*time, std::time(nullptr));
    // The log grows whenever it is counted.
    machine::fake("/usr/bin/wc", "n=$(sed -n '$=' /var/log/messages)\n"
                                 "echo \"Jan  2 03:04:05 line $((n + 1))\" >>/var/log/messages\n"
                                 "echo \"$((n + 1)) /var/log/messages\"\n");
    Lines const lines = linesOf(mihostRun({"--json", "watch", "log:1", "message", "index",
                                           "--interval", "0", "--count", "2"})
                                    .out);
    ASSERT_EQ(lines.size(), 2U);
    EXPECT_GE(Json::parse(lines[0])["time"], before);
    Json const first = Json::parse(lines[0])["properties"];
    Json const second = Json::parse(lines[1])["properties"];
    EXPECT_EQ(first.size(), 2U);
    EXPECT_EQ(second.size(), 1U);
    EXPECT_NE(first["message"]["value"], second["message"]["value"]);
}

TEST(MihostVersion, NamesProgramContractAndPluginFile)
{
    Json const version = mihostJson({"version"});
    EXPECT_EQ(version["contract"], "1");
    EXPECT_EQ(version["soname"], "libzorvvxicosswmi.so.1");
    EXPECT_TRUE(std::filesystem::equivalent(version["plugin"].get<std::string>(), PLUGIN_FILE));
    EXPECT_EQ(mihostRun({"--version"}).out,
              "mihost " + version["mihost"].get<std::string>() + "\n");
}

TEST(MihostUsage, IsRefusedWithACorrectionOrTheHelp)
{
    std::vector<std::pair<Lines, std::string>> const refusals = {
        {{"tre", "os"}, "no command 'tre' (did you mean tree?)"},
        {{"power", "sleep"}, "power: ACTION: unknown value 'sleep' (use restart, halt)"},
        {{"help", "gett"}, "help: no command 'gett' (did you mean get?)"},
        {{"help", "get", "os"}, "help: unexpected argument 'os'"}};
    for (auto const& [arguments, message] : refusals)
        EXPECT_EQ(mihostRun(arguments), failed(2, message));
    EXPECT_EQ(mihostRun({"shell"}, "get").err,
              "mihost: line 1: get: NODE is required (see 'help get')\n");
}

TEST(MihostUsage, ShowsTheHelpOfTheProgramAndOfEachCommand)
{
    EXPECT_EQ(mihostRun({"help"}).out, mihostRun({"--help"}).out);
    EXPECT_EQ(mihostRun({"help", "get"}).out, mihostRun({"get", "--help"}).out);
    std::string const help = mihostRun({"help", "get"}).out;
    EXPECT_TRUE(holds(help, "\nUsage: mihost get [OPTIONS] NODE [PROPERTY...]\n"));
    EXPECT_TRUE(holds(help, "\nExamples:\n  mihost get os "));
    EXPECT_TRUE(holds(mihostRun({"shell"}, "help get").out, "\nExamples:\n  get os "));
}

TEST(MihostDangers, NeedYesWithoutATerminal)
{
    machine::lay("small");
    for (Lines const& arguments :
         {Lines{"power", "halt"}, Lines{"power", "restart"}, Lines{"clear-log"},
          Lines{"set", "os", "requested-state", "9"}, Lines{"set", "os", "123", "12"},
          Lines{"set", "os", "clear-log", "9"}, Lines{"call", "UserDel", "UserName=root"},
          Lines{"set", "os", "74", "UserDel,UserName:CMPI_string:root"}}) {
        Outcome const outcome = mihostRun(arguments, "y\n");
        EXPECT_EQ(outcome.code, 2) << arguments[0];
        EXPECT_TRUE(startsWith(outcome.err, "mihost: " + arguments[0]));
        EXPECT_TRUE(holds(outcome.err, ": not a terminal (add --yes to "));
    }
    EXPECT_EQ(mihost::refusedPowerCommands(), Lines());
    EXPECT_FALSE(machine::read("/var/log/messages").empty());
}

TEST(MihostPluginRun, GivesCommandsAPrivateDirectoryAndNoInput)
{
    machine::lay("small");
    machine::fake("/usr/sbin/lsmod",
                  "{ pwd; umask; echo \"$LC_ALL $LANG\"; stat -c %a .; cat; } >/tmp/said\n"
                  "echo complaint >&2\n");
    std::filesystem::create_directory("/tmp/private");
    setenv("TMPDIR", "/tmp/private", 1);
    setenv("LANG", "de_DE.ISO-8859-1", 1);
    EXPECT_EQ(mihostRun({"get", "os", "155", "154"}, "input for mihost alone\n"),
              printed("155 language-edition  de-DE\n154 code-set          ISO-8859-1\n"));
    Lines const said = linesOf(machine::read("/tmp/said"));
    ASSERT_EQ(said.size(), 4U);
    EXPECT_TRUE(startsWith(said[0], "/tmp/private/mihost-"));
    EXPECT_EQ(said[1], "0077");
    EXPECT_EQ(said[2], "C de_DE.ISO-8859-1");
    EXPECT_EQ(said[3], "700");
    EXPECT_TRUE(std::filesystem::is_empty("/tmp/private"));
}

TEST(MihostPluginRun, UsesTheCodeSetOfTheLocaleWithoutLang)
{
    machine::lay("small");
    unsetenv("LANG");
    unsetenv("LC_CTYPE");
    setenv("LC_ALL", "C.UTF-8", 1);
    EXPECT_EQ(mihostRun({"get", "os", "code-set"}).out, "154 code-set  UTF-8\n");
    setenv("LC_ALL", "C", 1);
    EXPECT_EQ(mihostRun({"get", "os", "code-set"}).out, "154 code-set  ANSI_X3.4-1968\n");
}

} // namespace commands_test
