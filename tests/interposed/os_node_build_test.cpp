#include "tests/interposed/StandIns.h"
#include "tests/support/Frame.h"
#include "tests/support/Recording.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>
#include <map>
#include <string>
#include <utility>
#include <vector>

namespace
{

using IC::Error;
using IC::Node;
using IC::PropertyValue;

/** An interface that has built the fixed nodes. */
class Interface : public Frame
{
public:
    Interface()
    {
        createOsSwNodes();
        createRootNode();
        createComputerNodes();
    }
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

    /** The stored value, even of a live property. */
    std::string stored(unsigned int id)
    {
        return storedValue(*interface_.osNode_, id);
    }

    Interface interface_;
};

TEST_F(OsNodeBuild, TakesTheNextNodeIdBelowTheComputer)
{
    unsigned int const id = interface_.nextNodeId_;
    std::size_t const noted = interface_.nodeIds_->size();
    build();
    EXPECT_EQ(interface_.osNode_->getNodeId(), id);
    EXPECT_EQ(interface_.nextNodeId_, id + 1);
    EXPECT_EQ(interface_.nodeIds_->back(), id);
    EXPECT_EQ(interface_.nodeIds_->size(), noted + 1);
    EXPECT_EQ(interface_.osNode_->getLinkedId(), interface_.computerNode_->getNodeId());
    EXPECT_EQ(interface_.osNode_->getMIIds(), interface_.miIds_);
    EXPECT_EQ(interface_.osNode_->getNodeType(), 17U);
    EXPECT_EQ(interface_.osNode_->getIndex(), 0U);
}

TEST_F(OsNodeBuild, MakesTheNodeTheCurrentOneAndListsItOnce)
{
    std::size_t const listed = interface_.nodes_.size();
    build();
    EXPECT_EQ(interface_.currentNode_, interface_.osNode_);
    EXPECT_EQ(interface_.nodes_.back(), interface_.osNode_);
    EXPECT_EQ(interface_.nodes_.size(), listed + 1);
    EXPECT_TRUE(interface_.published.empty());
    EXPECT_EQ(interface_.osNode_->getStatus(), 1U);
    EXPECT_EQ(interface_.osNode_->getDescription(), "Operating System");
}

TEST_F(OsNodeBuild, StoresEveryProperty)
{
    std::map<unsigned int, std::string> const expected{
        {74, "text dummy true"},        {75, "number 1 true"},
        {108, "text Kesto Linux true"}, {123, "enumeration 1 false"},
        {125, "numbers 0,1,24 true"},   {128, "enumeration 35 true"},
        {134, "text 10.2 true"},        {139, "date 1230767999 true"},
        {140, "boolean false true"},    {141, "date 1273659825 true"},
        {142, "number 142 true"},       {143, "number 143 true"},
        {144, "number 1440 true"},      {145, "number 145 true"},
        {146, "number 146 true"},       {147, "number 147 true"},
        {148, "number 148 true"},       {149, "number 1490 true"},
        {150, "number 1500 true"},      {151, "number 1510 true"},
        {152, "number 1520 true"},      {153, "number 1530 true"},
        {154, "text UTF-8 true"},       {155, "text en-US true"}};
    std::map<unsigned int, std::string> properties;
    for (auto const& [id, value] : build().getProperties())
        properties[id] = shown(value);
    EXPECT_EQ(properties, expected);
}

TEST_F(OsNodeBuild, StoresTheDistributedFlagAsATruthValue)
{
    standIns().numbers["getDistributed"] = 1;
    build();
    EXPECT_EQ(stored(140), "boolean true true");
}

TEST_F(OsNodeBuild, ReadsAndStoresInAFixedOrder)
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

TEST_F(OsNodeBuild, LeavesThePropertyOfAnUnknownFactUnset)
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
        EXPECT_EQ(stored(fact.id), "unset") << fact.getter;
        EXPECT_EQ(interface_.osNode_->getProperties().size(), 24U - standIns().failing.size())
            << fact.getter;
        EXPECT_TRUE(log.remarks().empty());
    }
}

TEST_F(OsNodeBuild, StoresTheProcessCountForUnknownFreeMemory)
{
    standIns().failing = {"getPhysicalMemoryFree"};
    build();
    EXPECT_EQ(stored(149), "number 1440 true");
    EXPECT_EQ(stored(150), "number 1500 true");
}

TEST_F(OsNodeBuild, StoresThePreviousFigureForUnreadableOnes)
{
    standIns().failing = {"getSwapFileSize", "getSwapFileFree", "getSwapFileSizeStored"};
    build();
    EXPECT_EQ(stored(151), "number 1500 true");
    EXPECT_EQ(stored(153), "number 1500 true");
    EXPECT_EQ(stored(152), "number 1500 true");
}

