// YAML, JSON lines and CSV: their forms, and arbitrary texts read back by Python.

#include "mihost/cli/output/Document.h"
#include "mihost/cli/output/Rows.h"
#include "mihost/runtime/Text.h"
#include "tests/support/Program.h"

#include <gtest/gtest.h>
#include <random>

namespace document_test
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

bool hasPython(char const* module)
{
    return runToEnd({"/usr/bin/env", "python3", "-c", std::string("import ") + module}).code == 0;
}

/** @return the text as JSON, as the Python program reads it from its standard input */
std::string readBack(std::string const& program, std::string const& text)
{
    Outcome const outcome =
        runToEnd({"/usr/bin/env", "PYTHONIOENCODING=utf-8", "python3", "-X", "utf8", "-c",
                  "import sys, json\n" + program +
                      "\nsys.stdout.write(json.dumps(result, ensure_ascii=False))"},
                 text);
    EXPECT_EQ(outcome.code, 0) << outcome.err;
    return outcome.out;
}

/** Texts that a reader might read wrongly. */
class Texts
{
public:
    std::string next()
    {
        static std::vector<std::string> const pieces = {
            "a",      "yes",    "null",   "~",   " ",         "-",    ":",      ": ",     "#",
            " #",     "\"",     "'",      "\\",  ",",         "\n",   "\r",     "\t",     "0",
            "1e3",    "0x1",    "---",    "...", "{",         "}",    "[",      "]",      "&",
            "*",      "!",      "|",      ">",   "%",         "@",    "`",      "?",      "=",
            "<<",     "ä",      "李",     "😀",   "\x01",      "\x7F", "\u0085", "\u00A0", "\u2028",
            "\u202E", "\uFEFF", "\uFFFE", ".5",  "2026-01-01"};
        std::string text;
        for (std::size_t left = random_() % 5; left > 0; --left)
            text += pieces[random_() % pieces.size()];
        return text;
    }

private:
    std::mt19937 random_{42};
};

constexpr int rounds = 3000;

TEST(Yaml, IsReadBackAsItWasWritten)
{
    if (!hasPython("yaml"))
        GTEST_SKIP() << "no python3 with yaml here";
    Texts texts;
    Json list = Json::array();
    for (int round = 0; round < rounds; ++round)
        list.push_back({{texts.next(), texts.next()},
                        {"list", {texts.next(), round, nullptr, true, 0.5, Json::array()}},
                        {"nested", {{{"x", texts.next()}}, {{"y", Json::object()}}}}});
    list.push_back(1e-05);
    Json const read = Json::parse(readBack(
        "import yaml\nresult = yaml.load(sys.stdin, getattr(yaml, 'CSafeLoader', yaml.SafeLoader))",
        mihost::yamlText(list)));
    ASSERT_EQ(read.size(), list.size());
    for (std::size_t at = 0; at < list.size(); ++at)
        EXPECT_EQ(read[at].dump(), list[at].dump());
}

TEST(Csv, IsReadBackAsItWasWritten)
{
    if (!hasPython("csv"))
        GTEST_SKIP() << "no python3 here";
    Texts texts;
    mihost::Table table({{"one"}, {"two"}, {"three"}});
    Json expected = Json::array();
    for (int round = 0; round < rounds; ++round) {
        std::vector<std::string> const row = {texts.next(), texts.next(), texts.next()};
        table.add({row[0], row[1], row[2]});
        Json fields = Json::array();
        for (std::string const& text : row)
            fields.push_back(mihost::printable(text));
        expected.push_back(fields);
    }
    Json const read = Json::parse(readBack(
        "import csv\nresult = list(csv.reader(sys.stdin, strict=True))", csvText(table, false)));
    ASSERT_EQ(read.size(), expected.size());
    for (std::size_t at = 0; at < expected.size(); ++at)
        EXPECT_EQ(read[at].dump(), expected[at].dump());
}

} // namespace document_test
