// From the loading of the library to its closing.

#include "TestPaths.h"
#include "tests/contract/recording_host/Loaded.h"

#include "host/OpenMI.h"
#include "host/Properties.h"
#include "tests/interpose/Libc.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/FileRoot.h"

#include <algorithm>
#include <ctime>
#include <dlfcn.h>
#include <memory>
#include <new>
#include <set>
#include <sys/sysinfo.h>
#include <utility>

namespace lifecycle_test
{

Lines const builders = {"createOsSwNodes",  "createRootNode",    "createComputerNodes",
                        "createOsNodes",    "createDriverNodes", "createUserNodes",
                        "createGroupNodes", "createLogNodes",    "createLogEntryNodes"};

/** The entry and exit messages of builders, initialize, unload and publishNode. */
Lines frameMessages(Lines const& messages)
{
    Lines found;
    for (std::string const& message : messages) {
        std::string const name = message.substr(0, message.find(':'));
        if (name == "initialize" || name == "unload" || name == "publishNode" ||
            std::find(builders.begin(), builders.end(), name) != builders.end())
            found.push_back(message);
    }
    return found;
}

class Library : public testing::Test
{
protected:
    void SetUp() override
    {
#ifdef __SANITIZE_ADDRESS__
        GTEST_SKIP() << "with this sanitizer libraries stay loaded";
#endif
    }
};

TEST_F(Library, ConstructsItsObjectsInOrderAndDestroysThemInReverse)
{
    RecordingHost const& host = freshHost();
    std::make_unique<Plugin>().reset();
    EXPECT_EQ(host.events, (Lines{"ManagementInterface(), category Veltrix.IC.MI.OsSwMI",
                                  "Error(0, unsigned 0, \"\")", "Mutex()", "~Mutex()", "~Error()",
                                  "~ManagementInterface(), category Veltrix.IC.MI.OsSwMI"}));
    EXPECT_EQ(dlopen(PLUGIN_FILE, RTLD_NOW | RTLD_NOLOAD), nullptr);
}

TEST_F(Library, DestroysTheMutexOfTheGroupListingFirstOfAll)
{
    RecordingHost& host = freshHost();
    FileRoot const files{MACHINES_DIR "/redhat"};
    FakeCommands const commands;
    auto plugin = std::make_unique<Plugin>();
    plugin->initialize(); // which lists the groups for the first time
    plugin->unload();
    host.events.clear();
    plugin.reset();
    EXPECT_EQ(host.events, (Lines{"~Mutex()", "~Mutex()", "~Error()",
                                  "~ManagementInterface(), category Veltrix.IC.MI.OsSwMI"}));
}

TEST_F(Library, DeletesNoNodeWhenItIsClosed)
{
    RecordingHost& host = freshHost();
    auto plugin = std::make_unique<Plugin>();
    auto& mi = static_cast<IC::OsSwMI&>(plugin->interface());
    IC::MutableNode user(1, 0, {1}, IC::nodeType::user, 1);
    IC::MutableNode group(2, 0, {1}, IC::nodeType::group, 1);
    IC::MutableNode entry(3, 0, {1}, IC::nodeType::logEntry, 1);
    mi.*(&OpenInterface::userNodes_) = {&user};
    mi.*(&OpenInterface::groupNodes_) = {&group};
    mi.*(&OpenInterface::logEntryNodes_) = {&entry};
    host.events.clear();
    plugin.reset();
    EXPECT_EQ(host.events, (Lines{"~Mutex()", "~Error()",
                                  "~ManagementInterface(), category Veltrix.IC.MI.OsSwMI"}));
}

class Lifecycle : public Loaded
{
protected:
    IC::OsSwMI*& current() const
    {
        return object<IC::OsSwMI*>("IC::pOsSwMI");
    }

    /** Deletes the nodes of a kind and creates them again, as a write of a host does. */
    void rebuild(char const* builder) const
    {
        auto* const rebuilds =
            reinterpret_cast<void (*)(IC::OsSwMI*, bool)>(plugin.symbol(builder));
        rebuilds(&mi(), true);
    }

