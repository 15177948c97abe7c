#include "mihost/cli/check/LogRules.h"

#include "host/VXLogger.h"

#include <gtest/gtest.h>

namespace log_rules_test
{

using namespace mihost;
using namespace mihost::checks;
using Operation = LogMessage::Operation;

LoggedCall logged(std::string const& text)
{
    return {Operation::Log, "f", "OsSwMI", 1, "Veltrix.IC.MI.OsSwMI", 3000, false, 0, 0, text};
}

LoggedCall traced(std::string const& text)
{
    LoggedCall call = logged(text);
    call.operation = Operation::Trace;
    return call;
}

Findings nesting(std::vector<std::string> const& texts)
{
    LoggedCalls calls;
    for (std::string const& text : texts)
        calls.push_back(logged(text));
    return wrongNesting(calls);
}

TEST(CheckOfTheLog, RequiresEachMessageLoggedAndThenTraced)
{
    EXPECT_EQ(wrongRepeats({logged("a"), traced("a"), logged("b"), traced("b")}), Findings());
    EXPECT_EQ(wrongRepeats({}), Findings{"nothing was logged"});
    EXPECT_EQ(wrongRepeats({traced("a"), logged("a"), traced("a")}),
              Findings{"traced but not logged before: a"});
    EXPECT_EQ(wrongRepeats({logged("a"), logged("b"), traced("b")}),
              Findings{"logged but not traced after: a"});
    EXPECT_EQ(wrongRepeats({logged("a")}), Findings{"logged but not traced after: a"});
}

TEST(CheckOfTheLog, ComparesEveryArgumentOfTheTwo)
{
    auto const change = [](auto const& edit) {
        LoggedCall other = traced("a");
        edit(other);
        return wrongRepeats({logged("a"), other}) ==
               Findings{"logged and traced with different arguments: a"};
    };
    EXPECT_TRUE(change([](LoggedCall& call) { call.function = "g"; }));
    EXPECT_TRUE(change([](LoggedCall& call) { call.file = "g"; }));
    EXPECT_TRUE(change([](LoggedCall& call) { call.line = 2; }));
    EXPECT_TRUE(change([](LoggedCall& call) { call.category = "g"; }));
    EXPECT_TRUE(change([](LoggedCall& call) { call.level = 6000; }));
    EXPECT_TRUE(change([](LoggedCall& call) { call.hasExtra = true; }));
    EXPECT_TRUE(change([](LoggedCall& call) { call.first = 1; }));
    EXPECT_TRUE(change([](LoggedCall& call) { call.second = 1; }));
    EXPECT_TRUE(change([](LoggedCall& call) { call.text = "g"; }));
}

TEST(CheckOfTheLog, RequiresFunctionUnitLineNullAndZeros)
{
    auto const isWrong = [](auto const& edit) {
        LoggedCall call = logged("a");
        edit(call);
        return wrongArguments({call}).size() == 1;
    };
    EXPECT_EQ(wrongArguments({logged("a")}), Findings());
    EXPECT_TRUE(isWrong([](LoggedCall& call) { call.function.clear(); }));
    EXPECT_TRUE(isWrong([](LoggedCall& call) { call.file.clear(); }));
    EXPECT_TRUE(isWrong([](LoggedCall& call) { call.line = 0; }));
    EXPECT_TRUE(isWrong([](LoggedCall& call) { call.hasExtra = true; }));
    EXPECT_TRUE(isWrong([](LoggedCall& call) { call.first = -1; }));
    EXPECT_TRUE(isWrong([](LoggedCall& call) { call.second = 5; }));
}

TEST(CheckOfTheLog, KnowsTheLevelsAndCategories)
{
    for (int const level : {3000, 4000, 6000}) {
        LoggedCall call = logged("a");
        call.level = level;
        EXPECT_EQ(wrongLevels({call}), Findings()) << level;
    }
    LoggedCall other = logged("a");
    other.level = 3001;
    EXPECT_EQ(wrongLevels({other}), Findings{"level 3001: a"});
    other.category = "Veltrix.IC.MI.OsSwMI.LogInfo";
    EXPECT_EQ(wrongCategories({other}), Findings());
    other.category = "Veltrix.IC.MI.OsSwMI.";
    EXPECT_EQ(wrongCategories({other}), Findings{"category 'Veltrix.IC.MI.OsSwMI.': a"});
}

TEST(CheckOfTheLog, FollowsEntriesAndExits)
{
    EXPECT_EQ(nesting({"a: entry", "b: entry", "b: exit", "text", "a: exit"}), Findings());
    EXPECT_EQ(nesting({"a: entry", "a: entry", "a: exit", "a: exit"}), Findings());
    EXPECT_EQ(nesting({"a: entry"}), Findings{"a: entry without an exit"});
    EXPECT_EQ(nesting({"a: exit"}), Findings{"a: exit without an entry"});
    EXPECT_EQ(nesting({"a: entry", "b: entry", "a: exit", "b: exit"}),
              (Findings{"b: entry without an exit before that of a", "b: exit without an entry"}));
}

TEST(CheckOfTheLog, AllowsSomeEntriesWithoutAnExit)
{
    EXPECT_EQ(nesting({"a: entry", "OsNode::OsNode: entry", "UserNode::~UserNode: entry",
                       "PropertyType::CreateUser: entry", "a: exit"}),
              Findings());
    EXPECT_EQ(nesting({"UserNode::UserNode: entry", "UserNode::UserNode: exit"}), Findings());
    EXPECT_EQ(nesting({"OsNode::getProperty: entry"}),
              Findings{"OsNode::getProperty: entry without an exit"});
}

TEST(CheckOfTheLog, KeepsEveryArgumentOfACall)
{
    LogRecord record;
    VXLog::VXLogger::logLevelMessage("f", "u", 7, "c", 4000, nullptr, 0, 0, "one");
    char extra = 'x';
    VXLog::VXLogger::traceLevelMessage(nullptr, nullptr, 8, "d", 6000, &extra, 1, 2, "two");
    LoggedCalls const calls = record.calls();
    ASSERT_EQ(calls.size(), 2U);
    EXPECT_EQ(calls[0].operation, Operation::Log);
    EXPECT_EQ(calls[0].function + calls[0].file + calls[0].category + calls[0].text, "fucone");
    EXPECT_EQ(calls[0].line, 7);
    EXPECT_EQ(calls[0].level, 4000);
    EXPECT_FALSE(calls[0].hasExtra);
    EXPECT_EQ(calls[1].operation, Operation::Trace);
    EXPECT_EQ(calls[1].function + calls[1].file, "");
    EXPECT_TRUE(calls[1].hasExtra);
    EXPECT_EQ(calls[1].first * 10 + calls[1].second, 12);
    record.forget();
    EXPECT_TRUE(record.calls().empty());
}

} // namespace log_rules_test
