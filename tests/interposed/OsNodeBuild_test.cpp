#include "frame/OsSwMI.h"

#include "tests/interposed/StandIns.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>
#include <string>
#include <vector>

namespace
{

using IC::Error;
using IC::Node;
using IC::PropertyValue;

/** An interface that builds the fixed nodes and, when asked to, the operating system's. */
class Interface : public IC::OsSwMI
{
public:
    Interface()
    {
        nodeIds_ = new std::vector<unsigned int>;
        ManagementInterface::initialize(7, IC::Number(0U), IC::Number(0U));
        createOsSwNodes();
        createRootNode();
        createComputerNodes();
    }

    ~Interface() override
    {
        unload();
    }

    using OsSwMI::computerNode_;
    using OsSwMI::currentNode_;
    using OsSwMI::miIds_;
    using OsSwMI::nextNodeId_;
    using OsSwMI::nodeIds_;
    using OsSwMI::nodes_;
    using OsSwMI::osNode_;
};

class OsNodeBuild : public testing::Test
{
protected:
    OsNodeBuild()
    {
        setenv("TZ", "UTC0", 1);
        standIns() = {};
        standIns().texts = {{"getOSName", "Kesto Linux"},
                            {"getOSVersion", "10.2"},
                            {"getLanguageEdition", "en-US"},
                            {"getCodeSet", "UTF-8"}};
        standIns().numbers = {{"getProcessMaxNumber", 142},    {"getProcessMaxMemory", 143},
                              {"getUserCount", 145},           {"getLicensedUserCount", 146},
                              {"getVirtualMemorySize", 147},   {"getVirtualMemoryFree", 148},
                              {"getProcessCount", 1440},       {"getPhysicalMemoryFree", 1490},
                              {"getPhysicalMemorySize", 1500}, {"getSwapFileSize", 1510},
                              {"getSwapFileFree", 1530},       {"getSwapFileSizeStored", 1520}};
        standIns().times = {{"getLastBootTime", 1273659825}, {"getInstallDate", 1230767999}};
    }

    Node& build()
    {
        interface_.createOsNodes();
        return *interface_.osNode_;
    }

    /** What is stored, whatever a live read would answer. */
    PropertyValue stored(unsigned int id)
    {
        auto const properties = interface_.osNode_->getProperties();
        auto const found = properties.find(id);
        return found == properties.end() ? PropertyValue("not set", false) : found->second;
    }

    bool isSet(unsigned int id)
    {
        return interface_.osNode_->getProperties().count(id) != 0;
    }

