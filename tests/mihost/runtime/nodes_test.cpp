// The reference runtime's nodes.

#include "host/MutableNode.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace nodes_test
{

using IC::Error;
using IC::MutableNode;
using IC::Node;
using IC::PropertyValue;

class NodeStore : public testing::Test
{
protected:
    /** @return the text of a property, or "none" if the read fails and keeps the caller's value */
    std::string text(unsigned int id)
    {
        PropertyValue value("before", false);
        if (node_.getProperty(id, value).getStatus() == 0)
            return value;
        EXPECT_EQ(static_cast<std::string>(value), "before");
        return "none";
    }

    MutableNode node_{5, 4, {1, 2}, 46, 3};
};

TEST_F(NodeStore, KeepsItsIdsTypeAndIndexAndNothingElseAtFirst)
{
    EXPECT_EQ(node_.getNodeId(), 5U);
    EXPECT_EQ(node_.getLinkedId(), 4U);
    EXPECT_EQ(node_.getMIIds(), (std::vector<unsigned int>{1, 2}));
    EXPECT_EQ(node_.getNodeType(), 46U);
    EXPECT_EQ(node_.getIndex(), 3U);
    EXPECT_EQ(node_.getStatus(), 0U);
    EXPECT_EQ(node_.getDescription(), "");
    EXPECT_TRUE(node_.getProperties().empty());
}

TEST_F(NodeStore, KeepsStatusDescriptionPathAndParent)
{
    EXPECT_EQ(node_.setStatus(1).getStatus(), 0U);
    EXPECT_EQ(node_.setDescription("User Account").getStatus(), 0U);
    Node const& base = node_;
    EXPECT_EQ(base.getStatus(), 1U);
    EXPECT_EQ(base.getDescription(), "User Account");
    EXPECT_EQ(base.Node::getStatus(), 1U);
    EXPECT_EQ(base.Node::getDescription(), "User Account");
    EXPECT_EQ(static_cast<std::string>(base), "User Account");
    EXPECT_EQ(node_.setPath("/os/users").getStatus(), 0U);
    EXPECT_EQ(node_.setParent("os").getStatus(), 0U);
}

TEST_F(NodeStore, FailsWithStatus1ForAnUnsetProperty)
{
    PropertyValue value("before", false);
    Error const error = node_.getProperty(108, value);
    EXPECT_EQ(error.getStatus(), 1U);
    EXPECT_EQ(static_cast<std::string>(error), "status 1: property 108 is not set");
    EXPECT_EQ(static_cast<std::string>(value), "before");
}

TEST_F(NodeStore, ReplacesAnEarlierValueOfTheSameProperty)
{
    EXPECT_EQ(node_.setProperty(108, PropertyValue("first", true)).getStatus(), 0U);
    EXPECT_EQ(text(108), "first");
    EXPECT_EQ(node_.setProperty(108, PropertyValue(IC::Number(7U), false)).getStatus(), 0U);
    EXPECT_EQ(text(108), "7");
    EXPECT_EQ(node_.getProperties().size(), 1U);
    EXPECT_EQ(node_.getProperties().at(108).getKind(), PropertyValue::NumberKind);
    EXPECT_FALSE(node_.getProperties().at(108).getFlag());
}

TEST_F(NodeStore, KeepsPropertiesApartAndReturnsACopy)
{
    node_.setProperty(0, PropertyValue("zero", true));
    node_.setProperty(4294967295U, PropertyValue("last", true));
    EXPECT_EQ(text(0), "zero");
    EXPECT_EQ(text(4294967295U), "last");
    EXPECT_EQ(text(1), "none");
    node_.setProperty(108, PropertyValue("first", true));
    auto properties = node_.getProperties();
    properties.clear();
    EXPECT_EQ(text(108), "first");
}

TEST_F(NodeStore, AddsAnInterfaceOnceAndRemovesIt)
{
    node_.addMI(9);
    node_.addMI(9);
    EXPECT_EQ(node_.getMIIds(), (std::vector<unsigned int>{1, 2, 9}));
    node_.delMI(2);
    node_.delMI(77);
    EXPECT_EQ(node_.getMIIds(), (std::vector<unsigned int>{1, 9}));
}

TEST_F(NodeStore, OverridesTheFirstSixOperationsOfItsBase)
{
    Node& base = node_;
    base.setProperty(108, PropertyValue("text", true));
    PropertyValue value("", true);
    EXPECT_EQ(base.getProperty(108, value).getStatus(), 0U);
    EXPECT_EQ(static_cast<std::string>(value), "text");
    EXPECT_EQ(base.getProperties().size(), 1U);
}

} // namespace nodes_test
