// What a write to the operating-system node does, stores and returns.

#include "nodes/OsNode.h"
#include "tests/interpose/Libc.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/Frame.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"
#include "tests/support/WideTexts.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <string>
#include <vector>

namespace os_node_writes_test
{

using IC::EnumValue;
using IC::Error;
using IC::Number;
using IC::PropertyValue;

std::string const useraddLine = "/usr/sbin/useradd jdoe 2>&1;echo rc=$? 2>&1";
std::string const chageLine = "/usr/bin/chage -E -1 jdoe 2>&1";
std::string const addition = "UserAdd,UserName:CMPI_string:jdoe";

class OsNodeWrites : public testing::Test
{
protected:
    OsNodeWrites()
    {
        commands_.answers[useraddLine] = "rc=0\n";
        commands_.answers[chageLine] = "";
        commands_.answers["wc -l /var/log/messages"] = "0 /var/log/messages\n";
        commands_.answers["/sbin/shutdown -r now"] = "";
        commands_.answers["/sbin/shutdown -h now"] = "";
        files_.write("/var/log/messages", oldLog);
    }

    Error write(unsigned int id, PropertyValue const& value)
    {
        return node_.setProperty(id, value);
    }

    Error write(unsigned int id, unsigned int number)
    {
        return write(id, PropertyValue(Number(number), true));
    }

    Error writeText(std::string const& text)
    {
        return write(74, PropertyValue(text, true));
    }

    std::string stored(unsigned int id) const
    {
        return storedValue(node_, id);
    }

    /** The builders that ran, in order. */
    static Lines rebuilt(Recording const& log)
    {
        Lines found;
        for (std::string const& text : log.texts())
            for (char const* builder :
                 {"createUserNodes", "createGroupNodes", "createLogEntryNodes"})
                if (text == std::string(builder) + ": entry")
                    found.emplace_back(builder);
        return found;
    }

    bool logWasCleared() const
    {
        return std::filesystem::file_size(files_.realPath("/var/log/messages")) == 0;
    }

    static constexpr char oldLog[] = "Nov 20 10:11:01 message\n";