    Ids nodeTypes() const
    {
        Ids types;
        for (IC::MutableNode const* node : plugin.nodes())
            types.push_back(node->getNodeType());
        return types;
    }
};

TEST_F(Lifecycle, StartsWithEmptyListsAndReadsTheIdRangesOnFirstUse)
{
    EXPECT_TRUE(inside(&OpenInterface::userNodes_).empty());
    EXPECT_TRUE(inside(&OpenInterface::groupNodes_).empty());
    EXPECT_TRUE(inside(&OpenInterface::logEntryNodes_).empty());
    EXPECT_EQ(current(), nullptr);
    EXPECT_FALSE(object<bool>("IC::OSSWMI::MI_call"));
    auto const& instance = object<void*>("NQ::minMaxId::pinstance");
    EXPECT_EQ(instance, nullptr);
    plugin.initialize();
    void const* const first = instance;
    EXPECT_NE(first, nullptr);
    rebuild("IC::OsSwMI::createUserNodes(bool)");
    EXPECT_EQ(instance, first);
}

TEST_F(Lifecycle, OpenMIReturnsTheSameTwoObjectsAndCallsNothing)
{
    host.events.clear();
    auto* const open = reinterpret_cast<decltype(&OpenMI)>(plugin.symbol("OpenMI"));
    IC::ManagementInterface* interface = nullptr;
    IC::Error* error = nullptr;
    for (int time = 0; time < 2; ++time) {
        EXPECT_EQ(open(&interface, &error), 0);
        EXPECT_EQ(interface, &plugin.interface());
        EXPECT_EQ(error, &plugin.status());
    }
    EXPECT_EQ(interface, plugin.symbol("IC::OSSWMI::myosswmi"));
    EXPECT_EQ(error, plugin.symbol("IC::OSSWMI::myerr"));
    EXPECT_EQ(host.events, Lines());
}

TEST_F(Lifecycle, SetLoadCallBackOnlyStoresItsArguments)
{
    IC::ManagementInterface::LoadCallBack const load = [](IC::Node* const&,
                                                          void const*) -> IC::Error { throw 1; };
    IC::ManagementInterface::LookupCallBack const lookUp = [](std::string const&,
                                                              IC::Node**) -> IC::Error { throw 1; };
    host.events.clear();
    mi().setLoadCallBack(load, this, lookUp);
    EXPECT_EQ(inside(&OpenInterface::loadCallBack_), load);
    EXPECT_EQ(inside(&OpenInterface::loadCallBackContext_), this);
    EXPECT_EQ(inside(&OpenInterface::lookupCallBack_), lookUp);
    EXPECT_EQ(host.events, Lines());
    plugin.initialize();
    rebuild("IC::OsSwMI::createUserNodes(bool)");
}

TEST_F(Lifecycle, InitializePassesItsThreeArgumentsOnUnchanged)
{
    host.events.clear();
    mi().initialize(5, IC::Number(77U), IC::Number(true));
    ASSERT_GE(host.events.size(), 2U);
    EXPECT_EQ(host.events[0], "log: initialize: entry");
    EXPECT_EQ(host.events[1], "initialize(5, unsigned 77, boolean 1)");
    mi().unload();
}

TEST_F(Lifecycle, InitializeSetsItsMembersFirstAndBuildsLast)
{
    IC::MutableNode last(1, 0, {1}, 39, 0);
    inside(&OpenInterface::currentNode_) = &last;
    std::vector<IC::MutableNode*> seen;
    host.onInitialize = [this, &seen] {
        EXPECT_EQ(current(), &mi());
        EXPECT_TRUE(inside(&OpenInterface::nodeIds_)->empty());
        seen.push_back(inside(&OpenInterface::currentNode_));
    };
    host.onNode = [this, &seen] { seen.push_back(inside(&OpenInterface::currentNode_)); };
    plugin.initialize();
    ASSERT_GE(seen.size(), 2U);
    EXPECT_EQ(seen[0], &last);
    EXPECT_EQ(seen[1], nullptr);
}

TEST_F(Lifecycle, InitializeRunsTheNineBuildersInOrder)
{
    plugin.initialize();
    Lines expected = {"initialize: entry"};
    for (std::string const& builder : builders) {
        expected.push_back(builder + ": entry");
        expected.push_back(builder + ": exit");
    }
    expected.emplace_back("initialize: exit");
    EXPECT_EQ(frameMessages(host.messages()), expected);
}

TEST_F(Lifecycle, BuildsTheTreeIfTheFrameworkFails)
{
    EXPECT_EQ(plugin.initialize().getStatus(), 0);
    EXPECT_EQ(plugin.status().getStatus(), 0);
    Ids const whole = nodeTypes();
    plugin.unload();

    host.initializeStatus = 3;
    IC::Error const error = plugin.initialize();
    EXPECT_EQ(static_cast<std::string>(error), "status 3, not ready");
    EXPECT_EQ(static_cast<std::string>(plugin.status()), "status 3, not ready");
    EXPECT_EQ(nodeTypes(), whole);
    EXPECT_EQ(Ids(whole.begin(), whole.begin() + 4), (Ids{39, 59, 40, 17}));
}

TEST_F(Lifecycle, BuildsTheTreeWhateverTheSettersReturn)
{
    // Computed from the clock, the time of the last boot could differ by a second between starts.
    libc::hooks().time = [](std::time_t*) { return std::time_t{1273659825}; };
    libc::hooks().sysinfo = [](struct sysinfo* figures) {
        *figures = {};
        figures->uptime = 1000;
        return 0;
    };
    commands.answers = {{"lsmod", "exnet 24576 0\nexfs 1 0\n"},
                        {"modinfo exnet", ""},
                        {"modinfo exfs", ""},
                        {"wc -l /var/log/messages", "3 /var/log/messages\n"}};
    host.events.clear();
    plugin.initialize();
    ASSERT_EQ(plugin.nodes(IC::nodeType::driver).size(), 2U);
    Ids const whole = nodeTypes();
    Lines events = host.events;
    // The mutex of the group listing is made only once.
    events.erase(std::remove(events.begin(), events.end(), "Mutex()"), events.end());
    plugin.unload();

    host.events.clear();
    host.setterStatus = 1;
    EXPECT_EQ(plugin.initialize().getStatus(), 0);
    EXPECT_EQ(nodeTypes(), whole);
    EXPECT_EQ(host.events, events);
}

TEST_F(Lifecycle, PropagatesBadAlloc)
{
    commands.answers = {{"lsmod", "exnet 24576 0\n"},
                        {"modinfo exnet", ""},
                        {"wc -l /var/log/messages", "1 /var/log/messages\n"}};
    std::size_t built = 0;
    host.onNode = [&built] { ++built; };
    plugin.initialize();
    std::size_t const whole = built;
    ASSERT_GE(whole, 9U); // one of each kind at least
    plugin.unload();
    for (std::size_t last = 1; last <= whole; ++last) {
        built = 0;
        host.onNode = [&built, last] {
            if (++built == last)
                throw std::bad_alloc();
        };
        EXPECT_THROW(plugin.initialize(), std::bad_alloc) << last;
        EXPECT_EQ(built, last);
        plugin.unload();
    }
}

TEST_F(Lifecycle, BuildsTheTreeWhateverALockReturns)
{
    plugin.initialize();
    Ids const whole = nodeTypes();
    plugin.unload();
    host.events.clear();
    host.lockStatus = 1;
    plugin.initialize();
    EXPECT_EQ(nodeTypes(), whole);
    // Around the users, around the groups, and around the listing of the groups.
    EXPECT_EQ(std::count(host.events.begin(), host.events.end(), "lock(4294967295)"), 3);
    EXPECT_EQ(std::count(host.events.begin(), host.events.end(), "unlock()"), 3);
}

TEST_F(Lifecycle, PublishesNoNodeAtTheStart)
{
    commands.answers["wc -l /var/log/messages"] = "3 /var/log/messages\n";
    plugin.initialize();
    for (unsigned int const type :
         {IC::nodeType::user, IC::nodeType::group, IC::nodeType::logEntry})
        EXPECT_FALSE(plugin.nodes(type).empty());
    for (std::string const& call : host.calls())
        EXPECT_EQ(call.find("addNewNode"), std::string::npos) << call;
}

class Publishing : public Lifecycle
{
protected:
    Publishing()
    {
        plugin.initialize();
        host.events.clear();
        host.logCalls.clear();
    }

