#include "mihost/cli/input/Address.h"
#include "mihost/cli/system/Failure.h"

#include <gtest/gtest.h>
#include <memory>

namespace address_test
{

using mihost::Failure;

/** A tree with one node of each of several kinds. */
class Addresses : public testing::Test
{
protected:
    Addresses()
    {
        add(1, 39, 0);
        add(4, 17, 0);
        add(5, 46, 1, "jdoe");
        add(6, 46, 2, "a:b");
        add(7, 51, 1, "jdoe");
        add(8, 44, 1, "ext4");
        add(9, 35, 0);
        add(10, 47, 1).setProperty(89, IC::PropertyValue(IC::Number(1U), true));
        add(11, 99, 0);
    }

    unsigned int find(std::string const& address) const
    {
        return mihost::findNode(nodes_, address).getNodeId();
    }

    std::string refusalOf(std::string const& address) const
    {
        try {
            find(address);
        } catch (Failure const& failure) {
            return failure.what();
        }
        return "";
    }

    int codeOf(std::string const& address) const
    {
        try {
            find(address);
        } catch (Failure const& failure) {
            return failure.code();
        }
        return mihost::Done;
    }

    std::vector<IC::MutableNode*> nodes_;

private:
    IC::MutableNode& add(unsigned int id, unsigned int type, unsigned int index,
                         std::string const& name = "")
    {
        owned_.push_back(
            std::make_unique<IC::MutableNode>(id, 0U, std::vector<unsigned int>(), type, index));
        nodes_.push_back(owned_.back().get());
        if (!name.empty())
            nodes_.back()->setProperty(108, IC::PropertyValue(name, true));
        return *nodes_.back();
    }

    std::vector<std::unique_ptr<IC::MutableNode>> owned_;
};

TEST_F(Addresses, FindNodesByIdByKindAndByName)
{
    EXPECT_EQ(find("mi"), 1U);
    EXPECT_EQ(find("os"), 4U);
    EXPECT_EQ(find("log"), 9U);
    EXPECT_EQ(find("11"), 11U);
    EXPECT_EQ(find("user:jdoe"), 5U);
    EXPECT_EQ(find("group:jdoe"), 7U);
    EXPECT_EQ(find("driver:ext4"), 8U);
    EXPECT_EQ(find("log:1"), 10U);
    EXPECT_EQ(find("user:a:b"), 6U);
}

TEST_F(Addresses, ThatNoNodeHasAreNotFound)
{
    for (char const* address : {"3", "user:nobody", "log:51", "computer"})
        EXPECT_EQ(codeOf(address), mihost::NotFound) << address;
}

TEST_F(Addresses, ThatAreInvalidAreRefusedWithAnExample)
{
    for (char const* address : {"", "user", "os:1", "-1", "4x", "99999999999", "nonsense:x"}) {
        EXPECT_EQ(codeOf(address), mihost::NotFound) << address;
        EXPECT_NE(refusalOf(address).find("user:NAME"), std::string::npos) << address;
    }
}

TEST_F(Addresses, NearlyNamingANodeSuggestItsNameOrTheList)
{
    EXPECT_EQ(refusalOf("group"), "no node 'group' (write group:NAME; see 'mihost list groups')");
    EXPECT_EQ(refusalOf("drivers"),
              "no node 'drivers' (write driver:NAME; see 'mihost list drivers')");
    EXPECT_EQ(refusalOf("user:jdoo"), "no node 'user:jdoo' in the tree (did you mean user:jdoe?)");
    for (char const* address : {"user:ext4", "user:", "log:2", "3"})
        EXPECT_EQ(refusalOf(address),
                  std::string("no node '") + address + "' in the tree (see 'mihost tree')");
}

TEST_F(Addresses, OfNodesReadBackAsTheyAreShown)
{
    for (IC::MutableNode const* node : nodes_)
        EXPECT_EQ(find(mihost::addressOf(*node)), node->getNodeId());
    EXPECT_EQ(mihost::addressOf(*nodes_[3]), "user:a:b");
    EXPECT_EQ(mihost::addressOf(*nodes_[8]), "11");
}

} // namespace address_test
