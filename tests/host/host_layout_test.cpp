// What a plug-in built against these headers relies on in memory.

#include "TestPaths.h"
#include "frame/OsSwMI.h"
#include "nodes/GroupNode.h"
#include "nodes/LogEntryNode.h"
#include "nodes/OsNode.h"
#include "nodes/UserNode.h"

#include "sysdata/driverInfo_linux.h"
#include "sysdata/logInfo_linux.h"
#include "tests/support/Libc.h"
#include "util/MyProcess.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <functional>
#include <string>
#include <type_traits>
#include <utility>
#include <vector>

namespace
{

TEST(HostLayout, GivesNodeClassesNoMembersOfTheirOwn)
{
    EXPECT_EQ(sizeof(IC::OsNode), sizeof(IC::MutableNode));
    EXPECT_EQ(sizeof(IC::UserNode), sizeof(IC::MutableNode));
    EXPECT_EQ(sizeof(IC::GroupNode), sizeof(IC::MutableNode));
    EXPECT_EQ(sizeof(IC::LogEntryNode), sizeof(IC::MutableNode));
}

class Frame : public IC::OsSwMI
{
public:
    /** Where the interface's members stand in it, in the order in which they are to stand. */
    std::vector<std::ptrdiff_t> offsets() const
    {
        return {offset(nextNodeId_),     offset(miId_),         offset(nodes_),
                offset(miIds_),          offset(loadCallBack_), offset(loadCallBackContext_),
                offset(lookupCallBack_), offset(currentNode_),  offset(nodeIds_),
                offset(osSwNode_),       offset(rootNode_),     offset(computerNode_),
                offset(osNode_),         offset(logNode_),      offset(userNodes_),
                offset(groupNodes_),     offset(logEntryNodes_)};
    }

    static_assert(std::is_same_v<decltype(nextNodeId_), unsigned int>);
    static_assert(std::is_same_v<decltype(miId_), unsigned int>);
    static_assert(std::is_same_v<decltype(nodes_), std::vector<IC::Node*>>);
    static_assert(std::is_same_v<decltype(miIds_), std::vector<unsigned int>>);
    static_assert(
        std::is_same_v<decltype(loadCallBack_), IC::Error (*)(IC::Node* const&, void const*)>);
    static_assert(std::is_same_v<decltype(loadCallBackContext_), void const*>);
    static_assert(
        std::is_same_v<decltype(lookupCallBack_), IC::Error (*)(std::string const&, IC::Node**)>);
    static_assert(std::is_same_v<decltype(currentNode_), IC::MutableNode*>);
    static_assert(std::is_same_v<decltype(nodeIds_), std::vector<unsigned int>*>);
    static_assert(std::is_same_v<decltype(osSwNode_), IC::MutableNode*>);
    static_assert(std::is_same_v<decltype(rootNode_), IC::MutableNode*>);
    static_assert(std::is_same_v<decltype(computerNode_), IC::MutableNode*>);
    static_assert(std::is_same_v<decltype(osNode_), IC::MutableNode*>);
    static_assert(std::is_same_v<decltype(logNode_), IC::MutableNode*>);
    static_assert(std::is_same_v<decltype(userNodes_), std::vector<IC::Node*>>);
    static_assert(std::is_same_v<decltype(groupNodes_), std::vector<IC::Node*>>);
    static_assert(std::is_same_v<decltype(logEntryNodes_), std::vector<IC::Node*>>);

private:
    template <class Member> std::ptrdiff_t offset(Member const& member) const
    {
        return reinterpret_cast<char const*>(&member) - reinterpret_cast<char const*>(this);
    }
};

TEST(HostLayout, KeepsTheInterfacesMembersInOrderFromTheVirtualTableOn)
{
    Frame const frame;
    std::vector<std::ptrdiff_t> const offsets = frame.offsets();
    EXPECT_EQ(offsets.front(), static_cast<std::ptrdiff_t>(sizeof(void*)));
    EXPECT_EQ(std::adjacent_find(offsets.begin(), offsets.end(), std::greater_equal<>()),
              offsets.end());
}

/** The symbols that the library defines, as the linker sees them. */
std::string definedSymbols()
{
    FILE* const stream = libc::realPopen("nm --dynamic --defined-only " PLUGIN_FILE, "r");
    std::string symbols;
    char line[4096];
    while (std::fgets(line, sizeof line, stream))
        symbols += line;
    libc::realPclose(stream);
    return symbols;
}

TEST(HostLayout, LeavesTablesAndTypeInformationOfHostClassesToTheHost)
{
    std::string const symbols = definedSymbols();
    ASSERT_NE(symbols.find(" _ZTVN2IC6OsNodeE\n"), std::string::npos);
    for (char const* type :
         {"N2IC19ManagementInterfaceE", "N2IC4NodeE", "N2IC11MutableNodeE", "N2IC13PropertyValueE",
          "N2IC6NumberE", "N2IC9EnumValueE", "N2IC5ErrorE", "N2IC5AlertE", "N2NQ5MutexE"})
        for (char const* of : {"_ZTV", "_ZTI", "_ZTS"})
            EXPECT_EQ(symbols.find(std::string(" ") + of + type + "\n"), std::string::npos)
                << of << type;
}

template <class Expected, class Actual> constexpr bool is(Actual)
{
    return std::is_same_v<Expected, Actual>;
}

// What symbols do not tell.
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
static_assert(is<void (IC::OsSwMI::*)()>(&IC::OsSwMI::createDriverNodes));
static_assert(is<void (IC::OsSwMI::*)()>(&IC::OsSwMI::createLogNodes));
static_assert(is<void (IC::OsSwMI::*)(bool)>(&IC::OsSwMI::createLogEntryNodes));

} // namespace
