#include "TestPaths.h"
#include "mihost/cli/check/Report.h"
#include "mihost/cli/check/Symbols.h"

#include "tests/support/Lines.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <set>

namespace report_test
{

using namespace mihost;
using namespace mihost::checks;

Results const results = {
    {"load.opening", "it loads", {}},
    {"load.names", "it has names", {{}, {"one <name> is missing"}}},
    {"start.tree", "the tree is whole", {{"a & \"b\"\x01", "more"}}},
    {"start.reads", "reads work", {{}, {}, "no machine"}},
};

TEST(CheckReport, ShowsFindingsNotesAndReasonsBelowTheLine)
{
    std::FILE* const file = std::tmpfile();
    Output out(file);
    writeText(results, out);
    out.flush();
    std::rewind(file);
    std::string text(4096, '\0');
    text.resize(std::fread(text.data(), 1, text.size(), file));
    std::fclose(file);
    EXPECT_EQ(text, "passed     load.opening  it loads\n"
                    "passed     load.names    it has names\n"
                    "           note: one <name> is missing\n"
                    "failed     start.tree    the tree is whole\n"
                    "           a & \"b\"\\x01\n"
                    "           more\n"
                    "skipped    start.reads   reads work\n"
                    "           no machine\n"
                    "1 of 4 checks failed, 1 skipped\n");
}

TEST(CheckReport, WritesTap)
{
    EXPECT_EQ(tapText(results), "TAP version 14\n"
                                "1..4\n"
                                "ok 1 - load.opening\n"
                                "ok 2 - load.names\n"
                                "# one <name> is missing\n"
                                "not ok 3 - start.tree\n"
                                "  ---\n"
                                "  findings:\n"
                                "    - \"a & \\\"b\\\"\\u0001\"\n"
                                "    - \"more\"\n"
                                "  ...\n"
                                "ok 4 - start.reads # SKIP no machine\n");
}

TEST(CheckReport, WritesJunitXml)
{
    EXPECT_EQ(junitText(results),
              "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
              "<testsuites name=\"mihost check\" tests=\"4\" failures=\"1\">\n"
              "  <testsuite name=\"load\" tests=\"2\" failures=\"0\" skipped=\"0\">\n"
              "    <testcase classname=\"load\" name=\"opening\"/>\n"
              "    <testcase classname=\"load\" name=\"names\">\n"
              "      <system-out>one &lt;name&gt; is missing\n</system-out>\n"
              "    </testcase>\n"
              "  </testsuite>\n"
              "  <testsuite name=\"start\" tests=\"2\" failures=\"1\" skipped=\"1\">\n"
              "    <testcase classname=\"start\" name=\"tree\">\n"
              "      <failure message=\"a &amp; &quot;b&quot;\\x01\">a &amp; &quot;b&quot;\\x01\n"
              "more\n</failure>\n"
              "    </testcase>\n"
              "    <testcase classname=\"start\" name=\"reads\">\n"
              "      <skipped message=\"no machine\"/>\n"
              "    </testcase>\n"
              "  </testsuite>\n"
              "</testsuites>\n");
}

TEST(CheckReport, IsAListAsJson)
{
    Json const list = toJson(tableOf(results));
    ASSERT_EQ(list.size(), 4U);
    EXPECT_EQ(list[1].dump(),
              R"({"check":"load.names","outcome":"passed","meaning":"it has names",)"
              R"("findings":[],"notes":["one <name> is missing"],"skipped":null})");
    EXPECT_EQ(list[2]["outcome"], "failed");
    EXPECT_EQ(list[3]["outcome"], "skipped");
    EXPECT_EQ(list[3]["skipped"], "no machine");
}

TEST(CheckScenarios, HaveUniqueNames)
{
    std::set<std::string> names;
    for (Scenario const& scenario : scenarios())
        for (mihost::checks::Check const& check : scenario.checks)
            EXPECT_TRUE(names.insert(std::string(scenario.name) + '.' + check.name).second)
                << scenario.name << ' ' << check.name;
    EXPECT_GT(names.size(), 30U);
}

TEST(CheckOfSymbols, KnowsTheHostsNames)
{
    for (char const* name :
         {"_ZN2IC6NumberC1ERKb", "_ZNK2IC11MutableNode9getNodeIdEv", "_ZTIN2IC11MutableNodeE",
          "_ZN2NQ5MutexC1Ev", "_ZN5VXLog15VXMessageBufferC1Ev"})
        EXPECT_TRUE(isHostName(name)) << name;
    for (char const* name : {"popen", "_ZN6mihost12nodeObserverEv", "_ZNSt6vectorI2ICE", "IC", "_Z",
                             "_ZN3ICE1aEv", ""})
        EXPECT_FALSE(isHostName(name)) << name;
}

/** The names without parameters, and without those that only a compiler makes. */
std::set<std::string> listedNames()
{
    std::set<std::string> names;
    for (std::string const& line : linesOf(contentOf(TESTS_DIR "/contract/exported_symbols.txt")))
        if (line.rfind("typeinfo", 0) != 0 && line.rfind("vtable", 0) != 0 &&
            line.rfind("IC::ManagementInterface::", 0) != 0)
            names.insert(line.substr(0, line.find('(')));
    return names;
}

TEST(CheckOfSymbols, HasThePublicNamesOfThePlugin)
{
    auto const& names = publicNames();
    EXPECT_EQ(std::set<std::string>(names.begin(), names.end()), listedNames());
    EXPECT_EQ(names.size(), listedNames().size());
}

TEST(CheckOfSymbols, ReportsNamesThatAreNotDefined)
{
    std::vector<Symbol> symbols = {{"OpenMI", true, false, false},
                                   {"_ZN2IC7pOsSwMIE", false, false, false}};
    auto const missing = missingPublicNames(symbols);
    EXPECT_EQ(missing.size(), publicNames().size() - 1);
    EXPECT_EQ(std::count(missing.begin(), missing.end(), "OpenMI"), 0);
    EXPECT_EQ(std::count(missing.begin(), missing.end(), "IC::pOsSwMI"), 1);
    symbols[1].defined = true;
    EXPECT_EQ(missingPublicNames(symbols).size(), missing.size() - 1);
}

TEST(CheckOfSymbols, RefusesALibraryThatIsNotLoaded)
{
    EXPECT_THROW(symbolsOf("/nonexistent"), std::runtime_error);
}

} // namespace report_test
