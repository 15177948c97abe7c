#include "nodes/UserNode.h"

#include "nodes/nodeValues.h"
#include "sysdata/minMaxId.h"
#include "tests/interpose/Libc.h"
#include "tests/support/Account.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/Frame.h"
#include "tests/support/Lines.h"
#include "tests/support/MutexCalls.h"
#include "tests/support/Recording.h"
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <new>
#include <string>
#include <vector>

namespace user_nodes_test
{

/** A machine with three users. */
class UserNodes : public testing::Test
{
protected:
    UserNodes()
    {
        useZone("UTC0");
        files.write("/etc/login.defs", "UID_MIN 500\nUID_MAX 60000\n");
        files.write("/etc/passwd",
                    account("root", 0) + account("anna", 1000) + account("ben", 1001));
    }

    std::vector<IC::MutableNode*> users() const
    {
        return frame.ofType(46);
    }

    FakeFiles const files;
    Frame frame;
};

TEST_F(UserNodes, HoldTwentyFourPropertiesInTheOrderThatHostsSee)
{
    files.write("/etc/passwd", "anna:x:1000:100:Anna,,,:/home/a:/bin/ksh\n");
    files.write("/etc/shadow", "anna:$6$salt$hash:14000:1:90:14:30:15000:\n");
    files.write("/etc/pam.d/login", "auth required pam_tally2.so deny=3\n");
    struct {
        unsigned int id;
        char const* value;
    } const properties[] = {
        {123, "enumeration 1 true"}, {125, "numbers 0,1,24 true"},    {108, "text anna true"},
        {109, "number 4 true"},      {89, "text 1000 true"},          {90, "number 4 true"},
        {311, "text 100 true"},      {312, "text Anna,,, true"},      {158, "text /home/a true"},
        {159, "text /bin/ksh true"}, {117, "text $6$salt$hash true"}, {120, "number 12 true"},
        {163, "number 90 true"},     {162, "number 14 true"},         {161, "number 1 true"},
        {44, "number 30 true"},      {118, "date 1296000000 true"},   {119, "number 0 true"},
        {113, "text  true"},         {91, "date 1296000000 true"},    {160, "date 1209600000 true"},
        {106, "number 3 true"},      {138, "boolean false true"},     {51, "number 1 true"},
    };
    NodeCalls const calls;
    frame.createUserNodes(false);
    Lines expected{"setStatus(1)", "setDescription(User Account)"};
    for (auto const& [id, value] : properties) {
        expected.push_back("setProperty(" + std::to_string(id) + ")");
        EXPECT_EQ(storedValue(*users().at(0), id), value) << id;
    }
    EXPECT_EQ(calls.calls, expected);
}

TEST_F(UserNodes, CountTheBytesOfTheirNameAndTheDigitsOfTheirId)
{
    files.write("/etc/passwd",
                account("christopher", 1000) + account("jo", 50001) + account("j\xC3\xB6rg", 1002));
    frame.createUserNodes(false);
    ASSERT_EQ(users().size(), 3U);
    EXPECT_EQ(storedValue(*users()[0], 109), "number 11 true");
    EXPECT_EQ(storedValue(*users()[0], 90), "number 4 true");
    EXPECT_EQ(storedValue(*users()[1], 109), "number 2 true");
    EXPECT_EQ(storedValue(*users()[1], 90), "number 5 true");
    EXPECT_EQ(storedValue(*users()[2], 109), "number 5 true");
}

TEST_F(UserNodes, HaveTheSystemsDefaultsForEmptyAgeingFields)
{
    files.write("/etc/passwd", account("anna", 1000));
    files.write("/etc/shadow", "anna:!:::::::\n");
    frame.createUserNodes(false);
    ASSERT_EQ(users().size(), 1U);
    IC::MutableNode const& anna = *users()[0];
    EXPECT_EQ(storedValue(anna, 163), "number 99999 true");
    EXPECT_EQ(storedValue(anna, 162), "number 7 true");
    EXPECT_EQ(storedValue(anna, 161), "number 0 true");
    EXPECT_EQ(storedValue(anna, 44), "number 99999 true");
    EXPECT_EQ(storedValue(anna, 118), "date 2147472000 true");
    EXPECT_EQ(storedValue(anna, 91), "date 2147472000 true");
}

TEST_F(UserNodes, ShowTheAccountsAsTheyAreAtTheRefresh)
{
    frame.createUserNodes(false);
    files.write("/etc/passwd", account("ben", 1001) + account("new", 1002));
    frame.createUserNodes(true);
    ASSERT_EQ(users().size(), 2U);
    EXPECT_EQ(storedValue(*users()[0], 108), "text ben true");
    EXPECT_EQ(storedValue(*users()[1], 108), "text new true");
    EXPECT_EQ(storedValue(*users()[1], 51), "number 2 true");
}

TEST_F(UserNodes, AreBuiltUnderTheSharedLockWithoutTimeLimit)
{
    NQ::minMaxId::Instance();
    for (bool const refresh : {false, true}) {
        Lines steps;
        MutexCalls mutexes;
        mutexes.onLock = [&steps](NQ::Mutex const& mutex, unsigned long timeout) {
            if (&mutex == &IC::OSSWMI::myuserlock)
                steps.push_back("lock " + std::to_string(timeout));
        };
        mutexes.onUnlock = [&steps](NQ::Mutex const& mutex) {
            if (&mutex == &IC::OSSWMI::myuserlock)
                steps.emplace_back("unlock");
            return 0;
        };
        std::size_t const deletedBefore = frame.deleted.size();
        auto const onOpen = libc::hooks().fopen.answer();
        libc::hooks().fopen = [&, onOpen](char const* path, char const* mode) {
            if (std::string(path) == "/etc/passwd")
                steps.push_back("list, deleted " +
                                std::to_string(frame.deleted.size() - deletedBefore));
            return onOpen(path, mode);
        };
        frame.createUserNodes(refresh);
        libc::hooks().fopen = onOpen;
        EXPECT_EQ(steps, (Lines{"lock 4294967295", refresh ? "list, deleted 3" : "list, deleted 0",
                                "unlock"}));
    }
}

TEST_F(UserNodes, AreNoneWithoutAnAccountFileAndTheLockIsReleased)
{
    files.remove("/etc/passwd");
    int locks = 0;
    int unlocks = 0;
    MutexCalls mutexes;
    mutexes.onLock = [&locks](NQ::Mutex const&, unsigned long) { ++locks; };
    mutexes.onUnlock = [&unlocks](NQ::Mutex const&) {
        ++unlocks;
        return 0;
    };
    frame.createUserNodes(false);
    EXPECT_TRUE(users().empty());
    EXPECT_EQ(locks, 1);
    EXPECT_EQ(unlocks, 1);
}

/** Records the flag at each message, and throws at the message throwAt. */
class FlagAtMessages : public mihost::LogSink
{
public:
    FlagAtMessages()
    {
        mihost::setLogSink(this);
    }
    ~FlagAtMessages() override
    {
        mihost::setLogSink(nullptr);
    }

