#include "TestPaths.h"
#include "tests/support/Mihost.h"

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
    EXPECT_TRUE(startsWith(group, "group (type 51, group:NAME): "));
    EXPECT_TRUE(holds(group, "165  members      texts"));
    EXPECT_FALSE(holds(group, "user-name"));
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
    EXPECT_TRUE(holds(help, "GroupName  name   required  the group's name"));
    EXPECT_FALSE(holds(help, "\xE2\x81")); // no marks of styles
    EXPECT_TRUE(holds(mihostRun({"call", "--help"}).out, "UserSetHomeDir"));
}

} // namespace documents_test
