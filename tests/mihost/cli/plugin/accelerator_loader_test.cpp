#include "mihost/cli/plugin/AcceleratorLoader.h"

#include <gtest/gtest.h>

namespace accelerator_loader_test
{

std::vector<mihost::Accelerator::Row> const rows{
    {"wc", 301, 0, ""}, {"lsmod", 0, 1, "PATH leads elsewhere"}, {"other", 0, 12, "unknown"}};

TEST(AnswersText, ShowsHowEachCommandWasAnsweredAndWhyItWasRun)
{
    EXPECT_EQ(answersText(rows),
              "wc                          301 answered      0 run\n"
              "lsmod                         0 answered      1 run: PATH leads elsewhere\n"
              "other                         0 answered     12 run: unknown\n");
    EXPECT_EQ(mihost::answersText({}), "");
}

TEST(AnswersJson, HasNullIfNoReasonIsKnown)
{
    EXPECT_EQ(toJson(rows).dump(),
              R"([{"command":"wc","answered":301,"run":0,"reason":null},)"
              R"({"command":"lsmod","answered":0,"run":1,"reason":"PATH leads elsewhere"},)"
              R"({"command":"other","answered":0,"run":12,"reason":"unknown"}])");
}

} // namespace accelerator_loader_test
