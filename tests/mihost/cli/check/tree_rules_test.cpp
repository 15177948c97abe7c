#include "mihost/cli/check/PropertyRules.h"
#include "mihost/cli/check/TreeRules.h"

#include "host/Properties.h"
#include "nodes/nodeValues.h"

#include <gtest/gtest.h>
#include <memory>

namespace tree_rules_test
{

using namespace mihost::checks;

constexpr unsigned int ownId = 50;

/** The smallest complete tree: the single nodes and two groups. */
class CheckOfTheTree : public testing::Test
{
protected:
    CheckOfTheTree()
    {
        add(IC::nodeType::osSw, 0, 0, "OsSw Management Interface");
        add(IC::nodeType::root, 50, 0, "ROOT Node");
        add(IC::nodeType::computer, 51, 0, "Computer");
        add(IC::nodeType::operatingSystem, 52, 0, "Operating System");
        IC::values::setProperties(
            at(IC::nodeType::operatingSystem),
            {{IC::property::fixedEnumeration, IC::values::enumeration(35)},
             {IC::property::requestedState, IC::PropertyValue(IC::EnumValue(1U), false)},
             {IC::property::fixedNumbers, IC::values::fixedNumberList()},
             {IC::property::createUser, IC::values::text("dummy")},
             {IC::property::refresh, IC::values::number(1)}});
        for (unsigned int index : {1U, 2U}) {
            add(IC::nodeType::group, 53, index, "Group");
            IC::values::setProperties(*nodes_.back(),
                                      {{IC::property::name, IC::values::text("staff")},
                                       {IC::property::id, IC::values::number(index)},
                                       {IC::property::members, IC::values::texts({})},
                                       {IC::property::elementCount, IC::values::number(2)}});
        }
        add(IC::nodeType::log, 53, 0, "OS Log");
        IC::values::setProperties(*nodes_.back(),
                                  {{IC::property::requestedState, IC::values::enumeration(1)},
                                   {IC::property::fixedNumbers, IC::values::fixedNumberList()},
                                   {IC::property::logNumber, IC::values::number(0)},
                                   {IC::property::name, IC::values::text("OS Log")},
                                   {IC::property::logState, IC::values::enumeration(2)},
                                   {IC::property::dataType, IC::values::text("*string LogData*")}});
    }

    void add(unsigned int type, unsigned int parent, unsigned int index,
             std::string const& description)
    {
        auto const id = ownId + static_cast<unsigned int>(owned_.size());
        owned_.push_back(
            std::make_unique<IC::MutableNode>(id, parent, std::vector{ownId}, type, index));
        nodes_.push_back(owned_.back().get());
        nodes_.back()->setStatus(1);
        nodes_.back()->setDescription(description);
    }

    IC::MutableNode& at(unsigned int type)
    {
        for (IC::MutableNode* node : nodes_)
            if (node->getNodeType() == type)
                return *node;
        throw std::logic_error("no such node");
    }

