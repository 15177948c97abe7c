#include "util/MyProcess.h"

#include "sysdata/groupInfo_linux.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <functional>
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
    struct {
        char const* text;
        char const* delimiters;
        Lines tokens;
    } const cases[] = {{"one,two,three", ",", {"one", "two", "three"}},
                       {"one:two,three:,four", ",:", {"one", "two", "three", "four"}},
                       {"a:b,c;d", ",:", {"a", "b", "c;d"}},
                       {",,one,,,two,", ",", {"one", "two"}},
                       {"", ",", {}},
                       {",,,", ",", {}},
                       {"one two", ",", {"one two"}},
                       {"one,two", "", {"one,two"}}};
    for (auto const& [text, delimiters, tokens] : cases) {
        Lines expected{"before"};
        expected.insert(expected.end(), tokens.begin(), tokens.end());
        Lines found{"before"};
        NQ::Tokenize(text, found, delimiters);
        EXPECT_EQ(found, expected) << text;
        found = {"before"};
        NQ::groupInfo().Tokenize(text, found, delimiters);
        EXPECT_EQ(found, expected) << text;
    }
}

TEST(Tokenize, LogsEachTokenBetweenEntryAndExit)
{
    struct {
        char const* source;
        std::function<void()> run;
    } const cases[] = {
        {"Tokenize MyProcess Veltrix.IC.MI.OsSwMI.MyProcess", [] { tokens("one,two", ","); }},
        {"Tokenize groupInfo_linux Veltrix.IC.MI.OsSwMI.GroupInfo", [] {
             Lines found;
             NQ::groupInfo().Tokenize("one,two", found, ",");
         }}};
    for (auto const& [source, run] : cases) {
        Recording const log;
        run();
        EXPECT_EQ(log.texts(3000),
                  (Lines{"Tokenize: entry", "str.substr(lastPos, pos - lastPos) = one",
                         "str.substr(lastPos, pos - lastPos) = two", "Tokenize: exit"}));
        EXPECT_EQ(log.sources(), Lines{source});
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
    for (std::string const text : {"one,Pass,word", "password"}) {
        Recording const log;
        std::size_t const count = tokens(text, ",").size();
        EXPECT_EQ(log.remarks().size(), count);
    }
    EXPECT_EQ(tokens("one,Password", ","), (Lines{"one", "Password"}));
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

TEST(Tokenize, LogsATokenBeforeAppendingItForGroupsAfter)
{
    Lines found;
    CountAtLog const log(found);
    NQ::Tokenize("one,two", found, ",");
    found.clear();
    NQ::groupInfo().Tokenize("one,two", found, ",");
    EXPECT_EQ(log.counts, (std::vector<std::size_t>{0, 1, 1, 2}));
}

} // namespace method_tokenize_test
