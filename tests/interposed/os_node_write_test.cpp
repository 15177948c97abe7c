#include "nodes/OsNode.h"

#include "tests/interposed/StandIns.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace
{

TEST(OsNodeWrite, MakesOneReaderOfEachKindForItsOwnTimeWhateverTheProperty)
{
    IC::OsNode node(9, 7, {7}, 17, 0);
    for (unsigned int const id : {74U, 75U, 108U, 123U, 191U, 4711U}) {
        standIns() = {};
        IC::PropertyValue const value =
            id == 74 ? IC::PropertyValue("dummy", true) : IC::PropertyValue(IC::Number(1U), true);
        EXPECT_EQ(node.setProperty(id, value).getStatus(), 0);
        EXPECT_EQ(standIns().lives, (std::vector<std::string>{"OsInfo made", "logInfo made",
                                                              "logInfo gone", "OsInfo gone"}))
            << id;
    }
}

} // namespace