    std::vector<std::unique_ptr<IC::MutableNode>> owned_;
    Nodes nodes_;
};

TEST_F(CheckOfTheTree, FindsNothingWrongWithACompleteOne)
{
    EXPECT_EQ(wrongTypeOrder(nodes_), Findings());
    EXPECT_EQ(wrongIds(nodes_, ownId), Findings());
    EXPECT_EQ(wrongParents(nodes_), Findings());
    EXPECT_EQ(wrongIndexes(nodes_), Findings());
    EXPECT_EQ(wrongStatuses(nodes_), Findings());
    EXPECT_EQ(wrongDescriptions(nodes_), Findings());
    EXPECT_EQ(wrongMiIds(nodes_, ownId), Findings());
    EXPECT_EQ(wrongPropertyIds(nodes_), Findings());
    EXPECT_EQ(wrongKinds(nodes_), Findings());
    EXPECT_EQ(wrongFlags(nodes_), Findings());
    EXPECT_EQ(wrongValues(nodes_), Findings());
}

TEST_F(CheckOfTheTree, ReportsMissingSingleNodesAndUnknownOnes)
{
    nodes_.pop_back();
    add(99, 0, 0, "Other");
    EXPECT_EQ(wrongTypes(nodes_), (Findings{"node #57: unknown node type 99",
                                            "0 nodes of the kind log rather than 1"}));
    add(IC::nodeType::log, 53, 0, "OS Log");
    add(IC::nodeType::log, 53, 0, "OS Log");
    EXPECT_EQ(wrongTypes(nodes_).back(), "2 nodes of the kind log rather than 1");
}

TEST_F(CheckOfTheTree, KnowsTheOrderOfBuilding)
{
    std::swap(nodes_[4], nodes_.back());
    EXPECT_EQ(wrongTypeOrder(nodes_), (Findings{"group #55: listed after a node of the kind log",
                                                "group #54: listed after a node of the kind log"}));
    EXPECT_EQ(wrongTypes(nodes_), Findings());
}

TEST_F(CheckOfTheTree, NamesWrongNumbers)
{
    EXPECT_EQ(wrongIds(nodes_, ownId - 1).front(), "mi #50: node id 50 rather than 49");
    EXPECT_EQ(wrongMiIds(nodes_, 1).size(), nodes_.size());
    at(IC::nodeType::log).setStatus(2);
    EXPECT_EQ(wrongStatuses(nodes_), Findings{"log #56: status 2 rather than 1"});
    add(IC::nodeType::logEntry, 53, 2, "OS LogEntry");
    EXPECT_EQ(wrongParents(nodes_), Findings{"log-entry #57: parent id 53 rather than 56"});
    EXPECT_EQ(wrongIndexes(nodes_), Findings{"log-entry #57: index 2 rather than 1"});
}

TEST_F(CheckOfTheTree, NamesWrongDescriptions)
{
    at(IC::nodeType::root).setDescription("root");
    add(IC::nodeType::driver, 53, 1, "anything");
    EXPECT_EQ(wrongDescriptions(nodes_),
              Findings{"root #51: description 'root' rather than 'ROOT Node'"});
    nodes_.back()->setDescription("");
    EXPECT_EQ(wrongDescriptions(nodes_).back(), "driver #57: no description");
}

TEST_F(CheckOfTheTree, ReportsMissingPropertiesAndUnknownOnes)
{
    at(IC::nodeType::root).setProperty(7, IC::values::number(1));
    add(IC::nodeType::driver, 53, 1, "one");
    EXPECT_EQ(wrongPropertyIds(nodes_),
              (Findings{"root #51: unknown property 7", "driver #57: driver-version (134): not set",
                        "driver #57: driver-name (108): not set",
                        "driver #57: build-number (70): not set",
                        "driver #57: manufacturer (36): not set"}));
}

TEST_F(CheckOfTheTree, NamesWrongKindsAndFlags)
{
    IC::MutableNode& os = at(IC::nodeType::operatingSystem);
    os.setProperty(IC::property::refresh, IC::PropertyValue("1", false));
    os.setProperty(IC::property::requestedState, IC::values::enumeration(1));
    EXPECT_EQ(wrongKinds(nodes_), Findings{"os #53: refresh (75): text rather than number"});
    EXPECT_EQ(wrongFlags(nodes_),
              (Findings{"os #53: refresh (75): flag false rather than true",
                        "os #53: requested-state (123): flag true rather than false"}));
}

TEST_F(CheckOfTheTree, AcceptsAnEmptyFigureThatCouldNotBeRead)
{
    IC::MutableNode& os = at(IC::nodeType::operatingSystem);
    os.setProperty(IC::property::processCount, IC::values::emptyValue());
    EXPECT_EQ(wrongKinds(nodes_), Findings());
    os.setProperty(IC::property::userCount, IC::values::emptyValue());
    EXPECT_EQ(wrongKinds(nodes_), Findings{"os #53: user-count (145): empty rather than number"});
}

TEST_F(CheckOfTheTree, NamesWrongValuesLengthsAndCounts)
{
    at(IC::nodeType::log).setProperty(IC::property::logNumber, IC::values::number(1));
    at(IC::nodeType::group).setProperty(IC::property::elementCount, IC::values::number(3));
    EXPECT_EQ(wrongValues(nodes_), (Findings{"group #54: group-count (51): '3' rather than '2'",
                                             "log #56: log-number (37): '1' rather than '0'"}));
}

/** Answers every property, also those that the real nodes do not answer. */
class AnswersAll : public IC::MutableNode
{
public:
    using MutableNode::MutableNode;

    IC::Error getProperty(unsigned int, IC::PropertyValue& value) const override
    {
        value = IC::PropertyValue("all", true);
        return IC::values::success();
    }
};

TEST(CheckOfReads, NamesUnknownWrongAndMissingValues)
{
    AnswersAll node(9, 0, {}, IC::nodeType::computer, 0);
    EXPECT_EQ(wrongReads({&node}),
              Findings{"computer #9: returns a value for the unknown property 4294967295"});
    AnswersAll group(9, 0, {}, IC::nodeType::group, 1);
    EXPECT_EQ(wrongReads({&group}).front(),
              "group #9: group-id (89): reads as text rather than number");
    IC::MutableNode os(9, 0, {}, IC::nodeType::operatingSystem, 0);
    EXPECT_EQ(wrongReads({&os}), Findings{"os #9: clear-log (191): cannot be read"});
}

} // namespace tree_rules_test
