// Metrics as text that Prometheus reads.

#include "mihost/cli/metrics/MetricText.h"

#include <gtest/gtest.h>

namespace metric_text_test
{

using mihost::metricText;

TEST(MetricText, HasHelpTypeUnitAndSamples)
{
    EXPECT_EQ(metricText({{"mi_free_bytes", "bytes", "Free.", {{{}, 1024}}}}),
              "# HELP mi_free_bytes Free.\n"
              "# TYPE mi_free_bytes gauge\n"
              "# UNIT mi_free_bytes bytes\n"
              "mi_free_bytes 1024\n"
              "# EOF\n");
}

TEST(MetricText, JoinsLabelsAndOmitsAMissingUnit)
{
    EXPECT_EQ(
        metricText({{"mi_x", "", "X.", {{{{"a", "1"}, {"b", ""}}, 0.25}, {{{"a", "2"}}, 2}}}}),
        "# HELP mi_x X.\n"
        "# TYPE mi_x gauge\n"
        "mi_x{a=\"1\",b=\"\"} 0.25\n"
        "mi_x{a=\"2\"} 2\n"
        "# EOF\n");
}

TEST(MetricText, EscapesCharactersThatWouldEndALabel)
{
    std::string const text = metricText({{"x", "", "X.", {{{{"n", "a\"b\\c\nd\xff"}}, 1}}}});
    // A byte that is not UTF-8 becomes \xff, whose backslash is escaped in turn.
    EXPECT_NE(text.find("x{n=\"a\\\"b\\\\c\\nd\\\\xff\"} 1\n"), std::string::npos) << text;
}

TEST(MetricText, WritesWholeNumbersInFull)
{
    std::string const text =
        metricText({{"x", "", "X.", {{{}, 1795276425}, {{{"a", "1"}}, 68719476736}}}});
    EXPECT_NE(text.find("x 1795276425\nx{a=\"1\"} 68719476736\n"), std::string::npos) << text;
}

// As for two accounts of the same name, or two names that read the same once they are escaped.
TEST(MetricText, HasOnlyTheFirstOfSamplesWithTheSameLabels)
{
    std::string const text = metricText(
        {{"x", "", "X.", {{{{"n", "\xff"}}, 1}, {{{"n", "\\xff"}}, 2}, {{{"n", "b"}}, 3}}},
         {"y", "", "Y.", {{{{"n", "b"}}, 4}}}});
    EXPECT_NE(text.find("x{n=\"\\\\xff\"} 1\nx{n=\"b\"} 3\n"), std::string::npos) << text;
    EXPECT_NE(text.find("y{n=\"b\"} 4\n"), std::string::npos) << text;
}

} // namespace metric_text_test
