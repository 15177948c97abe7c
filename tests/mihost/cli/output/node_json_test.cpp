#include "mihost/cli/output/NodeJson.h"

#include <gtest/gtest.h>

namespace node_json_test
{

using IC::Number;
using IC::PropertyValue;
using mihost::Secrets;

std::string dumped(IC::MutableNode const& node, Secrets secrets = Secrets::Hide)
{
    return toJson(mihost::storedView(node, secrets)).dump();
}

TEST(NodeAsJson, HasItsKeysInOrderAndItsPropertiesByName)
{
    IC::MutableNode node(4, 3, {1}, 17, 0);
    node.setStatus(1);
    node.setDescription("Operating System");
    node.setProperty(108, PropertyValue("Linux", true));
    auto const json = toJson(mihost::storedView(node, Secrets::Hide));
    std::string const start = R"({"id":4,"parent":3,"type":17,"kind":"os","index":0,"status":1,)"
                              R"("description":"Operating System","mi_ids":[1],"properties":{)";
    EXPECT_EQ(json.dump().substr(0, start.size()), start);
    EXPECT_EQ(json["properties"]["os-name"].dump(),
              R"({"id":108,"kind":"text","flag":true,"value":"Linux"})");
}

TEST(NodeAsJson, NamesEachKind)
{
    struct Row {
        unsigned int type;
        char const* kind;
    };
    for (Row const& row : {Row{39, "mi"}, Row{59, "root"}, Row{40, "computer"}, Row{17, "os"},
                           Row{44, "driver"}, Row{46, "user"}, Row{51, "group"}, Row{35, "log"},
                           Row{47, "log-entry"}, Row{99, "unknown"}}) {
        IC::MutableNode const node(4, 3, {1}, row.type, 0);
        EXPECT_EQ(toJson(mihost::storedView(node, Secrets::Hide))["kind"], row.kind);
    }
}

TEST(NodeAsJson, WritesEachKindOfValueAsItsOwnJsonType)
{
    IC::MutableNode node(4, 3, {1}, 99, 0);
    unsigned int id = 0;
    for (PropertyValue const& value :
         {PropertyValue("a", true), PropertyValue(Number(4294967295U), true),
          PropertyValue(Number(true), true), PropertyValue(Number(-5L, 0), true),
          PropertyValue(IC::EnumValue(7U), false),
          PropertyValue(std::vector<Number>{Number(0U), Number(24U)}, true),
          PropertyValue(std::vector<std::string>{"x", "y"}, true),
          PropertyValue(PropertyValue::EmptyKind, true)})
        node.setProperty(++id, value);
    EXPECT_EQ(toJson(mihost::storedView(node, Secrets::Hide))["properties"].dump(),
              R"({"1":{"id":1,"kind":"text","flag":true,"value":"a"},)"
              R"("2":{"id":2,"kind":"number","flag":true,"value":4294967295},)"
              R"("3":{"id":3,"kind":"boolean","flag":true,"value":true},)"
              R"("4":{"id":4,"kind":"date","flag":true,"value":-5},)"
              R"("5":{"id":5,"kind":"enumeration","flag":false,"value":7},)"
              R"("6":{"id":6,"kind":"numbers","flag":true,"value":[0,24]},)"
              R"("7":{"id":7,"kind":"texts","flag":true,"value":["x","y"]},)"
              R"("8":{"id":8,"kind":"empty","flag":true,"value":null}})");
}

TEST(NodeAsJson, WritesBytesThatAreNotUtf8InHex)
{
    IC::MutableNode node(4, 3, {1}, 99, 0);
    node.setDescription("J\xFCrgen");
    node.setProperty(1, PropertyValue("\xFF", true));
    auto const json = nlohmann::json::parse(dumped(node));
    EXPECT_EQ(json["description"], "J\\xfcrgen");
    EXPECT_EQ(json["properties"]["1"]["value"], "\\xff");
}

TEST(NodeAsJson, HidesPasswordHashesUnlessAskedForThem)
{
    IC::MutableNode node(5, 4, {1}, 46, 1);
    node.setProperty(117, PropertyValue("$6$hash", true));
    auto const hidden = toJson(mihost::storedView(node, Secrets::Hide));
    EXPECT_EQ(hidden["properties"]["password"].dump(),
              R"({"id":117,"kind":"text","flag":true,"value":null,"hidden":true})");
    auto const shown = toJson(mihost::storedView(node, Secrets::Show));
    EXPECT_EQ(shown["properties"]["password"].dump(),
              R"({"id":117,"kind":"text","flag":true,"value":"$6$hash"})");
}

TEST(NodeAsJson, NeverShowsAMethodCallThatHoldsAPassword)
{
    IC::MutableNode node(4, 3, {1}, 17, 0);
    node.setProperty(74, PropertyValue("UserAdd,Password:CMPI_string:pw", true));
    for (Secrets const secrets : {Secrets::Hide, Secrets::Show})
        EXPECT_TRUE(
            toJson(mihost::storedView(node, secrets))["properties"]["create-user"]["hidden"]);
    node.setProperty(74, PropertyValue("UserDel,UserName:CMPI_string:jdoe", true));
    EXPECT_EQ(toJson(mihost::storedView(node, Secrets::Hide))["properties"]["create-user"]["value"],
              "UserDel,UserName:CMPI_string:jdoe");
}

} // namespace node_json_test
