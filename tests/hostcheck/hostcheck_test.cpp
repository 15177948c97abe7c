// libmihostcheck in correct hosts, and in hosts that are each broken in one way.

#include "TestPaths.h"
#include "tests/support/Lines.h"
#include "tests/support/Program.h"
#include "tests/support/ScratchFolder.h"

#include <algorithm>
#include <cstdlib>
#include <gtest/gtest.h>
#include <regex>

namespace hostcheck_test
{

using Names = std::vector<std::string>;

bool startsWith(std::string const& text, std::string const& start)
{
    return text.compare(0, start.size(), start) == 0;
}

long linesThatStartWith(std::string const& start, std::string const& text)
{
    Names const lines = linesOf(text);
    return std::count_if(lines.begin(), lines.end(),
                         [&start](std::string const& line) { return startsWith(line, start); });
}

std::string host(std::string const& name)
{
    return HOSTS_DIR "/" + name;
}

/** Runs a host with the checker, whose TAP goes to standard output. */
Outcome checked(std::vector<std::string> command)
{
    setenv("MIHOSTCHECK_TAP", "-", 1);
    setenv("TZ", "JST-9", 1); // where local time is not UTC
    command.emplace_back(HOSTCHECK_FILE);
    Outcome outcome = runToEnd(command);
    unsetenv("MIHOSTCHECK_TAP");
    return outcome;
}

void expectAllPassed(Outcome const& outcome)
{
    EXPECT_EQ(outcome.code, 0) << outcome.err;
    long const passed = linesThatStartWith("ok ", outcome.out);
    EXPECT_GT(passed, 100);
    EXPECT_EQ(linesThatStartWith("not ok ", outcome.out), 0) << outcome.out;
    EXPECT_EQ(linesThatStartWith("1.." + std::to_string(passed), outcome.out), 1) << outcome.out;
}

TEST(HostCheck, PassesTheReferenceRuntimeAndAnotherHost)
{
    expectAllPassed(checked({MINIMAL_HOST}));
    expectAllPassed(checked({host("other_host")}));
}

TEST(OtherHost, ShowsTheTreeOfTheRealPlugin)
{
    Outcome const outcome = runToEnd({host("other_host"), PLUGIN_FILE});
    EXPECT_EQ(outcome.code, 0) << outcome.err;
    EXPECT_TRUE(startsWith(outcome.out, "1 OsSw Management Interface\n"
                                        "  2 ROOT Node\n"
                                        "    3 Computer\n"
                                        "      4 Operating System\n"
                                        "        5 "))
        << outcome.out;
}

#ifdef HAS_MIHOST

Outcome mihostChecked(std::vector<std::string> const& command)
{
    std::vector<std::string> arguments = {"--plugin", HOSTCHECK_FILE};
    arguments.insert(arguments.end(), command.begin(), command.end());
    return mihostRun(arguments);
}

TEST(HostCheck, PublishesItsFindingsAsNodes)
{
    Outcome const tree = mihostChecked({"tree"});
    EXPECT_EQ(tree.code, 0) << tree.err;
    std::string const first = tree.out.substr(0, tree.out.find('\n'));
    EXPECT_TRUE(std::regex_match(first, std::regex("2 #2 +passed: host check"))) << first;
    EXPECT_GT(std::count(tree.out.begin(), tree.out.end(), '\n'), 100);
    std::string const node = mihostChecked({"get", "3"}).out;
    EXPECT_NE(node.find(" IC::Number: has the declared size\n"), std::string::npos) << node;
    EXPECT_NE(node.find(" passed\n"), std::string::npos) << node;
}

TEST(HostCheck, WritesTapToAFile)
{
    ScratchFolder const folder;
    setenv("MIHOSTCHECK_TAP", folder.path("tap").c_str(), 1);
    Outcome const outcome = mihostChecked({"tree"});
    unsetenv("MIHOSTCHECK_TAP");
    EXPECT_EQ(outcome.code, 0) << outcome.err;
    EXPECT_EQ(outcome.out.find("TAP"), std::string::npos) << outcome.out;
    std::string const tap = contentOf(folder.path("tap"));
    EXPECT_TRUE(startsWith(tap, "TAP version 14\n1..")) << tap;
    EXPECT_GT(linesThatStartWith("ok ", tap), 100);
}

TEST(HostCheck, FailsToStartIfItCannotWriteTap)
{
    setenv("MIHOSTCHECK_TAP", "/nonexistent/tap", 1);
    Outcome const outcome = mihostChecked({"tree"});
    unsetenv("MIHOSTCHECK_TAP");
    EXPECT_EQ(outcome.code, 1);
    EXPECT_NE(outcome.err.find("MIHOSTCHECK_TAP names a file that cannot be written"),
              std::string::npos)
        << outcome.err;
}

#endif

/** The names that script/symbols lists of a library. */
Names symbols(char const* kind, char const* library)
{
    Outcome const outcome = runToEnd({TESTS_DIR "/../script/symbols", kind, library});
    EXPECT_EQ(outcome.code, 0) << outcome.err;
    return linesOf(outcome.out);
}

TEST(HostCheck, ExportsOnlyTheEntryPoint)
{
    EXPECT_EQ(symbols("exported", HOSTCHECK_FILE), Names{"OpenMI"});
}

/** Whether it is internal to the runtime or defined in a header, so no plug-in imports it. */
bool isInside(std::string const& name)
{
    static Names const insides = {"::Own::",    "::Store::",  "::Identity::",      "::Handle::",
                                  "::Stream::", "::stream()", "::setLoadCallBack("};
    return std::any_of(insides.begin(), insides.end(), [&name](std::string const& inside) {
        return name.find(inside) != std::string::npos;
    });
}

TEST(HostCheck, UsesEveryOperationThatAHostProvides)
{
    Names const used = symbols("undefined", HOSTCHECK_FILE);
    int provided = 0;
    for (std::string const& name : symbols("exported", RUNTIME_FILE)) {
        if (!(startsWith(name, "IC::") || startsWith(name, "NQ::") || startsWith(name, "VXLog::")))
            continue;
        if (isInside(name))
            continue;
        ++provided;
        EXPECT_NE(std::find(used.begin(), used.end(), name), used.end()) << name;
    }
    EXPECT_GT(provided, 100);
}

/** A host that is broken in one way, and the check that fails first. */
struct BrokenHost {
    char const* way;
    char const* check; // or the symbol that the loader misses
};

void PrintTo(BrokenHost const& broken, std::ostream* out)
{
    *out << broken.way;
}

/** The first check that failed, or else the one during which the host crashed. */
std::string culprit(std::string const& tap)
{
    std::string running = "nothing";
    for (std::string const& line : linesOf(tap)) {
        if (startsWith(line, "not ok "))
            return line.substr(line.find(" - ") + 3);
        if (startsWith(line, "# running "))
            running = line.substr(line.find("g ") + 2);
        else if (startsWith(line, "ok "))
            running = "nothing";
    }
    return running;
}

class BrokenHosts : public testing::TestWithParam<BrokenHost>
{
};

TEST_P(BrokenHosts, FailTheCheckOfTheirFault)
{
    Outcome const outcome = checked({host(std::string("broken_") + GetParam().way)});
    EXPECT_NE(outcome.code, 0);
    EXPECT_EQ(culprit(outcome.out), GetParam().check) << outcome.out << outcome.err;
}

auto const nameOfWay = [](auto const& broken) { return std::string(broken.param.way); };

INSTANTIATE_TEST_SUITE_P(
    All, BrokenHosts,
    testing::Values(

        BrokenHost{"BooleanIsANumber", "IC::Number::Number(bool const&): makes a truth value"},
        BrokenHost{"ShortEnumIsAByte",
                   "IC::EnumValue::EnumValue(unsigned short const&): keeps the value"},
        BrokenHost{"ErrorCopyLosesText", "IC::Error::Error(Error const&): copies"},
        BrokenHost{"FlagIsForgotten",
                   "IC::PropertyValue::PropertyValue(std::string const&, bool const&): has its "
                   "kind and keeps the flag"},
        BrokenHost{"DatesAreUtc",
                   "IC::PropertyValue::operator std::string: writes dates as local time"},
        BrokenHost{"NumberIsThePrefix",
                   "IC::PropertyValue::operator unsigned int: reads a wholly decimal text"},

        BrokenHost{"LockExcludesNobody",
                   "NQ::Mutex::lock: fails while another thread holds the lock"},
        BrokenHost{"LockIgnoresTheTime",
                   "NQ::Mutex::lock: waits for the time limit in milliseconds"},
        BrokenHost{"UnlockReturnsOne", "NQ::Mutex::unlock: releases the lock and returns 0"},
        BrokenHost{"StrayBytesAreReplaced",
                   "NQ::make_wstring(std::string const&): keeps bytes that are not UTF-8"},
        BrokenHost{"NullTextIsRead", "NQ::make_string(char const*): is empty for a null pointer"},
        BrokenHost{"ExtraIsRead", "VXLog::VXLogger::logLevelMessage: takes every level, with a "
                                  "null extra argument"},
        BrokenHost{"NumbersOvertakeText", "VXLog::VXMessageBuffer::str(std::ostream&): has text "
                                          "and numbers in order"},

        BrokenHost{"UnsetClearsTheValue", "IC::MutableNode::getProperty: fails for an unset "
                                          "property, the value untouched"},
        BrokenHost{"FirstValueStays", "IC::MutableNode::setProperty: replaces an earlier value"},
        BrokenHost{"BaseCallsDerived",
                   "IC::MutableNode::setProperty: does not call the derived one again"},
        BrokenHost{"IdIsNotTakenAway", "IC::MutableNode::delMI: takes the id away"},

        BrokenHost{"ListsTwice", "IC::ManagementInterface::addNewNode: lists a node once"},
        BrokenHost{"CallsBackTwice",
                   "IC::ManagementInterface::addNewNode: calls the load callback once"},
        BrokenHost{"AnswerIsDropped", "IC::ManagementInterface::addNewNode: returns the "
                                      "callback's answer and keeps the node"},
        BrokenHost{"NodeIsNotDeleted",
                   "IC::ManagementInterface::deleteNode: unlists and deletes the node"},
        BrokenHost{"UnlistedIsDeleted",
                   "IC::ManagementInterface::deleteNode: fails for a node that is not listed"},
        BrokenHost{"UnloadKeepsNodes", "IC::ManagementInterface::unload: deletes every node"},
        BrokenHost{"CountsFromItsOwnId", "IC::ManagementInterface::initialize: counts node ids "
                                         "from the id after its own"},
        BrokenHost{"MembersAreSwapped", "IC::ManagementInterface::initialize: counts node ids "
                                        "from the id after its own"}),
    nameOfWay);

TEST(BrokenHost, PublishesTheFailedCheckAndFailsToStart)
{
    Outcome const outcome = runToEnd({host("broken_UnlockReturnsOne"), HOSTCHECK_FILE});
    EXPECT_EQ(outcome.code, 1);
    EXPECT_TRUE(startsWith(outcome.out, "2 failed: host check\n")) << outcome.out;
    EXPECT_EQ(linesThatStartWith("2 failed: ", outcome.out), 1);
    EXPECT_NE(outcome.out.find(" failed: NQ::Mutex::unlock: releases the lock and returns 0\n"),
              std::string::npos)
        << outcome.out;
}

/** Hosts whose classes have another layout, so that none of their operations can be called. */
class MisdeclaredHosts : public testing::TestWithParam<BrokenHost>
{
};

TEST_P(MisdeclaredHosts, GetNoInterface)
{
    Outcome const outcome = checked({host(std::string("broken_") + GetParam().way)});
    EXPECT_EQ(outcome.code, 1);
    EXPECT_EQ(culprit(outcome.out), GetParam().check) << outcome.out << outcome.err;
    EXPECT_EQ(linesThatStartWith("Bail out!", outcome.out), 1) << outcome.out;
    EXPECT_EQ(linesThatStartWith("mihostcheck: 1 of ", outcome.err), 1) << outcome.err;
    EXPECT_NE(outcome.err.find(GetParam().check), std::string::npos) << outcome.err;
}

INSTANTIATE_TEST_SUITE_P(
    Headers, MisdeclaredHosts,
    testing::Values(BrokenHost{"NumberIsLarger", "IC::Number: has the declared size"},
                    BrokenHost{"NodeIsLarger", "IC::MutableNode: has the declared size"},
                    BrokenHost{"NodeSlotsAreSwapped",
                               "IC::MutableNode: has its virtual operations in order"},
                    BrokenHost{"InterfaceSlotIsAdded",
                               "IC::ManagementInterface: has its virtual operations in order"}),
    nameOfWay);

/** Hosts that lack a symbol: the loader names it. */
class IncompleteHosts : public testing::TestWithParam<BrokenHost>
{
};

TEST_P(IncompleteHosts, CannotLoadTheChecker)
{
    Outcome const outcome = checked({host(std::string("broken_") + GetParam().way)});
    EXPECT_EQ(outcome.code, 1);
    EXPECT_EQ(outcome.out, "");
    EXPECT_NE(outcome.err.find(std::string("undefined symbol: ") + GetParam().check),
              std::string::npos)
        << outcome.err;
}

INSTANTIATE_TEST_SUITE_P(Symbols, IncompleteHosts,
                         testing::Values(BrokenHost{"LacksTypeInformation",
                                                    "_ZTIN2IC19ManagementInterfaceE"},
                                         BrokenHost{"HidesItsSymbols", "_ZN2NQ"}),
                         nameOfWay);

} // namespace hostcheck_test