TEST_F(OsNodeBuild, StoresAnEmptyValueForAnUnreadableFirstFigure)
{
    standIns().failing = {"getProcessCount"};
    build();
    EXPECT_EQ(stored(144), "empty  true");
    EXPECT_EQ(stored(149), "number 1490 true");
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

TEST_F(OsNodeBuild, GivesItsTwoTimesNoSubSeconds)
{
    build();
    std::vector<std::pair<long, unsigned short>> const expected{{1273659825, 0}, {1230767999, 0}};
    EXPECT_EQ(standIns().dates, expected);
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
    useZone("CET-1CEST,M3.5.0,M10.5.0/3");
    Recording const log;
    build();
    EXPECT_TRUE(log.has("LastBootTime = Wed May 12 12:23:45 2010\n", 3000));
    EXPECT_EQ(stored(141), "date 1273659825 true");
}

/** Records messages in order with the lives of the fact readers. */
class MessagesAmongLives : public mihost::LogSink
{
public:
    MessagesAmongLives()
    {
        standIns().lives.clear();
        mihost::setLogSink(this);
    }
    ~MessagesAmongLives() override
    {
        mihost::setLogSink(nullptr);
    }

    void write(mihost::LogMessage const& message) override
    {
        if (message.operation == mihost::LogMessage::Operation::Log)
            standIns().lives.push_back(message.text);
    }
};

TEST_F(OsNodeBuild, DestroysItsFactReaderBeforeLoggingItsExit)
{
    MessagesAmongLives const noting;
    build();
    std::vector<std::string> const& lives = standIns().lives;
    // One more than its 24 writes and its 6 reads make for themselves.
    EXPECT_EQ(std::count(lives.begin(), lives.end(), "OsInfo made"), 24 + 6 + 1);
    EXPECT_EQ(std::count(lives.begin(), lives.end(), "OsInfo gone"), 24 + 6 + 1);
    ASSERT_GE(lives.size(), 2U);
    EXPECT_EQ(lives[lives.size() - 2], "OsInfo gone");
    EXPECT_EQ(lives.back(), "createOsNodes: exit");
}

class OsNodeRead : public OsNodeBuild
{
protected:
    OsNodeRead() : node_(build())
    {
        standIns().calls.clear();
    }

    /** The caller's value after a read; it was "before". */
    std::string read(unsigned int id)
    {
        PropertyValue value("before", false);
        EXPECT_EQ(static_cast<std::string>(node_.getProperty(id, value)), "status 0");
        return shown(value);
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

TEST_F(OsNodeRead, ReadsALiveFigureEachTime)
{
    for (Live const& live : liveProperties) {
        standIns().calls.clear();
        for (unsigned int const figure : {0U, 17U, 0xFFFFFFFFU}) {
            standIns().numbers[live.getter] = figure;
            EXPECT_EQ(read(live.id), "number " + std::to_string(figure) + " true") << live.getter;
        }
        EXPECT_EQ(standIns().calls, std::vector<std::string>(3, live.getter));
    }
}

TEST_F(OsNodeRead, DoesNotStoreALiveFigure)
{
    standIns().numbers["getProcessCount"] = 17;
    read(144);
    EXPECT_EQ(stored(144), "number 1440 true");
}

TEST_F(OsNodeRead, IgnoresTheStoredValueOfALiveFigure)
{
    EXPECT_EQ(node_.setProperty(144, PropertyValue("stored", true)).getStatus(), 0U);
    EXPECT_EQ(read(144), "number 1440 true");
    EXPECT_EQ(stored(144), "text stored true");
}

TEST_F(OsNodeRead, KeepsTheCallersValueForAnUnreadableFigure)
{
    for (Live const& live : liveProperties) {
        standIns().failing = {live.getter};
        EXPECT_EQ(read(live.id), "text before false") << live.getter;
    }
}

TEST_F(OsNodeRead, ReadsTheClearCommandAsZeroWhateverWasStored)
{
    EXPECT_EQ(stored(191), "unset");
    for (unsigned int const written : {9U, 1U}) {
        interface_.osNode_->IC::MutableNode::setProperty(191, {IC::Number(written), true});
        EXPECT_EQ(read(191), "number 0 true");
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
        EXPECT_EQ(read(id), shown(value)) << id;
        EXPECT_TRUE(standIns().calls.empty()) << id;
    }
}

TEST_F(OsNodeRead, AnswersTheRequestedStateAsWritten)
{
    EXPECT_EQ(read(123), "enumeration 1 false");
    node_.setProperty(123, PropertyValue(IC::EnumValue(5U), true));
    EXPECT_EQ(read(123), "enumeration 5 true");
}

TEST_F(OsNodeRead, ReturnsTheFrameworksErrorForAnUnknownProperty)
{
    PropertyValue value("before", false);
    Error const error = node_.getProperty(4711, value);
    Error const framework = interface_.osNode_->IC::MutableNode::getProperty(4711, value);
    EXPECT_NE(error.getStatus(), 0U);
    EXPECT_EQ(static_cast<std::string>(error), static_cast<std::string>(framework));
    EXPECT_EQ(static_cast<std::string>(value), "before");
}

TEST_F(OsNodeRead, MakesOneFactReaderForEachRead)
{
    for (unsigned int const id : {144U, 153U, 191U, 108U, 74U, 4711U}) {
        MessagesAmongLives const noting;
        PropertyValue value("", true);
        node_.getProperty(id, value);
        EXPECT_EQ(standIns().lives,
                  (std::vector<std::string>{"OsNode::getProperty: entry", "OsInfo made",
                                            "OsInfo gone", "OsNode::getProperty: exit"}))
            << id;
    }
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

TEST_F(OsNodeBuild, MakesOnlyTheDummyTextOfALiteral)
{
    standIns().literals.clear();
    build();
    EXPECT_EQ(standIns().literals, std::vector<std::string>{"dummy"});
}

} // namespace
