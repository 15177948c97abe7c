#include "nodes/OsNode.h"

#include "tests/interposed/StandIns.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/Frame.h"

#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

namespace
{

TEST(OsNodeWrite, MakesOneReaderOfEachKindForEachWrite)
{
    FakeFiles const files;
    FakeCommands commands;
    commands.otherwise = "";
    Frame const frame;
    IC::OsNode node(9, 7, {7}, 17, 0);
    std::pair<unsigned int, IC::PropertyValue> const writes[] = {
        {74, {"dummy", true}},          {74, {"LocalGroupAdd,GroupName:CMPI_string:g", true}},
        {74, {"NoSuchMethod", true}},   {75, {IC::Number(0U), true}},
        {75, {IC::Number(1U), true}},   {108, {IC::Number(1U), true}},
        {123, {IC::Number(1U), true}},  {123, {IC::Number(9U), true}},
        {123, {IC::Number(12U), true}}, {191, {IC::Number(1U), true}},
        {4711, {IC::Number(1U), true}}};
    for (auto const& [id, value] : writes) {
        standIns() = {};
        node.setProperty(id, value);
        EXPECT_EQ(standIns().lives, (std::vector<std::string>{"OsInfo made", "logInfo made",
                                                              "logInfo gone", "OsInfo gone"}))
            << id;
    }
}

} // namespace