    Interface interface_;
};

TEST_F(OsNodeBuild, TakesTheNextNodeIdBelowTheComputer)
{
    unsigned int const id = interface_.nextNodeId_;
    build();
    EXPECT_EQ(interface_.osNode_->getNodeId(), id);
    EXPECT_EQ(interface_.nextNodeId_, id + 1);
    EXPECT_EQ(interface_.nodeIds_->back(), id);
    EXPECT_EQ(interface_.nodeIds_->size(), 5U);
    EXPECT_EQ(interface_.osNode_->getLinkedId(), interface_.computerNode_->getNodeId());
    EXPECT_EQ(interface_.osNode_->getMIIds(), interface_.miIds_);
    EXPECT_EQ(interface_.osNode_->getNodeType(), 17U);
    EXPECT_EQ(interface_.osNode_->getIndex(), 0U);
}

TEST_F(OsNodeBuild, MakesTheNodeTheCurrentOneAndListsIt)
{
    build();
    EXPECT_EQ(interface_.currentNode_, interface_.osNode_);
    EXPECT_EQ(interface_.nodes_.back(), interface_.osNode_);
    EXPECT_EQ(interface_.nodes_.size(), 4U);
    EXPECT_EQ(interface_.osNode_->getStatus(), 1U);
    EXPECT_EQ(interface_.osNode_->getDescription(), "Operating System");
}

struct Row {
    unsigned int id;
    PropertyValue::KindType kind;
    char const* text;
    bool flag;
};

TEST_F(OsNodeBuild, StoresEveryProperty)
{
    using Value = PropertyValue;
    Row const rows[] = {{74, Value::TextKind, "dummy", true},
                        {75, Value::NumberKind, "1", true},
                        {108, Value::TextKind, "Kesto Linux", true},
                        {123, Value::EnumerationKind, "1", false},
                        {125, Value::NumbersKind, "0,1,24", true},
                        {128, Value::EnumerationKind, "35", true},
                        {134, Value::TextKind, "10.2", true},
                        {139, Value::DateKind, "2008-12-31 23:59:59", true},
                        {140, Value::BooleanKind, "false", true},
                        {141, Value::DateKind, "2010-05-12 10:23:45", true},
                        {142, Value::NumberKind, "142", true},
                        {143, Value::NumberKind, "143", true},
                        {144, Value::NumberKind, "1440", true},
                        {145, Value::NumberKind, "145", true},
                        {146, Value::NumberKind, "146", true},
                        {147, Value::NumberKind, "147", true},
                        {148, Value::NumberKind, "148", true},
                        {149, Value::NumberKind, "1490", true},
                        {150, Value::NumberKind, "1500", true},
                        {151, Value::NumberKind, "1510", true},
                        {152, Value::NumberKind, "1520", true},
                        {153, Value::NumberKind, "1530", true},
                        {154, Value::TextKind, "UTF-8", true},
                        {155, Value::TextKind, "en-US", true}};
    build();
    for (Row const& row : rows) {
        PropertyValue const value = stored(row.id);
        EXPECT_EQ(value.getKind(), row.kind) << row.id;
        EXPECT_EQ(static_cast<std::string>(value), row.text) << row.id;
        EXPECT_EQ(value.getFlag(), row.flag) << row.id;
    }
    EXPECT_EQ(interface_.osNode_->getProperties().size(), std::size(rows));
}

TEST_F(OsNodeBuild, StoresTheDistributedFlagAsATruthValue)
{
    standIns().numbers["getDistributed"] = 1;
    build();
    EXPECT_EQ(static_cast<std::string>(stored(140)), "true");
}

TEST_F(OsNodeBuild, AsksAndStoresInAFixedOrder)
{
    standIns().calls.clear();
    build();
    EXPECT_EQ(standIns().calls, (std::vector<std::string>{"set 128", "set 123",
                                                          "set 125", "getOSName",
                                                          "set 108", "getOSVersion",
                                                          "set 134", "set 74",
                                                          "set 75",  "getDistributed",
                                                          "set 140", "getProcessMaxNumber",
                                                          "set 142", "getProcessMaxMemory",
                                                          "set 143", "getUserCount",
                                                          "set 145", "getLicensedUserCount",
                                                          "set 146", "getVirtualMemorySize",
                                                          "set 147", "getVirtualMemoryFree",
                                                          "set 148", "getLanguageEdition",
                                                          "set 155", "getCodeSet",
                                                          "set 154", "getProcessCount",
                                                          "set 144", "getPhysicalMemoryFree",
                                                          "set 149", "getPhysicalMemorySize",
                                                          "set 150", "getSwapFileSize",
                                                          "set 151", "getSwapFileFree",
                                                          "set 153", "getSwapFileSizeStored",
                                                          "set 152", "getLastBootTime",
                                                          "set 141", "getInstallDate",
                                                          "set 139"}));
}

TEST_F(OsNodeBuild, LeavesAPropertyUnsetWithoutAMessageWhenItsFactCannotBeHad)
{
    struct {
        char const* getter;
        unsigned int id;
    } const facts[] = {{"getOSName", 108},
                       {"getOSVersion", 134},
                       {"getDistributed", 140},
                       {"getProcessMaxNumber", 142},
                       {"getProcessMaxMemory", 143},
                       {"getUserCount", 145},
                       {"getLicensedUserCount", 146},
                       {"getVirtualMemorySize", 147},
                       {"getVirtualMemoryFree", 148},
                       {"getLanguageEdition", 155},
                       {"getCodeSet", 154},
                       {"getLastBootTime", 141},
                       {"getInstallDate", 139}};
    for (auto const& fact : facts) {
        standIns().failing = {fact.getter, "getLastBootTime", "getInstallDate"};
        Recording const log;
        build();
        EXPECT_FALSE(isSet(fact.id)) << fact.getter;
        EXPECT_EQ(interface_.osNode_->getProperties().size(), 24U - standIns().failing.size())
            << fact.getter;
        EXPECT_TRUE(log.remarks().empty());
    }
}

TEST_F(OsNodeBuild, StoresTheProcessCountAsFreeMemoryWhenFreeMemoryCannotBeHad)
{
    standIns().failing = {"getPhysicalMemoryFree"};
    build();
    EXPECT_EQ(stored(149).getKind(), PropertyValue::NumberKind);
    EXPECT_EQ(stored(149).getNumber(), 1440);
    EXPECT_EQ(stored(150).getNumber(), 1500);
}

TEST_F(OsNodeBuild, CarriesAFigureOverEveryOneThatCannotBeHad)
{
    standIns().failing = {"getSwapFileSize", "getSwapFileFree", "getSwapFileSizeStored"};
    build();
    EXPECT_EQ(stored(151).getNumber(), 1500);
    EXPECT_EQ(stored(153).getNumber(), 1500);
    EXPECT_EQ(stored(152).getNumber(), 1500);
}

TEST_F(OsNodeBuild, StoresAnEmptyValueWhenTheFirstFigureCannotBeHad)
{
    standIns().failing = {"getProcessCount"};
    build();
    EXPECT_EQ(stored(144).getKind(), PropertyValue::EmptyKind);
    EXPECT_TRUE(stored(144).getFlag());
    EXPECT_EQ(stored(149).getNumber(), 1490);
}

TEST_F(OsNodeBuild, SeedsWithTheNodesOwnReads)
{
    Recording const log;
    build();
    std::vector<std::string> const texts = log.texts();
    EXPECT_EQ(std::count(texts.begin(), texts.end(), "OsNode::getProperty: entry"), 6);
    EXPECT_EQ(std::count(texts.begin(), texts.end(), "OsNode::getProperty: exit"), 6);
    EXPECT_EQ(std::count(texts.begin(), texts.end(), "OsNode::setProperty: entry"), 24);
    EXPECT_EQ(std::count(texts.begin(), texts.end(), "OsNode::setProperty: exit"), 24);
}

TEST_F(OsNodeBuild, LogsItsEntryItsExitAndTheTwoTimes)
{
    Recording const log;
    build();
    EXPECT_EQ(log.texts().front(), "createOsNodes: entry");
    EXPECT_EQ(log.texts().back(), "createOsNodes: exit");
    EXPECT_TRUE(log.has("LastBootTime = Wed May 12 10:23:45 2010\n", 3000));
    EXPECT_TRUE(log.has("InstallDate = Wed Dec 31 23:59:59 2008\n", 3000));
    for (LogRecord const& record : log.records()) {
        EXPECT_EQ(record.category, "Veltrix.IC.MI.OsSwMI");
        EXPECT_EQ(record.file, "OsSwMI");
        if (record.text.find(" = ") != std::string::npos) {
            EXPECT_EQ(record.function, "createOsNodes");
        }
    }
}

TEST_F(OsNodeBuild, LogsEachTimeRightAfterItIsStored)
{
    Recording const log;
    build();
    std::vector<std::string> const texts = log.texts();
    std::vector<std::string> const end(texts.end() - 7, texts.end());
    EXPECT_EQ(end, (std::vector<std::string>{
                       "OsNode::setProperty: entry", "OsNode::setProperty: exit",
                       "LastBootTime = Wed May 12 10:23:45 2010\n", "OsNode::setProperty: entry",
                       "OsNode::setProperty: exit", "InstallDate = Wed Dec 31 23:59:59 2008\n",
                       "createOsNodes: exit"}));
}

TEST_F(OsNodeBuild, WritesTheTimesInLocalTime)
{
    setenv("TZ", "CET-1CEST,M3.5.0,M10.5.0/3", 1);
    tzset();
    Recording const log;
    build();
    EXPECT_TRUE(log.has("LastBootTime = Wed May 12 12:23:45 2010\n", 3000));
    EXPECT_EQ(stored(141).getNumber(), 1273659825);
}

class OsNodeRead : public OsNodeBuild
{
protected:
    OsNodeRead() : node_(build())
    {
        standIns().calls.clear();
    }

