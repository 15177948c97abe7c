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
    struct {
        char const* what;
        char const* field;
        Names names;
        char const* members;
    } const cases[] = {
        {"both", "anna,ben,", {"ben", "carl"}, "anna,ben,carl"},
        {"neither", "", {}, ""},
        {"no names", "anna,ben,", {}, "anna,ben"},
        {"no field", "", {"anna", "ben"}, "anna,ben"},
        {"a listed name ends in another", "xbob,", {"bob", "carl"}, "xbob,carl"},
        {"so does a name before it", "", {"xbob", "bob"}, "xbob"},
        {"a name within listed ones", "bobx,xbobx,", {"bob"}, "bobx,xbobx,bob"},
        {"a name that ends in a listed one", "bob,", {"xbob"}, "bob,xbob"},
        {"a name twice", "", {"anna", "anna"}, "anna"},
        {"a listed name twice", "anna,anna,", {}, "anna,anna"},
        {"a single empty name", "", {""}, ","},
        {"a single empty listed name", ",", {}, ","},
        {"an empty name", "anna,", {""}, "anna"},
        {"names with a comma", "xa,b,", {"a,b", "b,a"}, "xa,b,b,a"},
    };
    for (auto const& [what, field, names, members] : cases)
        EXPECT_EQ(joined(field, names), members) << what;
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