    void write(mihost::LogMessage const& message) override
    {
        if (message.operation == mihost::LogMessage::Operation::Trace)
            return;
        std::string& seen = at[message.text];
        seen += IC::OSSWMI::MI_call ? '1' : '0';
        if (message.text == throwAt)
            throw std::bad_alloc();
    }

    std::map<std::string, std::string> at;
    std::string throwAt;
};

TEST_F(UserNodes, SetTheFlagOnlyWhileTheirPropertiesAreStored)
{
    files.write("/etc/passwd", account("root", 0));
    FlagAtMessages flag;
    frame.createUserNodes(false);
    frame.createUserNodes(true);
    EXPECT_EQ(flag.at["UserNode::UserNode: entry"], "00");
    EXPECT_EQ(flag.at["UserNode::setProperty: entry"], std::string(48, '1'));
    EXPECT_EQ(flag.at["UserNode::setProperty: exit"], std::string(48, '1'));
    EXPECT_EQ(flag.at["publishNode: entry"], "0");
    EXPECT_EQ(flag.at["createUserNodes: exit"], "00");
    EXPECT_FALSE(IC::OSSWMI::MI_call);
}

TEST_F(UserNodes, ReleaseFlagAndLockWhenAnExceptionPasses)
{
    FlagAtMessages flag;
    flag.throwAt = "getPwdMinDays: entry";
    int unlocks = 0;
    MutexCalls mutexes;
    mutexes.onUnlock = [&unlocks](NQ::Mutex const&) {
        ++unlocks;
        return 0;
    };
    EXPECT_THROW(frame.createUserNodes(false), std::bad_alloc);
    EXPECT_FALSE(IC::OSSWMI::MI_call);
    EXPECT_EQ(unlocks, 1);
}

TEST_F(UserNodes, AnswerTheirCountWithoutALock)
{
    frame.createUserNodes(false);
    int locks = 0;
    MutexCalls mutexes;
    mutexes.onLock = [&locks](NQ::Mutex const&, unsigned long) { ++locks; };
    IC::PropertyValue value = IC::values::emptyValue();
    users()[0]->getProperty(51, value);
    EXPECT_EQ(locks, 0);
}

TEST_F(UserNodes, LogAReadUnderTheConstructorsName)
{
    frame.createUserNodes(false);
    IC::PropertyValue value = IC::values::emptyValue();
    Recording log;
    users()[0]->getProperty(108, value);
    EXPECT_EQ(log.texts(3000), (Lines{"UserNode::UserNode: entry", "UserNode::UserNode: exit"}));
    EXPECT_EQ(log.sources(), Lines{"getProperty OsSwMI Veltrix.IC.MI.OsSwMI"});
    log.clear();
    users()[0]->getProperty(51, value);
    Lines const texts = log.texts(3000);
    EXPECT_EQ(texts.front(), "UserNode::UserNode: entry");
    EXPECT_EQ(texts.at(1), "getUserInfo: entry");
    EXPECT_EQ(texts.back(), "UserNode::UserNode: exit");
}

} // namespace user_nodes_test
