#include "tests/interposed/StandIns.h"
#include "tests/support/Frame.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>
#include <iterator>
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

/** A property, the operation that yields its value (or none), and the value stored. */
struct Fact {
    unsigned int id;
    std::string getter;
    char const* stored;
    bool isLive = false; // read again at each read of the property
};

// In the order in which they are stored.
Fact const facts[] = {{128, "", "enumeration 35 true"},
                      {123, "", "enumeration 1 false"},
                      {125, "", "numbers 0,1,24 true"},
                      {108, "getOSName", "text Kesto Linux true"},
                      {134, "getOSVersion", "text 10.2 true"},
                      {74, "", "text dummy true"},
                      {75, "", "number 1 true"},
                      {140, "getDistributed", "boolean false true"},
                      {142, "getProcessMaxNumber", "number 142 true"},
                      {143, "getProcessMaxMemory", "number 143 true"},
                      {145, "getUserCount", "number 145 true"},
                      {146, "getLicensedUserCount", "number 146 true"},
                      {147, "getVirtualMemorySize", "number 147 true"},
                      {148, "getVirtualMemoryFree", "number 148 true"},
                      {155, "getLanguageEdition", "text en-US true"},
                      {154, "getCodeSet", "text UTF-8 true"},
                      {144, "getProcessCount", "number 1440 true", true},
                      {149, "getPhysicalMemoryFree", "number 1490 true", true},
                      {150, "getPhysicalMemorySize", "number 1500 true", true},
                      {151, "getSwapFileSize", "number 1510 true", true},
                      {153, "getSwapFileFree", "number 1530 true", true},
                      {152, "getSwapFileSizeStored", "number 1520 true", true},
                      {141, "getLastBootTime", "date 1273659825 true"},
                      {139, "getInstallDate", "date 1230767999 true"}};

TEST_F(OsNodeBuild, ReadsAndStoresEveryPropertyInAFixedOrder)
{
    standIns().calls.clear();
    build();
    EXPECT_EQ(interface_.osNode_->getProperties().size(), std::size(facts));
    Lines calls;
    for (Fact const& fact : facts) {
        EXPECT_EQ(stored(fact.id), fact.stored) << fact.id;
        if (!fact.getter.empty())
            calls.push_back(fact.getter);
        calls.push_back("set " + std::to_string(fact.id));
    }
    EXPECT_EQ(standIns().calls, calls);
}

TEST_F(OsNodeBuild, StoresTheDistributedFlagAsATruthValue)
{
    standIns().numbers["getDistributed"] = 1;
    build();
    EXPECT_EQ(stored(140), "boolean true true");
}

TEST_F(OsNodeBuild, LeavesThePropertyOfAnUnknownFactUnset)
{
    for (Fact const& fact : facts) {
        if (fact.getter.empty() || fact.isLive)
            continue;
        standIns().failing = {fact.getter, "getLastBootTime", "getInstallDate"};
        Recording const log;
        build();
        EXPECT_EQ(stored(fact.id), "unset") << fact.getter;
        EXPECT_EQ(interface_.osNode_->getProperties().size(), 24U - standIns().failing.size())
            << fact.getter;
        EXPECT_TRUE(log.remarks().empty());
    }
}

TEST_F(OsNodeBuild, StoresThePreviousFigureForUnreadableOnes)
{
    standIns().failing = {"getProcessCount"};
    build();
    EXPECT_EQ(stored(144), "empty  true");
    EXPECT_EQ(stored(149), "number 1490 true");
    standIns().failing = {"getPhysicalMemoryFree", "getSwapFileSize", "getSwapFileFree",
                          "getSwapFileSizeStored"};
    build();
    EXPECT_EQ(stored(149), "number 1440 true");
    for (unsigned int const id : {150U, 151U, 153U, 152U})
        EXPECT_EQ(stored(id), "number 1500 true") << id;
}

TEST_F(OsNodeBuild, SeedsWithTheNodesOwnReads)
{
    Recording const log;
    build();
    Lines const texts = log.texts();
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

TEST_F(OsNodeBuild, LogsEachTimeInLocalTimeRightAfterItIsStored)
{
    useZone("CET-1CEST,M3.5.0,M10.5.0/3");
    Recording const log;
    build();
    Lines const texts = log.texts(3000);
    EXPECT_EQ(texts.front(), "createOsNodes: entry");
    EXPECT_EQ(Lines(texts.end() - 7, texts.end()),
              (Lines{"OsNode::setProperty: entry", "OsNode::setProperty: exit",
                     "LastBootTime = Wed May 12 12:23:45 2010\n", "OsNode::setProperty: entry",
                     "OsNode::setProperty: exit", "InstallDate = Thu Jan  1 00:59:59 2009\n",
                     "createOsNodes: exit"}));
    EXPECT_EQ(stored(141), "date 1273659825 true");
    std::string const unit = " OsSwMI Veltrix.IC.MI.OsSwMI";
    EXPECT_EQ(log.sources(), (Lines{"OsNode" + unit, "createOsNodes" + unit, "getProperty" + unit,
                                    "setProperty" + unit}));
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
    Lines const& lives = standIns().lives;
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

TEST_F(OsNodeRead, ReadsALiveFigureEachTimeAndStoresNone)
{
    for (Fact const& fact : facts) {
        if (!fact.isLive)
            continue;
        standIns().calls.clear();
        for (unsigned int const figure : {0U, 17U, 0xFFFFFFFFU}) {
            standIns().numbers[fact.getter] = figure;
            EXPECT_EQ(read(fact.id), "number " + std::to_string(figure) + " true") << fact.getter;
        }
        EXPECT_EQ(standIns().calls, Lines(3, fact.getter));
        EXPECT_EQ(stored(fact.id), fact.stored);
        standIns().failing = {fact.getter};
        EXPECT_EQ(read(fact.id), "text before false") << fact.getter;
    }
}

TEST_F(OsNodeRead, IgnoresTheStoredValueOfALiveFigure)
{
    EXPECT_EQ(node_.setProperty(144, PropertyValue("stored", true)).getStatus(), 0U);
    EXPECT_EQ(read(144), "number 1440 true");
    EXPECT_EQ(stored(144), "text stored true");
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
    for (Fact const& fact : facts)
        if (!fact.isLive) {
            EXPECT_EQ(read(fact.id), fact.stored);
        }
    EXPECT_TRUE(standIns().calls.empty());
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
        EXPECT_EQ(standIns().lives, (Lines{"OsNode::getProperty: entry", "OsInfo made",
                                           "OsInfo gone", "OsNode::getProperty: exit"}))
            << id;
    }
}

TEST_F(OsNodeBuild, MakesOnlyTheDummyTextOfALiteral)
{
    standIns().literals.clear();
    build();
    EXPECT_EQ(standIns().literals, Lines{"dummy"});
}

} // namespace