    /** The value that a read leaves behind, by a caller whose value said "before". */
    PropertyValue read(unsigned int id)
    {
        PropertyValue value("before", false);
        Error const error = node_.getProperty(id, value);
        EXPECT_EQ(error.getStatus(), 0U);
        EXPECT_EQ(static_cast<std::string>(error),
                  static_cast<std::string>(Error(0, IC::Number(IC::Number::EmptyKind), "")));
        return value;
    }

    Node& node_;
};

struct Live {
    unsigned int id;
    char const* getter;
};

constexpr Live liveProperties[] = {{144, "getProcessCount"},       {149, "getPhysicalMemoryFree"},
                                   {150, "getPhysicalMemorySize"}, {151, "getSwapFileSize"},
                                   {152, "getSwapFileSizeStored"}, {153, "getSwapFileFree"}};

TEST_F(OsNodeRead, AsksAfreshForEveryLiveFigure)
{
    for (Live const& live : liveProperties) {
        standIns().calls.clear();
        for (unsigned int const figure : {0U, 17U, 0xFFFFFFFFU}) {
            standIns().numbers[live.getter] = figure;
            PropertyValue const value = read(live.id);
            EXPECT_EQ(value.getKind(), PropertyValue::NumberKind) << live.getter;
            EXPECT_EQ(value.getNumber(), figure) << live.getter;
            EXPECT_TRUE(value.getFlag()) << live.getter;
        }
        EXPECT_EQ(standIns().calls, std::vector<std::string>(3, live.getter));
    }
}

TEST_F(OsNodeRead, DoesNotStoreALiveFigure)
{
    standIns().numbers["getProcessCount"] = 17;
    read(144);
    EXPECT_EQ(stored(144).getNumber(), 1440);
}

TEST_F(OsNodeRead, AnswersALiveFigureWhateverWasStoredInItsPlace)
{
    EXPECT_EQ(node_.setProperty(144, PropertyValue("stored", true)).getStatus(), 0U);
    EXPECT_EQ(read(144).getNumber(), 1440);
    EXPECT_EQ(static_cast<std::string>(stored(144)), "stored");
}

TEST_F(OsNodeRead, SucceedsAndLeavesTheCallersValueWhenALiveFigureCannotBeHad)
{
    for (Live const& live : liveProperties) {
        standIns().failing = {live.getter};
        PropertyValue const value = read(live.id);
        EXPECT_EQ(static_cast<std::string>(value), "before") << live.getter;
        EXPECT_FALSE(value.getFlag()) << live.getter;
    }
}

TEST_F(OsNodeRead, AnswersZeroForTheClearCommandWhateverWasStored)
{
    EXPECT_FALSE(isSet(191));
    for (unsigned int const written : {9U, 1U}) {
        interface_.osNode_->IC::MutableNode::setProperty(191, {IC::Number(written), true});
        PropertyValue const value = read(191);
        EXPECT_EQ(value.getKind(), PropertyValue::NumberKind);
        EXPECT_EQ(value.getNumber(), 0);
        EXPECT_TRUE(value.getFlag());
    }
}

TEST_F(OsNodeRead, AnswersEveryOtherPropertyFromTheStore)
{
    for (auto const& [id, value] : node_.getProperties()) {
        bool live = false;
        for (Live const& property : liveProperties)
            live = live || property.id == id;
        if (live)
            continue;
        standIns().calls.clear();
        PropertyValue const answer = read(id);
        EXPECT_EQ(answer.getKind(), value.getKind()) << id;
        EXPECT_EQ(answer.getFlag(), value.getFlag()) << id;
        EXPECT_EQ(static_cast<std::string>(answer), static_cast<std::string>(value)) << id;
        EXPECT_TRUE(standIns().calls.empty()) << id;
    }
}

TEST_F(OsNodeRead, AnswersTheRequestedStateAsWritten)
{
    EXPECT_EQ(static_cast<unsigned int>(read(123)), 1U);
    node_.setProperty(123, PropertyValue(IC::EnumValue(5U), true));
    EXPECT_EQ(static_cast<unsigned int>(read(123)), 5U);
    EXPECT_TRUE(read(123).getFlag());
}

TEST_F(OsNodeRead, HandsBackTheFrameworksErrorForAnUnknownProperty)
{
    PropertyValue value("before", false);
    Error const error = node_.getProperty(4711, value);
    Error const framework = interface_.osNode_->IC::MutableNode::getProperty(4711, value);
    EXPECT_NE(error.getStatus(), 0U);
    EXPECT_EQ(static_cast<std::string>(error), static_cast<std::string>(framework));
    EXPECT_EQ(static_cast<std::string>(value), "before");
}

TEST_F(OsNodeRead, LogsItsEntryAndExitUnderTheClassName)
{
    for (unsigned int const id : {144U, 191U, 108U, 4711U}) {
        Recording const log;
        PropertyValue value("", true);
        node_.getProperty(id, value);
        EXPECT_EQ(log.texts(3000), (std::vector<std::string>{"OsNode::getProperty: entry",
                                                             "OsNode::getProperty: exit"}));
        for (LogRecord const& record : log.records())
            EXPECT_EQ(record.function, "getProperty");
    }
}

} // namespace
