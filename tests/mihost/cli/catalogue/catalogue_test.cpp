#include "mihost/cli/catalogue/Catalogue.h"

#include <gtest/gtest.h>
#include <set>

namespace catalogue_test
{

using mihost::methods;
using mihost::nodeKinds;

TEST(Catalogue, GivesEachPropertyOfAKindItsOwnIdAndName)
{
    for (auto const& kind : nodeKinds()) {
        std::set<unsigned int> ids;
        std::set<std::string> names;
        for (auto const& property : kind.properties) {
            EXPECT_TRUE(ids.insert(property.id).second) << kind.name << property.id;
            EXPECT_TRUE(names.insert(property.name).second) << kind.name << property.name;
            EXPECT_STRNE(property.meaning, "") << kind.name << property.name;
        }
    }
    for (auto const& kind : nodeKinds())
        for (auto const& property : kind.properties)
            EXPECT_NE(std::string(property.name).find_first_not_of("0123456789"),
                      std::string::npos);
}

TEST(Catalogue, ListsThePropertiesOfEachKindInTheirOrder)
{
    std::map<std::string, std::vector<unsigned int>> ids;
    for (auto const& kind : nodeKinds())
        for (auto const& property : kind.properties)
            ids[kind.name].push_back(property.id);
    EXPECT_EQ(ids, (std::map<std::string, std::vector<unsigned int>>{
                       {"computer", {108}},
                       {"os", {128, 123, 125, 108, 134, 74,  75,  140, 142, 143, 145, 146, 147,
                               148, 155, 154, 144, 149, 150, 151, 153, 152, 141, 139, 191}},
                       {"driver", {134, 108, 70, 36}},
                       {"user", {123, 125, 108, 109, 89,  90,  311, 312, 158, 159, 117, 120,
                                 163, 162, 161, 44,  118, 119, 113, 91,  160, 106, 138, 51}},
                       {"group", {108, 89, 165, 51}},
                       {"log", {123, 125, 37, 108, 114, 84}},
                       {"log-entry", {89, 81, 79}}}));
}

TEST(Catalogue, MarksWhatActsOnTheSystem)
{
    std::set<std::pair<std::string, unsigned int>> acting;
    for (auto const& kind : nodeKinds())
        for (auto const& property : kind.properties)
            if (property.has(mihost::Property::Acts))
                acting.emplace(kind.name, property.id);
    EXPECT_EQ(acting, (std::set<std::pair<std::string, unsigned int>>{{"os", 123},
                                                                      {"os", 191},
                                                                      {"os", 75},
                                                                      {"os", 74},
                                                                      {"user", 117},
                                                                      {"user", 118},
                                                                      {"user", 91},
                                                                      {"user", 138}}));
}

TEST(Catalogue, MarksWhatIsReadLive)
{
    std::map<std::string, std::set<unsigned int>> live;
    for (auto const& kind : nodeKinds())
        for (auto const& property : kind.properties)
            if (property.has(mihost::Property::Live))
                live[kind.name].insert(property.id);
    EXPECT_EQ(live, (std::map<std::string, std::set<unsigned int>>{
                        {"os", {144, 149, 150, 151, 152, 153, 191}},
                        {"user", {51}},
                        {"group", {51}},
                        {"log-entry", {81, 89, 79}}}));
}

TEST(Catalogue, KnowsEveryMethod)
{
    std::vector<std::string> names;
    for (auto const& method : methods())
        names.emplace_back(method.name);
    EXPECT_EQ(names,
              (std::vector<std::string>{"UserAdd", "UserDel", "UserSetAttrib", "UserSetFullName",
                                        "UserSetScriptPath", "UserSetHomeDir", "UserSetPassword",
                                        "LocalGroupAdd", "LocalGroupDel", "LocalGroupAddUser",
                                        "LocalGroupDelUser", "GetShadowing"}));
}

TEST(Catalogue, NamesTypesThatAMethodCallKnows)
{
    for (auto const& method : methods())
        for (auto const& parameter : method.parameters)
            EXPECT_TRUE((std::set<std::string>{"CMPI_string", "CMPI_uint32", "CMPI_dateTime"}.count(
                            parameter.type)) != 0)
                << parameter.name;
}

} // namespace catalogue_test
