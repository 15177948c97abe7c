#include "sysdata/groupInfo_members.h"

#include <gtest/gtest.h>

#include <random>
#include <string>
#include <vector>

namespace group_members_test
{

using NQ::GROUP_INFO::withMembers;
using Names = std::vector<std::string>;

std::vector<char const*> terminated(Names const& names)
{
    std::vector<char const*> pointers;
    pointers.reserve(names.size() + 1);
    for (std::string const& name : names)
        pointers.push_back(name.c_str());
    pointers.push_back(nullptr);
    return pointers;
}

std::string joined(std::string const& field, Names const& names)
{
    return withMembers(field, terminated(names).data());
}

/** The same in the plainest way: two searches of the whole field for each name. */
std::string plainlyJoined(std::string field, Names const& names)
{
    for (std::string const& name : names)
        if (field.find("," + name + ",") == std::string::npos &&
            field.find(name + ",") == std::string::npos)
            field += name + ",";
    if (field.size() > 1)
        field.erase(field.size() - 1);
    return field;
}

TEST(GroupMembers, AreTheFieldAndTheNamesThatItLacks)
{
    EXPECT_EQ(joined("anna,ben,", {"ben", "carl"}), "anna,ben,carl");
}

TEST(GroupMembers, AreNoneWithoutFieldAndNames)
{
    EXPECT_EQ(joined("", {}), "");
}

TEST(GroupMembers, AreTheFieldIfThereAreNoNames)
{
    EXPECT_EQ(joined("anna,ben,", {}), "anna,ben");
}

TEST(GroupMembers, AreTheNamesIfThereIsNoField)
{
    EXPECT_EQ(joined("", {"anna", "ben"}), "anna,ben");
}

TEST(GroupMembers, LackANameThatAListedOneEndsIn)
{
    EXPECT_EQ(joined("xbob,", {"bob", "carl"}), "xbob,carl");
    EXPECT_EQ(joined("", {"xbob", "bob"}), "xbob");
}

TEST(GroupMembers, HoldANameThatIsPartOfAListedOne)
{
    EXPECT_EQ(joined("bobx,xbobx,", {"bob"}), "bobx,xbobx,bob");
}

TEST(GroupMembers, HoldALongerNameAfterAShorterOneThatItEndsIn)
{
    EXPECT_EQ(joined("bob,", {"xbob"}), "bob,xbob");
}

TEST(GroupMembers, HoldANameOnce)
{
    EXPECT_EQ(joined("", {"anna", "anna"}), "anna");
    EXPECT_EQ(joined("anna,anna,", {}), "anna,anna");
}

TEST(GroupMembers, KeepTheCommaOfASingleEmptyName)
{
    EXPECT_EQ(joined("", {""}), ",");
    EXPECT_EQ(joined(",", {}), ",");
    EXPECT_EQ(joined("anna,", {""}), "anna");
}

TEST(GroupMembers, FindANameWithACommaAcrossListedOnes)
{
    EXPECT_EQ(joined("xa,b,", {"a,b", "b,a"}), "xa,b,b,a");
}

TEST(GroupMembers, MatchThePlainSearchForRandomNames)
{
    std::mt19937 random(20101);
    auto const below = [&random](unsigned int limit) {
        return static_cast<unsigned int>(random() % limit);
    };
    auto const someNames = [&below](std::string const& letters) {
        Names names(below(9));
        for (std::string& name : names)
            for (unsigned int length = below(5); length > 0; --length)
                name += letters[below(static_cast<unsigned int>(letters.size()))];
        return names;
    };
    for (std::string const letters : {"ab", "abc", "a,", "ab,"})
        for (int round = 0; round < 2000; ++round) {
            std::string field;
            for (std::string const& name : someNames(letters))
                field += name + ",";
            Names const names = someNames(letters);
            std::string const expected = plainlyJoined(field, names);
            ASSERT_EQ(joined(field, names), expected)
                << "field " << field << ", names " << plainlyJoined("", names);
        }
}

} // namespace group_members_test
