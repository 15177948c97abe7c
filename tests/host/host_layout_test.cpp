// What a plug-in built against these headers relies on in memory.

#include "TestPaths.h"
#include "frame/OsSwMI.h"
#include "nodes/GroupNode.h"
#include "nodes/LogEntryNode.h"
#include "nodes/OsNode.h"
#include "nodes/UserNode.h"

#include "sysdata/driverInfo_linux.h"
#include "sysdata/logInfo_linux.h"
#include "sysdata/osInfo_linux.h"
#include "tests/interpose/Libc.h"
#include "tests/support/Insides.h"
#include "util/MyProcess.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <functional>
#include <string>
#include <type_traits>
#include <utility>
#include <vector>

namespace host_layout_test
{

TEST(HostLayout, GivesNodeClassesNoMembersOfTheirOwn)
{
    EXPECT_EQ(sizeof(IC::OsNode), sizeof(IC::MutableNode));
    EXPECT_EQ(sizeof(IC::UserNode), sizeof(IC::MutableNode));
    EXPECT_EQ(sizeof(IC::GroupNode), sizeof(IC::MutableNode));
    EXPECT_EQ(sizeof(IC::LogEntryNode), sizeof(IC::MutableNode));
}

/** The offsets of the interface's members, in their fixed order. */
std::vector<std::ptrdiff_t> offsetsIn(OpenInterface const& interface)
{
    auto const offset = [&interface](auto const& member) {
        return reinterpret_cast<char const*>(&member) - reinterpret_cast<char const*>(&interface);
    };
    return {offset(interface.nextNodeId_),     offset(interface.miId_),
            offset(interface.nodes_),          offset(interface.miIds_),
            offset(interface.loadCallBack_),   offset(interface.loadCallBackContext_),
            offset(interface.lookupCallBack_), offset(interface.currentNode_),
            offset(interface.nodeIds_),        offset(interface.osSwNode_),
            offset(interface.rootNode_),       offset(interface.computerNode_),
            offset(interface.osNode_),         offset(interface.logNode_),
            offset(interface.userNodes_),      offset(interface.groupNodes_),
            offset(interface.logEntryNodes_)};
}

static_assert(std::is_same_v<decltype(OpenInterface::nextNodeId_), unsigned int>);
static_assert(std::is_same_v<decltype(OpenInterface::miId_), unsigned int>);
static_assert(std::is_same_v<decltype(OpenInterface::nodes_), std::vector<IC::Node*>>);
static_assert(std::is_same_v<decltype(OpenInterface::miIds_), std::vector<unsigned int>>);
static_assert(std::is_same_v<decltype(OpenInterface::loadCallBack_),
                             IC::Error (*)(IC::Node* const&, void const*)>);
static_assert(std::is_same_v<decltype(OpenInterface::loadCallBackContext_), void const*>);
static_assert(std::is_same_v<decltype(OpenInterface::lookupCallBack_),
                             IC::Error (*)(std::string const&, IC::Node**)>);
static_assert(std::is_same_v<decltype(OpenInterface::currentNode_), IC::MutableNode*>);
static_assert(std::is_same_v<decltype(OpenInterface::nodeIds_), std::vector<unsigned int>*>);
static_assert(std::is_same_v<decltype(OpenInterface::osSwNode_), IC::MutableNode*>);
static_assert(std::is_same_v<decltype(OpenInterface::rootNode_), IC::MutableNode*>);
static_assert(std::is_same_v<decltype(OpenInterface::computerNode_), IC::MutableNode*>);
static_assert(std::is_same_v<decltype(OpenInterface::osNode_), IC::MutableNode*>);
static_assert(std::is_same_v<decltype(OpenInterface::logNode_), IC::MutableNode*>);
static_assert(std::is_same_v<decltype(OpenInterface::userNodes_), std::vector<IC::Node*>>);
static_assert(std::is_same_v<decltype(OpenInterface::groupNodes_), std::vector<IC::Node*>>);
static_assert(std::is_same_v<decltype(OpenInterface::logEntryNodes_), std::vector<IC::Node*>>);

TEST(HostLayout, KeepsTheInterfacesMembersInOrder)
{
    std::vector<std::ptrdiff_t> const offsets = offsetsIn(OpenInterface());
    EXPECT_EQ(offsets.front(), static_cast<std::ptrdiff_t>(sizeof(void*)));
    EXPECT_EQ(std::adjacent_find(offsets.begin(), offsets.end(), std::greater_equal<>()),
              offsets.end());
}

/** The symbols that the library defines, as the linker sees them. */
std::string definedSymbols()
{
    FILE* const stream =
        interpose::real(popen)("nm --dynamic --demangle --defined-only " PLUGIN_FILE, "r");
    std::string symbols;
    char line[4096];
    while (std::fgets(line, sizeof line, stream))
        symbols += line;
    interpose::real(pclose)(stream);
    return symbols;
}

TEST(HostLayout, LeavesTablesOfHostClassesToTheHost)
{
    std::string const symbols = definedSymbols();
    ASSERT_NE(symbols.find(" vtable for IC::OsNode\n"), std::string::npos);
    for (char const* type :
         {"IC::ManagementInterface", "IC::Node", "IC::MutableNode", "IC::PropertyValue",
          "IC::Number", "IC::EnumValue", "IC::Error", "IC::Alert", "NQ::Mutex"})
        for (char const* of : {"vtable for ", "typeinfo for ", "typeinfo name for "})
            EXPECT_EQ(symbols.find(std::string(" ") + of + type + "\n"), std::string::npos)
                << of << type;
}

template <class Expected, class Actual> constexpr bool is(Actual)
{
    return std::is_same_v<Expected, Actual>;
}

// Return types, which are not part of a symbol.
static_assert(is<void (*)(std::vector<NQ::driverInfo>&)>(&NQ::getDriverInfo));
static_assert(is<unsigned int (NQ::logInfo::*)()>(&NQ::logInfo::getMaxLine));
static_assert(is<void (NQ::logInfo::*)(unsigned int, char*, int)>(&NQ::logInfo::getLog));
static_assert(is<bool (NQ::logInfo::*)(std::string&, unsigned int)>(&NQ::logInfo::getData));
static_assert(is<bool (NQ::logInfo::*)(long&, unsigned int)>(&NQ::logInfo::getCreationTime));
static_assert(is<bool (NQ::logInfo::*)()>(&NQ::logInfo::clearLog));
static_assert(is<void (NQ::logInfo::*)(char*, char, char)>(&NQ::logInfo::strreplace));
static_assert(is<FILE* (NQ::MyProcess::*)(char const*, char const*)>(&NQ::MyProcess::mypopen));
static_assert(is<char* (*)(char*, char)>(&NQ::strget));
static_assert(is<time_t (*)(int, char*, int, int, int, int, int, int)>(&NQ::to_time_t));
static_assert(is<time_t (*)(int, int, int, int, int, int, int, int)>(&NQ::ito_time_t));
static_assert(is<int (NQ::OsInfo::*)(std::string, std::string&, std::vector<NQ::ParamInfo>&)>(
    &NQ::OsInfo::parseMethodAndParams));
static_assert(is<int (NQ::OsInfo::*)(std::string, std::vector<NQ::ParamInfo>, bool&)>(
    &NQ::OsInfo::executeMethod));
static_assert(is<int (NQ::OsInfo::*)(char*, char**, char*)>(&NQ::OsInfo::executeCommand));
static_assert(is<void (NQ::OsInfo::*)(char*, char*)>(&NQ::OsInfo::executePasswordEncryption));
static_assert(is<bool (NQ::OsInfo::*)(std::string, std::vector<NQ::ParamInfo>)>(
    &NQ::OsInfo::groupMemberChanges));
static_assert(is<void (NQ::OsInfo::*)(std::string&)>(&NQ::OsInfo::trimString));
static_assert(is<void (NQ::OsInfo::*)(char*, char, char)>(&NQ::OsInfo::strreplace));
static_assert(
    is<void (*)(std::string const&, std::vector<std::string>&, std::string const&)>(&NQ::Tokenize));
static_assert(is<void (IC::OsSwMI::*)(IC::Node*)>(&IC::OsSwMI::publishNode));
static_assert(is<void (IC::OsSwMI::*)()>(&IC::OsSwMI::createDriverNodes));
static_assert(is<void (IC::OsSwMI::*)()>(&IC::OsSwMI::createLogNodes));
static_assert(is<void (IC::OsSwMI::*)(bool)>(&IC::OsSwMI::createLogEntryNodes));

} // namespace host_layout_test
