#include "mihost/cli/input/Choices.h"

#include <CLI/Config.hpp>
#include <CLI/Formatter.hpp>
#include <gtest/gtest.h>

namespace choices_test
{

using mihost::Choices;
using mihost::ChoiceTable;

class ChoiceTableTest : public testing::Test
{
protected:
    /** @return what is wrong with the word; empty if it is accepted */
    std::string objectionTo(std::string const& word)
    {
        try {
            app_.parse(std::vector<std::string>{word});
        } catch (CLI::ParseError const& error) {
            return error.what();
        }
        return "";
    }

    CLI::App app_;
    std::string word_;
    CLI::Option* option_ = app_.add_option("ACTION", word_);
    ChoiceTable table_;
};

TEST_F(ChoiceTableTest, AcceptsOnlyTheWordsOfAnOption)
{
    table_.restrict(option_, {"restart", "halt"});
    EXPECT_EQ(objectionTo("halt"), "");
    EXPECT_EQ(word_, "halt");
    EXPECT_EQ(objectionTo("Halt"), "ACTION: unknown value 'Halt' (did you mean halt?)");
    EXPECT_EQ(objectionTo("sleep"), "ACTION: unknown value 'sleep' (use restart, halt)");
}

TEST_F(ChoiceTableTest, KnowsTheWordsOfItsOptions)
{
    EXPECT_EQ(table_.find(*option_), nullptr);
    table_.restrict(option_, {"restart", "halt"});
    ASSERT_NE(table_.find(*option_), nullptr);
    EXPECT_EQ(*table_.find(*option_), (Choices{"restart", "halt"}));
}

TEST_F(ChoiceTableTest, ShowsFewWordsInTheHelpAndLeavesOutMany)
{
    table_.restrict(option_, {"restart", "halt"});
    EXPECT_NE(app_.help().find("ACTION restart|halt"), std::string::npos) << app_.help();
    std::string const longWord(40, 'x');
    table_.restrict(option_, {"restart", longWord});
    EXPECT_EQ(app_.help().find("restart|"), std::string::npos) << app_.help();
}

} // namespace choices_test
