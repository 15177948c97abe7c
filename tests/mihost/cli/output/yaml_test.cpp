#include "mihost/cli/output/Document.h"

#include <gtest/gtest.h>

namespace yaml_test
{

using mihost::documentText;
using mihost::Format;
using mihost::Json;
using mihost::yamlText;

TEST(Yaml, ShowsNestedListsAndObjectsAsBlocks)
{
    Json const document = {{"id", 4},
                           {"list", Json::array({1, "two", Json::array({3, 4})})},
                           {"objects", {{{"a", 1}, {"b", {{"c", nullptr}}}}}},
                           {"empty", Json::object()},
                           {"none", Json::array()}};
    EXPECT_EQ(yamlText(document), "---\n"
                                  "id: 4\n"
                                  "list:\n"
                                  "  - 1\n"
                                  "  - two\n"
                                  "  - - 3\n"
                                  "    - 4\n"
                                  "objects:\n"
                                  "  - a: 1\n"
                                  "    b:\n"
                                  "      c: null\n"
                                  "empty: {}\n"
                                  "none: []\n");
}

TEST(Yaml, StartsEveryDocumentAndWritesSmallNumbers)
{
    EXPECT_EQ(yamlText(Json::array()), "--- []\n");
    EXPECT_EQ(yamlText("text"), "--- text\n");
    EXPECT_EQ(yamlText(1e-05), "--- 1.0e-05\n");
    EXPECT_EQ(yamlText(0.5), "--- 0.5\n");
}

TEST(Yaml, QuotesTextsThatWouldBeReadAsSomethingElse)
{
    struct Row {
        char const* text;
        char const* shown;
    };
    for (Row const& row :
         std::initializer_list<Row>{{"plain", "plain"},
                                    {"/bin/sh", "\"/bin/sh\""},
                                    {"a.b-c_d/e+f1", "a.b-c_d/e+f1"},
                                    {"", "\"\""},
                                    {"Yes", "\"Yes\""},
                                    {"NULL", "\"NULL\""},
                                    {"n", "\"n\""},
                                    {"1", "\"1\""},
                                    {"1e3", "\"1e3\""},
                                    {"2026-01-01", "\"2026-01-01\""},
                                    {"- x", "\"- x\""},
                                    {"a: b", "\"a: b\""},
                                    {"a #b", "\"a #b\""},
                                    {"a:", "\"a:\""},
                                    {"two words", "\"two words\""},
                                    {"say \"x\\\"", R"("say \"x\\\"")"},
                                    {"李明", "\"李明\""},
                                    {"\n\x1b\u2028", R"("\U0000000a\U0000001b\U00002028")"}})
        EXPECT_EQ(yamlText(row.text), std::string("--- ") + row.shown + "\n");
}

TEST(JsonLines, HasALineForEachElementOrOneForTheDocument)
{
    EXPECT_EQ(documentText(Json::array({1, "x"}), Format::JsonLines), "1\n\"x\"\n");
    EXPECT_EQ(documentText({{"a", 1}}, Format::JsonLines), "{\"a\":1}\n");
    EXPECT_EQ(documentText(Json::array(), Format::JsonLines), "");
    EXPECT_EQ(documentText(Json::array(), Format::JsonText), "[]\n");
}

} // namespace yaml_test
