#include "mihost/cli/input/Suggestion.h"

#include <gtest/gtest.h>

namespace suggestion_test
{

using mihost::nearest;
using mihost::suggestion;

std::vector<std::string> const names = {"tree",    "list",    "get",    "set",
                                        "UserAdd", "UserDel", "os-name"};

TEST(Suggestion, IsTheNameInAnotherCaseOrWithFewOtherLetters)
{
    EXPECT_EQ(nearest("useradd", names), "UserAdd");
    EXPECT_EQ(nearest("TREE", names), "tree");
    EXPECT_EQ(nearest("tre", names), "tree");
    EXPECT_EQ(nearest("treee", names), "tree");
    EXPECT_EQ(nearest("lost", names), "list");
    EXPECT_EQ(nearest("lits", names), "list");
    EXPECT_EQ(nearest("osname1", names), "os-name");
    EXPECT_EQ(nearest("lit1", names), "");
}

TEST(Suggestion, IsTheNearestOfSeveral)
{
    EXPECT_EQ(nearest("UserDell", names), "UserDel");
    EXPECT_EQ(nearest("UserDd", {"UserDel", "UserAdd"}), "UserAdd");
}

TEST(Suggestion, IsNotMadeForALetterAPageOrAnotherWord)
{
    EXPECT_EQ(nearest("g", names), "");
    EXPECT_EQ(nearest("", names), "");
    EXPECT_EQ(nearest(std::string(65, 'x'), {std::string(65, 'x')}), "");
    EXPECT_EQ(nearest("reboot", names), "");
}

TEST(Suggestion, AsksForASimilarNameOrListsAll)
{
    EXPECT_EQ(suggestion("gte", {"get", "set"}, "use"), "did you mean get?");
    EXPECT_EQ(suggestion("refresh", {"get", "set"}, "use"), "use get, set");
    EXPECT_EQ(suggestion("refresh", {}, "it has"), "it has none");
}

TEST(Suggestion, ListsAsManyNamesAsAMessageHasRoomFor)
{
    std::string const half(44, 'x');
    EXPECT_EQ(suggestion("refresh", {half, half}, "use"), "use " + half + ", " + half);
    EXPECT_EQ(suggestion("refresh", {half, half, "y"}, "use"),
              "use " + half + ", " + half + ", ...");
}

} // namespace suggestion_test