    /** A member function of IC::OsSwMI, called as such. */
    void publish(IC::Node* node)
    {
        auto* const publishNode = reinterpret_cast<void (*)(IC::OsSwMI*, IC::Node*)>(
            plugin.symbol("IC::OsSwMI::publishNode(IC::Node*)"));
        publishNode(&mi(), node);
    }
};

TEST_F(Publishing, PassesTheNodeToTheFrameworkAndLogsARefusal)
{
    std::size_t const nodes = plugin.nodes().size();
    constexpr unsigned char statuses[] = {0, 1, 255};
    for (unsigned char const status : statuses) {
        host.events.clear();
        host.logCalls.clear();
        host.addNewNodeStatus = status;
        publish(inside(&OpenInterface::rootNode_));
        Lines refusal;
        Lines expected{"log: publishNode: entry", "addNewNode(ROOT Node)"};
        if (status != 0) {
            refusal = {"addNewNode error = status " + std::to_string(status) + ", refused"};
            expected.push_back("log: " + refusal[0]);
        }
        expected.emplace_back("log: publishNode: exit");
        EXPECT_EQ(host.events, expected);
        EXPECT_EQ(host.messages(6000), refusal);
    }
    EXPECT_EQ(plugin.nodes().size(), nodes);
}

struct Rebuild {
    char const* builder; // of IC::OsSwMI, taking the refresh flag
    unsigned int type;
};

constexpr Rebuild rebuilds[] = {{"IC::OsSwMI::createUserNodes(bool)", IC::nodeType::user},
                                {"IC::OsSwMI::createGroupNodes(bool)", IC::nodeType::group},
                                {"IC::OsSwMI::createLogEntryNodes(bool)", IC::nodeType::logEntry}};

TEST_F(Publishing, OfARebuildLogsEachRefusalOnceAndContinues)
{
    commands.answers["wc -l /var/log/messages"] = "3 /var/log/messages\n";
    host.addNewNodeStatus = 1;
    for (auto const& [builder, type] : rebuilds) {
        host.logCalls.clear();
        rebuild(builder);
        std::size_t const nodes = plugin.nodes(type).size();
        ASSERT_GE(nodes, 3U);
        Lines refusals;
        for (std::string const& message : host.messages(6000))
            if (message.rfind("addNewNode error = ", 0) == 0)
                refusals.push_back(message);
        EXPECT_EQ(refusals, Lines(nodes, "addNewNode error = status 1, refused"));
        Lines const all = host.messages();
        EXPECT_EQ(std::count(all.begin(), all.end(), "publishNode: exit"),
                  static_cast<std::ptrdiff_t>(nodes));
    }
}

TEST_F(Lifecycle, UnloadFreesTheIdListLast)
{
    plugin.initialize();
    host.events.clear();
    bool hadList = false;
    host.onUnload = [this, &hadList] { hadList = inside(&OpenInterface::nodeIds_) != nullptr; };
    plugin.unload();
    EXPECT_EQ(host.events[0], "log: unload: entry");
    EXPECT_EQ(host.events[1], "unload()");
    EXPECT_EQ(host.events.back(), "log: unload: exit");
    EXPECT_TRUE(hadList);
    EXPECT_EQ(inside(&OpenInterface::nodeIds_), nullptr);
    host.events.clear();
    mi().unload(); // without initialize
    EXPECT_EQ(host.events, (Lines{"log: unload: entry", "unload()", "log: unload: exit"}));
}

TEST_F(Lifecycle, UnloadDeletesNoNodeItself)
{
    plugin.initialize();
    IC::MutableNode* const root = inside(&OpenInterface::rootNode_);
    auto kept = inside(&OpenInterface::nodes_);
    host.onUnload = [this] { inside(&OpenInterface::nodes_).clear(); }; // the framework keeps them
    plugin.unload();
    EXPECT_EQ(root->getDescription(), "ROOT Node");
    for (IC::Node* node : kept)
        delete node;
}

TEST_F(Lifecycle, EachMessageGoesToBothLoggerOperations)
{
    plugin.initialize();
    plugin.unload();
    auto const& calls = host.logCalls;
    ASSERT_FALSE(calls.empty());
    ASSERT_EQ(calls.size() % 2, 0U);
    for (std::size_t at = 0; at < calls.size(); ++at) {
        LogCall const& call = calls[at];
        LogCall const& first = calls[at - at % 2];
        EXPECT_EQ(call.operation, at % 2 == 0 ? "log" : "trace");
        EXPECT_EQ(call.function, first.function);
        EXPECT_EQ(call.file, first.file);
        EXPECT_EQ(call.line, first.line);
        EXPECT_GT(call.line, 0);
        EXPECT_EQ(call.category, first.category);
        EXPECT_EQ(call.level, first.level);
        EXPECT_EQ(call.message, first.message);
        EXPECT_TRUE(call.extraIsNull);
        EXPECT_EQ(call.first, 0);
        EXPECT_EQ(call.second, 0);
    }
}

TEST_F(Lifecycle, TheFrameLogsUnderItsOwnCategoryAndFile)
{
    plugin.initialize();
    plugin.unload();
    std::size_t count = 0;
    for (LogCall const& call : host.logCalls) {
        if (frameMessages({call.message}).empty())
            continue;
        ++count;
        EXPECT_EQ(call.function, call.message.substr(0, call.message.find(':')));
        EXPECT_EQ(call.file, "OsSwMI");
        EXPECT_EQ(call.category, "Veltrix.IC.MI.OsSwMI");
        EXPECT_EQ(call.level, 3000);
    }
    // Entry and exit, each through both operations, of the builders, initialize and unload.
    EXPECT_EQ(count, (builders.size() + 2) * 4);
}

/** The instance of the id ranges, which the library names and makes. */
void* idRanges(Plugin const& plugin)
{
    auto* const instance = reinterpret_cast<void* (*)()>(plugin.symbol("NQ::minMaxId::Instance()"));
    void* const ranges = instance();
    EXPECT_EQ(ranges, *static_cast<void**>(plugin.symbol("NQ::minMaxId::pinstance")));
    return ranges;
}

/** The bounds in an instance, which need not be the library's own. */
Ids boundsOf(void* ranges, Plugin const& plugin)
{
    Ids bounds;
    for (std::string const getter :
         {"getMinUserId", "getMinGroupId", "getMaxUserId", "getMaxGroupId"})
        bounds.push_back(reinterpret_cast<unsigned int (*)(void*)>(
            plugin.symbol("NQ::minMaxId::" + getter + "()"))(ranges));
    return bounds;
}

TEST_F(Library, KeepsTheIdRangesOnTheHeapAndReadsThemAgain)
{
    freshHost();
    FakeCommands const commands;
    std::vector<Ids> bounds;
    void* ranges = nullptr;
    for (char const* machine : {MACHINES_DIR "/redhat", MACHINES_DIR "/suse"}) {
        FileRoot const files{machine};
        Plugin plugin;
        plugin.initialize();
        if (ranges) // those of the library that was closed
            bounds.push_back(boundsOf(ranges, plugin));
        ranges = idRanges(plugin);
        Dl_info info{};
        EXPECT_EQ(dladdr(ranges, &info), 0); // part of no loaded file
        bounds.push_back(boundsOf(ranges, plugin));
    }
    Ids const redhat{500, 500, 60000, 60000};
    EXPECT_EQ(bounds, (std::vector<Ids>{redhat, redhat, {1000, 1000, 60000, 60000}}));
}

TEST_F(Lifecycle, SetsTheFlagOnlyWhileAUserNodeIsSetUp)
{
    bool const& flag = object<bool>("IC::OSSWMI::MI_call");
    host.onNode = [&flag] { EXPECT_FALSE(flag); };
    host.onSetStatus = [&flag](IC::MutableNode const& node) {
        EXPECT_EQ(flag, node.getNodeType() == IC::nodeType::user) << node.getNodeType();
    };
    plugin.initialize();
    EXPECT_GE(plugin.nodes(IC::nodeType::user).size(), 2U);
}

TEST_F(Lifecycle, HoldsTheLockThroughoutABuildAndARebuild)
{
    struct {
        std::string name;
        char const* symbol;
        int unlocks; // the listing of groups has its own lock
    } const builds[] = {{"createUserNodes", "IC::OsSwMI::createUserNodes(bool)", 1},
                        {"createGroupNodes", "IC::OsSwMI::createGroupNodes(bool)", 2}};
    plugin.initialize();
    Lines const first = host.events;
    for (auto const& [name, symbol, unlocks] : builds) {
        host.events.clear();
        rebuild(symbol);
        for (Lines const& all : {first, host.events}) {
            auto const entry = std::find(all.begin(), all.end(), "log: " + name + ": entry");
            auto const exit = std::find(all.begin(), all.end(), "log: " + name + ": exit");
            ASSERT_GT(exit - entry, 2);
            EXPECT_EQ(entry[1], "lock(4294967295)");
            EXPECT_EQ(exit[-1], "unlock()");
            EXPECT_EQ(std::count(entry, exit, "unlock()"), unlocks);
        }
    }
    host.events.clear();
    plugin.node(IC::nodeType::operatingSystem).setProperty(75, {IC::Number(0U), true});
    // Around the users, around the groups, and around the listing of the groups.
    EXPECT_EQ(std::count(host.events.begin(), host.events.end(), "lock(4294967295)"), 3);
}

TEST_F(Lifecycle, HasTheCategoryOfEveryUnitFromTheStart)
{
    std::pair<char const*, char const*> const units[] = {
        {"IC::OSSWMI::loggerOsSwMI", ""},      {"NQ::loggerMyProcess", ".MyProcess"},
        {"NQ::loggerOsInfo", ".OsInfo"},       {"NQ::USER_INFO::loggerUserInfo", ".UserInfo"},
        {"NQ::loggerGroupInfo", ".GroupInfo"}, {"NQ::loggerDriverInfo", ".DriverInfo"},
        {"NQ::loggerLogInfo", ".LogInfo"}};
    for (auto const& [symbol, end] : units)
        EXPECT_EQ(object<std::string>(symbol), std::string("Veltrix.IC.MI.OsSwMI") + end);
}

TEST_F(Lifecycle, KeepsTheDriversWhenOtherNodesAreRebuilt)
{
    commands.answers = {{"lsmod", "exnet 24576 0\n"},
                        {"modinfo exnet", ""},
                        {"wc -l /var/log/messages", "1 /var/log/messages\n"}};
    plugin.initialize();
    auto const drivers = plugin.nodes(IC::nodeType::driver);
    ASSERT_EQ(drivers.size(), 1U);
    unsigned int const id = drivers[0]->getNodeId();
    commands.ran.clear();
    host.events.clear();
    plugin.node(IC::nodeType::operatingSystem).setProperty(75, {IC::Number(0U), true});
    rebuild("IC::OsSwMI::createLogEntryNodes(bool)");
    EXPECT_EQ(plugin.nodes(IC::nodeType::driver), drivers);
    EXPECT_EQ(drivers[0]->getNodeId(), id);
    for (std::string const& event : host.events) // an address may be used again
        EXPECT_EQ(event.find(", 44, "), std::string::npos) << event;
    for (std::string const& command : commands.ran)
        EXPECT_NE(command, "lsmod");
}

TEST_F(Publishing, TakesNoLockForLogEntries)
{
    commands.answers["wc -l /var/log/messages"] = "3 /var/log/messages\n";
    rebuild("IC::OsSwMI::createLogEntryNodes(bool)");
    EXPECT_EQ(plugin.nodes(IC::nodeType::logEntry).size(), 3U);
    EXPECT_EQ(std::count(host.events.begin(), host.events.end(), "lock(4294967295)"), 0);
}

TEST_F(Lifecycle, OpensOnlyTheSystemFilesThatItReads)
{
    std::set<std::string> opened;
    libc::hooks().fopen = [&opened, below = libc::hooks().fopen.answer()](char const* path,
                                                                          char const* mode) {
        opened.insert(path);
        return below(path, mode);
    };
    plugin.initialize();
    std::set<std::string> const known = {
        "/etc/login.defs",     "/etc/passwd",       "/etc/shadow",
        "/etc/pam.d/login",    "/etc/release",      "/etc/vmware-release",
        "/etc/redhat-release", "/etc/SuSE-release", "/etc/UnitedLinux-release"};
    EXPECT_FALSE(opened.empty());
    for (std::string const& path : opened)
        EXPECT_EQ(known.count(path), 1U) << path;
}

TEST_F(Lifecycle, InitializeReturnsTheStatusObjectsLastValue)
{
    host.initializeStatus = 3;
    Ids kept;
    host.onNode = [this, &kept] {
        kept.push_back(plugin.status().getStatus());
        object<IC::Error>("IC::OSSWMI::myerr") = IC::Error(9, IC::Number(0U), "later");
    };
    EXPECT_EQ(plugin.initialize().getStatus(), 9);
    ASSERT_FALSE(kept.empty());
    EXPECT_EQ(kept.front(), 3U);
}

TEST_F(Publishing, OfARebuildIgnoresADeletionThatFails)
{
    commands.answers["wc -l /var/log/messages"] = "3 /var/log/messages\n";
    for (auto const& [builder, type] : rebuilds) {
        host.deleteNodeStatus = 0;
        host.logCalls.clear();
        rebuild(builder);
        Lines const errors = host.messages(6000);
        std::size_t const nodes = plugin.nodes(type).size();
        ASSERT_GE(nodes, 3U);
        host.logCalls.clear();
        host.events.clear();
        host.deleteNodeStatus = 1;
        rebuild(builder);
        EXPECT_EQ(host.messages(6000), errors);
        EXPECT_EQ(plugin.nodes(type).size(), 2 * nodes); // the old ones stay
        Lines const calls = host.calls();
        EXPECT_EQ(std::count_if(calls.begin(), calls.end(),
                                [](auto const& call) { return call.rfind("deleteNode(", 0) == 0; }),
                  static_cast<std::ptrdiff_t>(nodes)); // each requested once
    }
}

} // namespace lifecycle_test
