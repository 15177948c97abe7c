#include "util/MyProcess.h"

#include "sysdata/groupInfo_linux.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace method_tokenize_test
{

Lines tokens(std::string const& text, std::string const& delimiters)
{
    Lines found;
    NQ::Tokenize(text, found, delimiters);
    return found;
}

TEST(Tokenize, AppendsEveryRunThatHoldsNoDelimiterInOrder)
{
    EXPECT_EQ(tokens("one,two,three", ","), (Lines{"one", "two", "three"}));
}

TEST(Tokenize, SplitsAtEveryCharacterOfTheSet)
{
    EXPECT_EQ(tokens("one:two,three:,four", ",:"), (Lines{"one", "two", "three", "four"}));
}

TEST(Tokenize, MakesNoEmptyTokensOfRunsAndEnds)
{
    EXPECT_EQ(tokens(",,one,,,two,", ","), (Lines{"one", "two"}));
}

TEST(Tokenize, FindsNothingInAnEmptyTextOrOnlyDelimiters)
{
    EXPECT_EQ(tokens("", ","), Lines());
    EXPECT_EQ(tokens(",,,", ","), Lines());
}

TEST(Tokenize, YieldsTheWholeTextIfItHoldsNoDelimiter)
{
    EXPECT_EQ(tokens("one two", ","), Lines{"one two"});
    EXPECT_EQ(tokens("one,two", ""), Lines{"one,two"});
}

TEST(Tokenize, DoesNotClearTheList)
{
    Lines found{"before"};
    NQ::Tokenize("one,two", found, ",");
    EXPECT_EQ(found, (Lines{"before", "one", "two"}));
}

TEST(Tokenize, LogsEachTokenBetweenEntryAndExit)
{
    Recording const log;
    tokens("one,two", ",");
    EXPECT_EQ(log.texts(), (Lines{"Tokenize: entry", "str.substr(lastPos, pos - lastPos) = one",
                                  "str.substr(lastPos, pos - lastPos) = two", "Tokenize: exit"}));
}

TEST(Tokenize, LogsAtLevel3000AsTheCommandRunner)
{
    Recording const log;
    tokens("one", ",");
    std::vector<LogRecord> const records = log.records();
    ASSERT_EQ(records.size(), 6U);
    for (std::size_t at = 0; at < records.size(); ++at) {
        EXPECT_EQ(records[at].trace, at % 2 == 1);
        EXPECT_EQ(records[at].text, records[at - at % 2].text);
        EXPECT_EQ(records[at].function, "Tokenize");
        EXPECT_EQ(records[at].file, "MyProcess");
        EXPECT_EQ(records[at].category, "Veltrix.IC.MI.OsSwMI.MyProcess");
        EXPECT_EQ(records[at].level, 3000);
    }
}

TEST(Tokenize, LogsNoTokenOfATextThatHoldsPasswordAnywhere)
{
    for (char const* text : {"one,Password", "Password,one", "one,aPasswordb,two"}) {
        Recording const log;
        tokens(text, ",");
        EXPECT_EQ(log.texts(), (Lines{"Tokenize: entry", "Tokenize: exit"})) << text;
    }
}

TEST(Tokenize, LooksForPasswordInTheWholeTextAndNotInItsTokens)
{
    Recording const log;
    tokens("one,Pass,word", ",");
    EXPECT_EQ(log.remarks().size(), 3U);
    EXPECT_EQ(tokens("one,Password", ","), (Lines{"one", "Password"}));
}

TEST(Tokenize, LogsATextThatHoldsPasswordInLowerCaseOnly)
{
    Recording const log;
    tokens("password", ",");
    EXPECT_EQ(log.remarks(), Lines{"str.substr(lastPos, pos - lastPos) = password"});
}

/** Records how many tokens the list holds when each of them is logged. */
class CountAtLog : public mihost::LogSink
{
public:
    explicit CountAtLog(Lines const& tokens) : tokens_(tokens)
    {
        mihost::setLogSink(this);
    }
    ~CountAtLog() override
    {
        mihost::setLogSink(nullptr);
    }

    void write(mihost::LogMessage const& message) override
    {
        if (message.operation == mihost::LogMessage::Operation::Log &&
            std::string(message.text).rfind("str.substr", 0) == 0)
            counts.push_back(tokens_.size());
    }

    std::vector<std::size_t> counts;

private:
    Lines const& tokens_;
};

TEST(Tokenize, LogsEachTokenBeforeItAppendsIt)
{
    Lines found;
    CountAtLog const log(found);
    NQ::Tokenize("one,two", found, ",");
    EXPECT_EQ(log.counts, (std::vector<std::size_t>{0, 1}));
}

TEST(GroupTokenize, AppendsEachPieceBeforeItLogsIt)
{
    Lines found;
    CountAtLog const log(found);
    NQ::groupInfo().Tokenize("one,two", found, ",");
    EXPECT_EQ(log.counts, (std::vector<std::size_t>{1, 2}));
}

} // namespace method_tokenize_test
