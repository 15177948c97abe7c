#include "mihost/cli/output/Table.h"

#include "mihost/cli/output/Rows.h"
#include "mihost/cli/system/Failure.h"

#include <gtest/gtest.h>

namespace table_test
{

using mihost::Cell;
using mihost::Column;
using mihost::Failure;
using mihost::Json;
using mihost::Selection;
using mihost::Table;

Table people()
{
    Table table({{"name"}, {"id", Column::Align::Right, "311"}, {"shell"}}, {"name", "shell"});
    table.add({"root", Cell(0, "0"), "/bin/sh"});
    table.add({"jdoe", Cell(1000, "1000"), "/bin/bash"});
    table.add({"anna", Cell(999, "999"), ""});
    return table;
}

std::string chosen(Selection const& selection)
{
    return valueText(people().selected(selection));
}

std::string where(std::string const& condition)
{
    return chosen({{"name"}, "", {condition}});
}

std::string sortedBy(std::string const& column)
{
    return chosen({{"name"}, column, {}});
}

TEST(TableSelection, ShowsTheUsualColumnsUnlessOthersAreChosen)
{
    EXPECT_EQ(chosen({}), "root\t/bin/sh\njdoe\t/bin/bash\nanna\t\n");
    EXPECT_EQ(chosen({{"id", "name"}, "", {}}), "0\troot\n1000\tjdoe\n999\tanna\n");
    EXPECT_EQ(chosen({{"311"}, "-311", {"311~0"}}), "1000\n0\n");
}

TEST(TableSelection, SortsNumbersBySizeAndTextsByTheirLetters)
{
    EXPECT_EQ(sortedBy("id"), "root\nanna\njdoe\n");
    EXPECT_EQ(sortedBy("-id"), "jdoe\nanna\nroot\n");
    EXPECT_EQ(sortedBy("name"), "anna\njdoe\nroot\n");
}

TEST(TableSelection, SortsTextsOfDigitsAsNumbers)
{
    Table table({{"id"}});
    for (char const* id : {"1000", "x", "999", "0"})
        table.add({id});
    EXPECT_EQ(valueText(table.selected({{}, "id", {}})), "0\n999\n1000\nx\n");
}

TEST(TableSelection, KeepsTheOrderOfEqualRows)
{
    Table table({{"key"}, {"n"}});
    for (int number = 0; number < 30; ++number)
        table.add({number % 2 == 0 ? "b" : "a", Cell(number, std::to_string(number))});
    std::size_t last = 0;
    Table const sorted = table.selected({{}, "key", {"key=b"}});
    for (Table::Row const& row : sorted.rows()) {
        EXPECT_GE(row.number, last);
        last = row.number;
    }
    EXPECT_EQ(last, 28U);
}

TEST(TableSelection, KeepsRowsThatMeetAllConditions)
{
    EXPECT_EQ(where("shell=/bin/sh"), "root\n");
    EXPECT_EQ(where("shell=/bin"), "");
    EXPECT_EQ(where("shell~/bin"), "root\njdoe\n");
    EXPECT_EQ(where("shell="), "anna\n");
    EXPECT_EQ(chosen({{"name"}, "", {"shell~bin", "id=0"}}), "root\n");
}

TEST(TableSelection, TakesTheFirstOperatorAsTheConditions)
{
    Table table({{"text"}});
    table.add({"a=b"});
    table.add({"a~b"});
    EXPECT_EQ(valueText(table.selected({{}, "", {"text=a~b"}})), "a~b\n");
    EXPECT_EQ(valueText(table.selected({{}, "", {"text~a=b"}})), "a=b\n");
}

TEST(TableSelection, RefusesUnknownColumnsAndWhatIsNotACondition)
{
    std::string const noCondition =
        ": not a condition (use COLUMN=VALUE for equal, COLUMN~TEXT for containing)";
    struct Row {
        Selection selection;
        int code;
        std::string message;
    };
    for (Row const& row : std::initializer_list<Row>{
             {{{"none"}, "", {}}, mihost::NotFound, "no column 'none' (use name, id, shell)"},
             {{{"names"}, "", {}}, mihost::NotFound, "no column 'names' (did you mean name?)"},
             {{{""}, "", {}}, mihost::NotFound, "no column '' (use name, id, shell)"},
             {{{}, "none", {}}, mihost::NotFound, "no column 'none' (use name, id, shell)"},
             {{{}, "-", {}}, mihost::NotFound, "no column '' (use name, id, shell)"},
             {{{}, "", {"none=1"}}, mihost::NotFound, "no column 'none' (use name, id, shell)"},
             {{{}, "", {"name"}}, mihost::BadUsage, "--where name" + noCondition},
             {{{}, "", {"=root"}}, mihost::BadUsage, "--where =root" + noCondition},
         })
        try {
            people().selected(row.selection);
            ADD_FAILURE() << row.message;
        } catch (Failure const& failure) {
            EXPECT_EQ(failure.code(), row.code);
            EXPECT_EQ(failure.what(), row.message);
        }
}

TEST(TableAsJson, HasValuesInTheirOwnTypes)
{
    EXPECT_EQ(toJson(people().selected({{"id", "shell"}, "", {"id=0"}})).dump(),
              R"([{"id":0,"shell":"/bin/sh"}])");
}

TEST(TableAsCsv, QuotesTextsThatAReaderWouldSplit)
{
    Table table({{"a"}, {"b,c"}});
    table.add({"x,y", "say \"yes\""});
    table.add({" x", ""});
    EXPECT_EQ(csvText(table, true), "a,\"b,c\"\n\"x,y\",\"say \"\"yes\"\"\"\n\" x\",\n");
    EXPECT_EQ(csvText(Table({{"a"}}), false), "");
}

TEST(TableAsCsv, WritesAnEmptyOnlyFieldInQuotes)
{
    Table table({{"a"}});
    table.add({""});
    EXPECT_EQ(csvText(table, false), "\"\"\n");
}

TEST(TableAsCsvOrValues, HasARowOnEachLineForAnyTexts)
{
    Table table({{"a"}, {"b"}});
    table.add({"1\n2\r", "3\t4\x1b\xFF"});
    EXPECT_EQ(csvText(table, false), "1\\n2\\r,3\\t4\\x1b\\xff\n");
    EXPECT_EQ(valueText(table), "1\\n2\\r\t3\\t4\\x1b\\xff\n");
}

} // namespace table_test
