// YAML and CSV of arbitrary texts, read back by Python.

#include "mihost/cli/output/Document.h"
#include "mihost/cli/output/Rows.h"
#include "mihost/runtime/Text.h"
#include "tests/support/Program.h"

#include <gtest/gtest.h>
#include <random>

namespace parsed_back_test
{

using mihost::Json;

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

} // namespace parsed_back_test
