// mihost check passes the plug-in, and fails plug-ins that are broken on purpose.

#include "TestPaths.h"
#include "tests/contract/mihost/cli/NeedsSandbox.h"
#include "tests/support/Mihost.h"
#include "tests/support/ScratchFolder.h"

#include <algorithm>
#include <filesystem>
#include <set>

namespace check_command_test
{

using Names = std::set<std::string>;

/** Checks a plug-in on a fixture machine. */
Outcome checkRun(std::string const& plugin, std::vector<std::string> const& options = {})
{
    std::vector<std::string> arguments = {"--overlay", MACHINES_DIR "/unitedlinux", "check",
                                          plugin};
    arguments.insert(arguments.end(), options.begin(), options.end());
    return mihostRun(arguments);
}

Json namesWith(Json const& results, std::string const& outcome)
{
    Json names = Json::array();
    for (Json const& result : results)
        if (result["outcome"] == outcome)
            names.push_back(result["check"]);
    return names;
}

Json findingsOf(Json const& results, std::string const& check)
{
    for (Json const& result : results)
        if (result["check"] == check)
            return result["findings"];
    return nullptr;
}

/** A way to break a plug-in, as tests/support/plugins/broken knows it, and the checks it fails. */
struct Broken {
    char const* way;
    char const* finding; // among those of the first check that fails
    Names failed;
};

class BrokenPlugin : public NeedsSandbox, public testing::WithParamInterface<Broken>
{
};

TEST_P(BrokenPlugin, FailsTheChecksOfItsFault)
{
    setenv("BROKEN", GetParam().way, 1);
    Outcome const outcome =
        checkRun(BROKEN_PLUGIN, {"--json", "--rounds", "2", "--time-limit", "20"});
    Json const results = Json::parse(outcome.out);
    Json const failed = namesWith(results, "failed");
    Names expected = GetParam().failed;
    for (Json const& skipped : namesWith(results, "skipped"))
        if (skipped == "rounds.memory") // in builds with a sanitizer
            expected.erase(skipped);
    EXPECT_EQ(failed.get<Names>(), expected) << outcome.out;
    if (expected.empty())
        GTEST_SKIP() << "this build cannot count the memory in use";
    EXPECT_EQ(outcome.code, 1) << outcome.err;
    ASSERT_FALSE(failed.empty());
    EXPECT_TRUE(holds(findingsOf(results, failed[0]).dump(), GetParam().finding)) << outcome.out;
}

Broken const ways[] = {
    {"entry-point", "the second call returns another status", {"load.entry-point"}},
    {"trace",
     "logged but not traced after: createRootNode: entry",
     {"start.log-repeats", "refresh.log-repeats", "method.log-repeats"}},
    {"exit",
     "createRootNode: entry without an exit before that of initialize",
     {"start.log-nesting", "refresh.log-nesting", "method.log-nesting"}},
    {"level",
     "level 1: createRootNode: entry",
     {"start.log-levels", "refresh.log-levels", "method.log-levels"}},
    {"category",
     "category 'Veltrix.IC.MI.Other': createRootNode: entry",
     {"start.log-categories", "refresh.log-categories", "method.log-categories"}},
    {"line",
     "no function, unit or line: createRootNode: entry",
     {"start.log-arguments", "refresh.log-arguments", "method.log-arguments"}},
    {"own-id",
     "mi #1: node id 1 rather than 7001",
     {"start.node-ids", "start.interface-ids", "refresh.tree"}},
    {"index", "index 0 rather than 1", {"start.indexes", "refresh.tree"}},
    {"parent", "parent id 7003 rather than 7004", {"start.parents", "refresh.tree"}},
    {"description",
     "description 'A System' rather than 'Operating System'",
     {"start.descriptions", "refresh.tree"}},
    {"kind",
     "group-id (89): text rather than number",
     {"start.property-kinds", "start.reads", "refresh.tree"}},
    {"missing-property", "members (165): not set", {"start.property-ids", "refresh.tree"}},
    {"flag",
     "requested-state (123): flag true rather than false",
     {"start.property-flags", "refresh.tree"}},
    {"length",
     "user-name-length (109): '99' rather than '4'",
     {"start.property-values", "refresh.tree"}},
    {"kept-nodes", "nodes are still listed after unload", {"start.unload", "rounds.memory"}},
    {"exception",
     "exception: thrown by the plug-in",
     {"start.initialize", "failing-start.answer", "refresh.answer", "refusal.build",
      "method.failure", "rounds.life"}},
    {"exit-at-unload",
     "ended the process with the exit code 3",
     {"start.unload", "early-unload.unload", "failing-start.unload", "rounds.life"}},
    {"early-unload", "killed by SIGUSR1", {"early-unload.unload"}},
    {"hidden-failure", "status 0 rather than 42", {"failing-start.answer"}},
    {"no-tree", "0 nodes of the kind log rather than 1", {"failing-start.tree"}},
    {"abort",
     "killed by SIGABRT: the plug-in gives up",
     {"refresh.answer", "refusal.build", "method.success", "rounds.life"}},
    {"no-deletion",
     "was not deleted",
     {"refresh.deleted", "refresh.node-ids", "refresh.published", "refresh.tree", "refusal.build"}},
    {"unpublished", "published 0 times rather than 1", {"refresh.published", "refusal.build"}},
    {"published-twice", "published 2 times rather than 1", {"refresh.published", "refusal.build"}},
    {"silent-refusal",
     "0 messages at level 6000 begin with 'addNewNode error = '",
     {"refusal.messages"}},
    {"method-success", "an unknown method: status 0 rather than 1", {"method.failure"}},
    {"stale-groups", "the new group has no node", {"method.group-node"}},
    {"memory", "bytes more after 2 rounds", {"rounds.memory"}},
    {"descriptors",
     "more after 2 rounds",
     {"rounds.descriptors", "rounds.children", "rounds.memory"}},
    {"children", "was not waited for", {"rounds.children"}},
};

INSTANTIATE_TEST_SUITE_P(Ways, BrokenPlugin, testing::ValuesIn(ways), [](auto const& way) {
    std::string name = way.param.way;
    std::replace(name.begin(), name.end(), '-', '_');
    return name;
});

class Check : public NeedsSandbox
{
protected:
    static void expectAllPassed(Outcome const& outcome)
    {
        EXPECT_EQ(outcome.code, 0) << outcome.out << outcome.err;
        EXPECT_EQ(outcome.err, "");
        EXPECT_TRUE(holds(outcome.out, "\n0 of "));
    }
};

// A sanitizer's allocator does not report the memory in use, so that check is skipped.
#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
constexpr bool countsMemory = false;
#else
constexpr bool countsMemory = true;
#endif

TEST_F(Check, PassesThePluginOnAFixtureMachine)
{
    Outcome const outcome = checkRun(PLUGIN_FILE);
    expectAllPassed(outcome);
    char const* const summary =
        countsMemory ? " checks failed, 0 skipped\n" : " checks failed, 1 skipped\n";
    EXPECT_TRUE(holds(outcome.out, summary));
    EXPECT_FALSE(holds(outcome.out, "note: "));
}

TEST_F(Check, PassesThePluginOnThisMachineAndChangesNothing)
{
    std::string const groups = contentOf("/etc/group");
    expectAllPassed(mihostRun({"check", "--rounds", "2"}));
    EXPECT_EQ(contentOf("/etc/group"), groups);
}

TEST_F(Check, PassesTheBrokenPluginWhenNothingIsBroken)
{
    unsetenv("BROKEN");
    expectAllPassed(checkRun(BROKEN_PLUGIN, {"--rounds", "2"}));
}

TEST_F(Check, SkipsTheMethodIfNoGroupCanBeAdded)
{
    ScratchFolder const machine;
    std::string const tool =
        machine.write("usr/sbin/groupadd", "#!/bin/sh\necho 'groupadd: locked'\n");
    std::filesystem::permissions(tool, std::filesystem::perms::owner_all);
    Outcome const outcome =
        mihostRun({"--json", "--overlay", machine.name(), "check", "--rounds", "1"});
    EXPECT_EQ(outcome.code, 0) << outcome.out << outcome.err;
    EXPECT_TRUE(holds(outcome.out, "a group cannot be added here: groupadd: locked"));
    Json expected{"method.success", "method.group-node"};
    if (!countsMemory)
        expected.push_back("rounds.memory");
    EXPECT_EQ(namesWith(Json::parse(outcome.out), "skipped"), expected);
}

TEST_F(Check, NamesASymbolThatNoHeaderDeclares)
{
    Outcome const outcome = checkRun(PLUGIN_THAT_WANTS_THE_PROGRAM, {"--json", "--rounds", "1"});
    EXPECT_EQ(outcome.code, 1) << outcome.err;
    Json const results = Json::parse(outcome.out);
    EXPECT_EQ(findingsOf(results, "load.host-symbols"),
              Json({"mihost::nodeObserver(): no header of host/ declares it, although "
                    "libmihost.so.0 has it"}));
    EXPECT_TRUE(holds(outcome.out, "public names are not defined: IC::GroupNode::GroupNode, "));
}

TEST_F(Check, RefusesAFileThatCannotBeLoaded)
{
    Outcome const outcome = checkRun(PLUGIN_WITHOUT_ENTRY_POINT);
    EXPECT_EQ(outcome.code, 3);
    EXPECT_EQ(outcome.out, "");
    EXPECT_TRUE(holds(outcome.err, "it has no entry point OpenMI"));
    EXPECT_EQ(checkRun("/nonexistent").code, 3);
}

TEST_F(Check, StopsAGroupThatHangs)
{
    setenv("BROKEN", "hang", 1);
    Json const results =
        Json::parse(checkRun(BROKEN_PLUGIN, {"--json", "--rounds", "1", "--time-limit", "1"}).out);
    EXPECT_EQ(findingsOf(results, "failing-start.answer"), Json({"not done after 1 s"}));
}

TEST_F(Check, PrintsTapForHarnesses)
{
    setenv("BROKEN", "index", 1);
    Outcome const outcome = mihostRun({"--overlay", MACHINES_DIR "/unitedlinux", "--plugin",
                                       BROKEN_PLUGIN, "check", "--format", "tap", "--rounds", "1"});
    EXPECT_EQ(outcome.code, 1);
    auto const lines = linesOf(outcome.out);
    ASSERT_GT(lines.size(), 2U);
    EXPECT_EQ(lines[0], "TAP version 14");
    std::size_t results = 0;
    for (std::string const& line : lines)
        if (line.rfind("ok ", 0) == 0 || line.rfind("not ok ", 0) == 0)
            ++results;
    EXPECT_EQ(lines[1], "1.." + std::to_string(results));
    EXPECT_TRUE(holds(outcome.out, " - start.indexes\n  ---\n"));
}

TEST_F(Check, PrintsJunitForBuildServers)
{
    Outcome const outcome = checkRun(PLUGIN_FILE, {"--format", "junit", "--rounds", "1"});
    EXPECT_EQ(outcome.code, 0);
    EXPECT_TRUE(
        startsWith(outcome.out, "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<testsuites "));
    EXPECT_TRUE(holds(outcome.out, "<testcase classname=\"start\" name=\"node-ids\"/>"));
}

TEST_F(Check, RefusesInvalidOptionsAndATrace)
{
    ScratchFolder const folder;
    for (Lines const& arguments :
         {Lines{"check", "--format", "html"}, Lines{"check", "--rounds", "0"},
          Lines{"check", "--time-limit", "0"}, Lines{"check", "--rounds", "some"},
          Lines{"--trace", folder.path("trace"), "check"}})
        EXPECT_EQ(mihostRun(arguments).code, 2) << arguments[2];
    Outcome const mixed = mihostRun({"--json", "check", "--format", "tap"});
    EXPECT_EQ(mixed.code, 2);
    EXPECT_TRUE(holds(mixed.err, " cannot be combined\n"));
}

TEST(CheckWithoutASandbox, DoesNotRun)
{
    Outcome const outcome = mihostRun({"--overlay", "/nonexistent", "check"});
    EXPECT_EQ(outcome.code, 2);
    EXPECT_EQ(outcome.out, "");
    EXPECT_TRUE(startsWith(outcome.err, "mihost: creating the sandbox: "));
    EXPECT_EQ(mihostRun({"shell"}, "check\n").code, 2);
}

} // namespace check_command_test
