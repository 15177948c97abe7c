// The program itself, run on fixture machines as a person or a script runs it.

#include "TestPaths.h"
#include "mihost/cli/input/Day.h"
#include "mihost/cli/output/DisplayWidth.h"
#include "mihost/sandbox/Sandbox.h"
#include "tests/support/Holds.h"
#include "tests/support/Lines.h"
#include "tests/support/Machine.h"
#include "tests/support/MihostJson.h"

#include <algorithm>
#include <ctime>
#include <filesystem>

namespace commands_test
{

/** Modules and a log, as lsmod and modinfo print them and syslog writes it. */
void makeMachine()
{
    setenv("LC_ALL", "C.UTF-8", 1);
    machine::lay("plain");
    machine::fake("/usr/sbin/lsmod", "echo 'Module Size Used'\necho 'ext4 1 0'\necho 'xfs 1 0'\n");
    machine::fake("/usr/sbin/modinfo",
                  "echo \"description:    Driver of $1\"\necho 'version:        1.0'\n");
    machine::write("/var/log/messages", "Jan  2 03:04:05 first line\nJan  2 03:04:06 second\n");
}

TEST(MihostTree, HasALineForEachNodeBelowItsParent)
{
    makeMachine();
    Lines const lines = linesOf(mihostRun({"tree"}).out);
    ASSERT_GE(lines.size(), 6U);
    std::string const last = "        └─log:2 #" + std::to_string(lines.size());
    struct Row {
        std::size_t line;
        std::string name;
        std::string text;
    };
    std::size_t const textsBegin = lines[0].find("OsSw");
    for (Row const& row :
         std::initializer_list<Row>{{0, "mi #1  ", "  OsSw Management Interface"},
                                    {1, "└─root #2  ", "  ROOT Node"},
                                    {3, "    └─os #4  ", "  Operating System: Linux"},
                                    {4, "      ├─driver:ext4 #5  ", "  Driver of ext4: 1.0"},
                                    {lines.size() - 1, last, "  OS LogEntry: *first line*"}}) {
        std::string const& line = lines[row.line];
        EXPECT_TRUE(startsWith(line, row.name));
        ASSERT_GE(line.size(), row.text.size());
        std::size_t const text = line.size() - row.text.size();
        EXPECT_EQ(line.substr(text), row.text) << line;
        EXPECT_EQ(mihost::displayWidth(line.substr(0, text + 2)), textsBegin) << line;
    }
    EXPECT_EQ(linesOf(mihostRun({}).out), lines);
}

TEST(MihostTree, CanBeginAtAnyNodeAndShowProperties)
{
    makeMachine();
    EXPECT_EQ(mihostRun({"tree", "--all", "driver:xfs"}).out,
              "driver:xfs #6  Driver of xfs: 1.0\n"
              "                36 manufacturer    -\n"
              "                70 build-number    -\n"
              "               108 driver-name     xfs\n"
              "               134 driver-version  1.0\n");
}

TEST(MihostTree, AsJsonIsAnArrayInTheOrderOfTheNodeList)
{
    makeMachine();
    Json const tree = mihostJson({"tree"});
    Lines kinds;
    for (Json const& node : tree) {
        EXPECT_EQ(node["id"], kinds.size() + 1);
        kinds.push_back(node["kind"]);
    }
    kinds.erase(std::remove_if(kinds.begin(), kinds.end(),
                               [](auto const& kind) { return kind == "user" || kind == "group"; }),
                kinds.end());
    EXPECT_EQ(kinds, (Lines{"mi", "root", "computer", "os", "driver", "driver", "log", "log-entry",
                            "log-entry"}));
    EXPECT_EQ(tree[3]["properties"]["clear-log"].dump(), // not stored, but read
              R"({"id":191,"kind":"number","flag":true,"value":0})");
    EXPECT_EQ(tree[3]["properties"]["requested-state"]["flag"], false);
}

TEST(MihostTree, HasThePropertiesAndKindsThatTheCatalogueNames)
{
    makeMachine();
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
    makeMachine();
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
    makeMachine();
    for (Lines const& arguments :
         {Lines{"get", "driver:none"}, Lines{"get", "999"}, Lines{"get", "os", "none"},
          Lines{"get", "os", "999"}, Lines{"get", "os", "message"}, Lines{"tree", "user:none"},
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
    makeMachine();
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

TEST(MihostList, PointsToTheDoctorIfThereIsNothingToList)
{
    makeMachine();
    machine::write("/var/log/messages", "");
    EXPECT_EQ(mihostRun({"list", "log"}),
              (Outcome{0, "index  time  message\n",
                       "mihost: nothing to list under log (see 'mihost doctor')\n"}));
    EXPECT_EQ(mihostRun({"--json", "list", "log"}).err, "");
}

TEST(MihostOutput, KeepsControlCharactersFromTheTerminal)
{
    makeMachine();
    machine::write("/var/log/messages", "Jan  2 03:04:05 a\x1b[31mb\xFF\n");
    EXPECT_EQ(mihostRun({"get", "log:1", "81"}).out, " 81 message  *a\\x1b[31mb\\xff*\n");
    for (Lines const& arguments : {Lines{"tree"}, Lines{"tree", "--all"}, Lines{"list", "log"}})
        EXPECT_EQ(mihostRun(arguments).out.find_first_of("\x1b\xFF"), std::string::npos);
    EXPECT_EQ(mihostJson({"get", "log:1", "81"})["properties"]["message"]["value"],
              "*a\x1b[31mb\\xff*");
}

TEST(MihostTrace, IsJsonLinesInCallOrderWithBothLoggerOperations)
{
    makeMachine();
    EXPECT_EQ(mihostRun({"--trace", "/tmp/trace", "version"}).code, 0);
    EXPECT_EQ(machine::read("/tmp/trace"), ""); // nothing was started

    EXPECT_EQ(mihostRun({"--trace", "/tmp/trace", "tree"}).code, 0);
    Lines const lines = linesOf(machine::read("/tmp/trace"));
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

TEST(MihostTrace, GoesToStandardErrorForADash)
{
    makeMachine();
    Outcome const outcome = mihostRun({"--trace", "-", "get", "os", "108"});
    EXPECT_EQ(outcome.out, "108 os-name  Linux\n");
    EXPECT_EQ(Json::parse(linesOf(outcome.err).at(0))["message"], "initialize: entry");
}

TEST(MihostTrace, ThatCannotBeWrittenIsReportedWithExitCode2)
{
    makeMachine();
    EXPECT_EQ(mihostRun({"--trace", "/dev/full", "get", "os", "108"}),
              (Outcome{2, "108 os-name  Linux\n",
                       "mihost: cannot write the trace '/dev/full': No space left on device\n"}));
    Outcome const missing = mihostRun({"--trace", "/nonexistent/file", "get", "os", "108"});
    EXPECT_EQ(missing.code, 2);
    EXPECT_EQ(missing.out, "");
}

TEST(MihostTiming, ShowsPhasesAndCommandsOfTheStart)
{
    makeMachine();
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
    makeMachine();
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
        {{"tre"}, "no command 'tre' (did you mean tree?)"},
        {{"tre", "os"}, "no command 'tre' (did you mean tree?)"},
        {{"--timng", "tree"}, "tree: no option '--timng' (did you mean --timing?)"},
        {{"tree", "--al"}, "tree: no option '--al' (did you mean --all?)"},
        {{"list", "users", "--colums=id"},
         "list: no option '--colums=id' (did you mean --columns?)"},
        {{"tree", "--nothing"}, "tree: no option '--nothing' (see 'mihost tree --help')"},
        {{"--nothing"}, "no option '--nothing' (see 'mihost --help')"},
        {{"tree", "os", "extra"}, "tree: unexpected argument 'extra' (see 'mihost tree --help')"},
        {{"power", "hatl"}, "power: ACTION: unknown value 'hatl' (did you mean halt?)"},
        {{"power", "sleep"}, "power: ACTION: unknown value 'sleep' (use restart, halt)"},
        {{"watch", "os", "108", "--interval", "nan"},
         "watch: --interval: 'nan' is not a number from 0 to 86400 (see 'mihost watch --help')"},
        {{"watch", "os", "108", "--interval", "-1"},
         "watch: --interval: '-1' is not a number from 0 to 86400 (see 'mihost watch --help')"},
        {{"get"}, "get: NODE is required (see 'mihost get --help')"},
        {{"set", "os"}, "set: PROPERTY is required (see 'mihost set --help')"},
        {{"help", "gett"}, "help: no command 'gett' (did you mean get?)"},
        {{"help", "get", "os"}, "help: unexpected argument 'os'"}};
    for (auto const& [arguments, message] : refusals)
        EXPECT_EQ(mihostRun(arguments), failed(2, message));
    EXPECT_TRUE(
        startsWith(mihostRun({"nonsense"}).err, "mihost: no command 'nonsense' (use tree, list, "));
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
    makeMachine();
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
    makeMachine();
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
    makeMachine();
    unsetenv("LANG");
    unsetenv("LC_CTYPE");
    setenv("LC_ALL", "C.UTF-8", 1);
    EXPECT_EQ(mihostRun({"get", "os", "code-set"}).out, "154 code-set  UTF-8\n");
    setenv("LC_ALL", "C", 1);
    EXPECT_EQ(mihostRun({"get", "os", "code-set"}).out, "154 code-set  ANSI_X3.4-1968\n");
}

} // namespace commands_test
