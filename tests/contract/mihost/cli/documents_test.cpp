#include "TestPaths.h"
#include "tests/support/Lines.h"
#include "tests/support/Program.h"

#include <gtest/gtest.h>

namespace documents_test
{

TEST(ReferenceDocuments, MatchTheCatalogue)
{
    EXPECT_EQ(contentOf(DOCS_DIR "/properties.md"), mihostRun({"properties", "--markdown"}).out)
        << "made by: mihost properties --markdown >docs/properties.md";
    EXPECT_EQ(contentOf(DOCS_DIR "/methods.md"), mihostRun({"methods", "--markdown"}).out)
        << "made by: mihost methods --markdown >docs/methods.md";
}

TEST(CatalogueCommands, NeedNoPlugin)
{
    for (char const* command : {"properties", "methods"})
        EXPECT_EQ(mihostRun({"--plugin", "/nonexistent", command}).code, 0) << command;
}

TEST(CatalogueCommands, DescribeOneKindOrMethod)
{
    std::string const group = mihostRun({"properties", "group"}).out;
    EXPECT_EQ(group.rfind("group (type 51, group:NAME): ", 0), 0U) << group;
    EXPECT_NE(group.find("165  members      texts"), std::string::npos) << group;
    EXPECT_EQ(group.find("user-name"), std::string::npos);
    std::string const method = mihostRun({"methods", "LocalGroupAdd"}).out;
    EXPECT_EQ(method, "LocalGroupAdd: adds a group\n"
                      "  parameter  value  required  meaning\n"
                      "  GroupName  name   required  the group's name\n");
    EXPECT_EQ(mihostRun({"properties", "things"}).code, 2);
    EXPECT_EQ(mihostRun({"methods", "useradd"}).code, 2);
}

TEST(CatalogueCommands, ListAMethodsParametersInItsHelp)
{
    std::string const help = mihostRun({"call", "LocalGroupAdd", "--help"}).out;
    EXPECT_NE(help.find("GroupName  name   required  the group's name"), std::string::npos) << help;
    EXPECT_EQ(help.find("\xE2\x81"), std::string::npos); // no marks of styles
    EXPECT_NE(mihostRun({"call", "--help"}).out.find("UserSetHomeDir"), std::string::npos);
}

} // namespace documents_test