    FakeFiles files_;
    FakeCommands commands_;
    Frame frame_;
    IC::OsNode node_{9, 7, {7}, 17, 0};
};

TEST_F(OsNodeWrites, OfNineOrTwelveToTheRequestedStateRunShutdown)
{
    struct {
        PropertyValue value;
        char const* command;
    } const cases[] = {{PropertyValue(EnumValue(9U), true), "/sbin/shutdown -r now"},
                       {PropertyValue(Number(12U), true), "/sbin/shutdown -h now"},
                       {PropertyValue("12", true), "/sbin/shutdown -h now"}};
    auto const expectShutdown = [this, &cases] {
        for (auto const& [value, command] : cases) {
            commands_.ran.clear();
            EXPECT_EQ(write(123, value).getStatus(), 0);
            EXPECT_EQ(commands_.ran, Lines{command});
            EXPECT_EQ(stored(123), shown(value));
        }
    };
    expectShutdown();
    commands_.answers.clear(); // it cannot be started
    expectShutdown();
}

TEST_F(OsNodeWrites, OfOtherNumbersToACommandAreOnlyStored)
{
    Recording const log;
    struct {
        unsigned int id;
        std::vector<unsigned int> numbers;
    } const cases[] = {{123, {0, 1, 5, 8, 10, 11, 13}}, {191, {0, 1, 8, 10, 12}}, {75, {1, 2, 9}}};
    for (auto const& [id, numbers] : cases)
        for (unsigned int const number : numbers) {
            EXPECT_EQ(write(id, number).getStatus(), 0);
            EXPECT_EQ(stored(id), "number " + std::to_string(number) + " true");
        }
    EXPECT_EQ(commands_.ran, Lines());
    EXPECT_EQ(rebuilt(log), Lines());
    EXPECT_FALSE(logWasCleared());
}

TEST_F(OsNodeWrites, OfNineInAnyFormToTheClearCommandClearTheLog)
{
    for (PropertyValue const& nine : {PropertyValue(Number(9U), true), PropertyValue("9", true),
                                      PropertyValue(EnumValue(9U), true)}) {
        files_.write("/var/log/messages", oldLog);
        Recording const log;
        EXPECT_EQ(write(191, nine).getStatus(), 0);
        EXPECT_TRUE(logWasCleared());
        EXPECT_EQ(rebuilt(log), Lines{"createLogEntryNodes"});
        EXPECT_EQ(stored(191), shown(nine));
    }
}

TEST_F(OsNodeWrites, KeepTheEntriesIfTheLogCannotBeCleared)
{
    libc::hooks().fopen = [](char const*, char const*) -> FILE* { return nullptr; };
    Recording const log;
    EXPECT_EQ(write(191, 9).getStatus(), 0);
    EXPECT_EQ(rebuilt(log), Lines());
    EXPECT_EQ(stored(191), "number 9 true");
    EXPECT_FALSE(logWasCleared());
}

TEST_F(OsNodeWrites, OfZeroToRefreshRebuildUsersAndThenGroups)
{
    for (PropertyValue const& value :
         {PropertyValue(Number(0U), true), PropertyValue("later", true)}) {
        Recording const log;
        EXPECT_EQ(write(75, value).getStatus(), 0);
        EXPECT_EQ(rebuilt(log), (Lines{"createUserNodes", "createGroupNodes"}));
        EXPECT_EQ(stored(75), shown(value));
    }
}

TEST_F(OsNodeWrites, PublishTheNodesThatTheyRebuild)
{
    files_.write("/etc/passwd", "root:x:0:0:root:/root:/bin/sh\n");
    files_.write("/etc/group", "root:x:0:\n");
    commands_.answers["wc -l /var/log/messages"] = "1 /var/log/messages\n";
    for (unsigned int round = 0; round < 2; ++round) {
        frame_.published.clear();
        frame_.deleted.clear();
        write(75, 0);
        EXPECT_EQ(frame_.published.size(), 2U);
        EXPECT_EQ(frame_.deleted.size(), 2U * round);
    }
    frame_.createLogNodes();
    for (unsigned int round = 0; round < 2; ++round) {
        frame_.published.clear();
        frame_.deleted.clear();
        write(191, 9);
        EXPECT_EQ(frame_.published.size(), 1U);
        EXPECT_EQ(frame_.deleted.size(), round);
    }
}

TEST_F(OsNodeWrites, OfAMethodRebuildUsersAndThenGroups)
{
    Recording const log;
    EXPECT_EQ(writeText(addition).getStatus(), 0);
    EXPECT_EQ(commands_.ran, (Lines{useraddLine, chageLine}));
    EXPECT_EQ(rebuilt(log), (Lines{"createUserNodes", "createGroupNodes"}));
    Lines const texts = log.texts();
    ASSERT_GE(texts.size(), 4U);
    EXPECT_EQ(
        Lines(texts.begin(), texts.begin() + 4),
        (Lines{"OsNode::setProperty: entry", "PropertyType::CreateUser: entry",
               "CreateUser: inMethodAndParams = " + addition, "OsNode::setCreateUser: entry"}));
    EXPECT_LT(std::find(texts.begin(), texts.end(), "OsNode::setCreateUser: exit"),
              std::find(texts.begin(), texts.end(), "createUserNodes: entry"));
    EXPECT_EQ(stored(74), "text " + addition + " true");
}

TEST_F(OsNodeWrites, OfAMethodKeepTheValueAsItWasWritten)
{
    write(74, PropertyValue(addition, false));
    EXPECT_EQ(stored(74), "text " + addition + " false");
}

TEST_F(OsNodeWrites, OfAMethodThatFailsReturnStatus1)
{
    commands_.answers[useraddLine] = "useradd: user 'jdoe' already exists\nrc=9\n";
    node_.IC::MutableNode::setProperty(74, PropertyValue("before", false));
    Recording const log;
    Error const error = writeText(addition);
    EXPECT_EQ(error.getStatus(), 1);
    EXPECT_EQ(static_cast<std::string>(error),
              static_cast<std::string>(Error(1, Number(Number::EmptyKind), "")));
    EXPECT_EQ(stored(74), "text  true");
    EXPECT_EQ(rebuilt(log), Lines());
}

TEST_F(OsNodeWrites, OfATextThatIsNotAMethodFail)
{
    for (char const* text : {"x", "dummy ", "Dummy", ",", "5", "UserAdd,A:CMPI_boolean:b"}) {
        EXPECT_EQ(writeText(text).getStatus(), 1) << text;
        EXPECT_EQ(stored(74), "text  true") << text;
    }
    EXPECT_EQ(commands_.ran, Lines());
}

TEST_F(OsNodeWrites, OfDummyOrOfNothingRunNoMethod)
{
    for (PropertyValue const& value : {PropertyValue("dummy", true), PropertyValue("", true),
                                       PropertyValue(PropertyValue::EmptyKind, true)}) {
        Recording const log;
        EXPECT_EQ(write(74, value).getStatus(), 0);
        EXPECT_EQ(stored(74), shown(value));
        EXPECT_EQ(log.texts(),
                  (Lines{"OsNode::setProperty: entry", "PropertyType::CreateUser: entry",
                         "OsNode::setProperty: exit"}));
    }
    EXPECT_EQ(commands_.ran, Lines());
}

TEST_F(OsNodeWrites, ThatContainPasswordAreNotLogged)
{
    for (char const* text : {"UserSetPassword", "x,Password:CMPI_string:s", "aPasswordb"}) {
        Recording const log;
        writeText(text);
        for (LogRecord const& record : log.records())
            EXPECT_EQ(record.text.find("inMethodAndParams"), std::string::npos) << text;
    }
}

TEST_F(OsNodeWrites, PassTheTextOnThroughWideTextByteForByte)
{
    std::string const name = "j\xC3\xB6rg\xFF\xE2\x82";
    commands_.answers["/usr/sbin/userdel " + name + " 2>&1"] = "";
    WideTexts const texts;
    EXPECT_EQ(writeText("UserDel,UserName:CMPI_string:" + name).getStatus(), 0);
    writeText("dummy");
    EXPECT_EQ(texts.widened, (Lines{"UserDel,UserName:CMPI_string:" + name, "dummy"}));
    EXPECT_EQ(texts.narrowed, texts.widened);
}

TEST_F(OsNodeWrites, AreStoredAfterTheirAction)
{
    struct {
        unsigned int id;
        PropertyValue value;
        char const* action; // a message that only the action logs
    } const commands[] = {
        {123, {Number(9U), true}, "Reboot after shutdown."},
        {123, {Number(12U), true}, "Halt after shutdown."},
        {191, {Number(9U), true}, "createLogEntryNodes: exit"},
        {75, {Number(0U), true}, "createGroupNodes: exit"},
        {74, {addition, true}, "createGroupNodes: exit"},
    };
    for (auto const& command : commands) {
        node_.IC::MutableNode::setProperty(command.id, PropertyValue("before", true));
        struct StoredAt : mihost::LogSink {
            void write(mihost::LogMessage const& message) override
            {
                if (message.text == action)
                    stored = storedValue(*node, id);
            }
            IC::MutableNode const* node = nullptr;
            unsigned int id = 0;
            std::string action;
            std::string stored;
        } sink;
        sink.node = &node_;
        sink.id = command.id;
        sink.action = command.action;
        mihost::setLogSink(&sink);
        write(command.id, command.value);
        mihost::setLogSink(nullptr);
        EXPECT_EQ(sink.stored, "text before true") << command.action;
        EXPECT_EQ(stored(command.id), shown(command.value)) << command.action;
    }
}

TEST_F(OsNodeWrites, OfAnyOtherPropertyAreStoredOnly)
{
    for (unsigned int const id :
         {0U,   9U,   73U,  76U,  108U, 125U, 128U, 134U, 138U, 139U, 140U, 141U, 142U, 143U, 144U,
          145U, 146U, 147U, 148U, 149U, 150U, 151U, 152U, 153U, 154U, 155U, 190U, 192U, 4711U}) {
        Recording const log;
        EXPECT_EQ(write(id, 9).getStatus(), 0);
        EXPECT_EQ(stored(id), "number 9 true");
        EXPECT_EQ(log.texts(), (Lines{"OsNode::setProperty: entry", "OsNode::setProperty: exit"}));
    }
    EXPECT_EQ(commands_.ran, Lines());
}

TEST_F(OsNodeWrites, LogTheirExitOnEveryPathUnderTheFramesName)
{
    commands_.answers.clear();
    for (unsigned int const id : {123U, 191U, 75U, 74U, 108U}) {
        Recording const log;
        write(id, 9);
        EXPECT_EQ(log.texts().front(), "OsNode::setProperty: entry");
        EXPECT_EQ(log.texts().back(), "OsNode::setProperty: exit");
        Lines const sources = log.sources();
        EXPECT_EQ(
            std::count(sources.begin(), sources.end(), "setProperty OsSwMI Veltrix.IC.MI.OsSwMI"),
            1);
    }
}

TEST_F(OsNodeWrites, UseTheTextFormOfAnyValueAsAMethod)
{
    Recording const log;
    EXPECT_EQ(write(74, 5).getStatus(), 1);
    EXPECT_TRUE(log.has("CreateUser: inMethodAndParams = 5", 3000));
    EXPECT_TRUE(log.has("Unknown method: 5", 6000));
}

} // namespace os_node_writes_test
