// What writing a property of a user node does to the system.

#include "nodes/UserNode.h"

#include "nodes/nodeValues.h"
#include "tests/interpose/Libc.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/Frame.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"
#include "tests/support/TimeZone.h"
#include "tests/support/WideTexts.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

namespace user_writes_test
{

constexpr char const* setPasswords = "chpasswd -e < usrandpwd ; rm -f usrandpwd";

Lines sorted(Lines texts)
{
    std::sort(texts.begin(), texts.end());
    return texts;
}

/** The node of anna, UID 1000, in its own working directory. */
class UserWrite : public testing::Test
{
protected:
    UserWrite()
    {
        useZone("UTC0");
        files.write("/etc/login.defs", "UID_MIN 500\nUID_MAX 60000\n");
        files.write("/etc/passwd", "anna:x:1000:100:Anna:/home/anna:/bin/sh\n");
        frame.createUserNodes(false);
        std::string const folder = files.realPath("/here");
        std::filesystem::create_directories(folder);
        std::filesystem::current_path(folder);
    }

    void TearDown() override
    {
        std::filesystem::current_path("/");
    }

    IC::MutableNode& anna() const
    {
        return *frame.ofType(46).at(0);
    }

    void write(unsigned int id, IC::PropertyValue const& value)
    {
        EXPECT_EQ(static_cast<std::string>(anna().setProperty(id, value)), "status 0");
    }

    FakeFiles const files;
    Frame frame;
    FakeCommands commands;
    Recording log;
};

/** Records the password file when chpasswd starts. */
class PasswordWrite : public UserWrite
{
protected:
    PasswordWrite()
    {
        auto const start = libc::hooks().popen.answer();
        libc::hooks().popen = [this, start](char const* command, char const* mode) {
            handedOver.push_back(contentOf("usrandpwd"));
            return start(command, mode);
        };
    }

    Lines handedOver;
};

TEST_F(PasswordWrite, PassesNameAndPasswordInAFile)
{
    commands.answers[setPasswords] = "";
    write(117, IC::values::text("$6$salt$hash"));
    EXPECT_EQ(commands.ran, Lines{setPasswords});
    EXPECT_EQ(commands.modes, Lines{"r"});
    EXPECT_EQ(handedOver, Lines{"anna:$6$salt$hash\n"});
    EXPECT_EQ(commands.open, 0);
    EXPECT_EQ(storedValue(anna(), 117), "text $6$salt$hash true");
    EXPECT_TRUE(log.texts(6000).empty());
}

TEST_F(PasswordWrite, EmptiesAFileThatIsThereAlready)
{
    std::ofstream("usrandpwd") << "root:x\nanna:an older and much longer password\n";
    write(117, IC::values::text("new"));
    EXPECT_EQ(handedOver, Lines{"anna:new\n"});
}

TEST_F(PasswordWrite, UsesTheNodesCurrentName)
{
    write(108, IC::values::text("renamed"));
    write(117, IC::values::text("new"));
    EXPECT_EQ(handedOver, Lines{"renamed:new\n"});
}

TEST_F(PasswordWrite, IsStoredEvenIfChpasswdCannotBeStarted)
{
    write(117, IC::values::text("new"));
    EXPECT_EQ(log.texts(6000),
              Lines{"Cannot open process: chpasswd -e < usrandpwd ; rm -f usrandpwd"});
    EXPECT_EQ(storedValue(anna(), 117), "text new true");
    for (LogRecord const& record : log.records())
        if (record.level == 6000) {
            EXPECT_EQ(record.function, "setProperty");
            EXPECT_EQ(record.file, "OsSwMI");
            EXPECT_EQ(record.category, "Veltrix.IC.MI.OsSwMI");
        }
}

TEST_F(PasswordWrite, StartsChpasswdEvenIfTheFileCannotBeCreated)
{
    std::filesystem::create_directory("usrandpwd");
    commands.answers[setPasswords] = "";
    write(117, IC::values::text("new"));
    EXPECT_EQ(commands.ran, Lines{setPasswords});
    EXPECT_TRUE(std::filesystem::is_directory("usrandpwd"));
    EXPECT_EQ(storedValue(anna(), 117), "text new true");
}

TEST_F(PasswordWrite, OfTheBuilderWritesNoFileAndRunsNothing)
{
    IC::OSSWMI::MI_call = true;
    write(117, IC::values::text("new"));
    IC::OSSWMI::MI_call = false;
    EXPECT_EQ(commands.ran, Lines{});
    EXPECT_FALSE(std::filesystem::exists("usrandpwd"));
    EXPECT_EQ(storedValue(anna(), 117), "text new true");
}

TEST_F(PasswordWrite, IsNeverLogged)
{
    commands.answers[setPasswords] = "";
    write(117, IC::values::text("$6$salt$hash"));
    for (std::string const& text : log.texts())
        EXPECT_EQ(text.find("$6$salt$hash"), std::string::npos) << text;
}

TEST_F(PasswordWrite, PassesItsTextsThroughWideText)
{
    WideTexts const texts;
    write(117, IC::values::text("new"));
    EXPECT_EQ(sorted(texts.widened), (Lines{"anna", "new"}));
    EXPECT_EQ(texts.narrowed, texts.widened);
}

TEST_F(UserWrite, OfAnInactiveTimeCountsFromTheExpiry)
{
    commands.answers = {{"chage -l anna", "Password expires : Jan 01, 2008\n"},
                        {"chage -I 10 anna", ""}};
    write(118, IC::values::text("2008-01-11 00:00:00"));
    EXPECT_EQ(commands.ran, (Lines{"chage -l anna", "chage -I 10 anna"}));
    EXPECT_EQ(storedValue(anna(), 118), "text 2008-01-11 00:00:00 true");
}

TEST_F(UserWrite, OfAPasswordExpirationCountsFromTheChange)
{
    commands.answers = {{"chage -l anna", "Last password change : Jan 01, 2008\n"},
                        {"chage -M 10 anna", ""}};
    write(91, IC::values::text("2008-01-11 00:00:00"));
    EXPECT_EQ(commands.ran, (Lines{"chage -l anna", "chage -M 10 anna"}));
    EXPECT_EQ(storedValue(anna(), 91), "text 2008-01-11 00:00:00 true");
}

TEST_F(UserWrite, OfADateUsesItsTextForm)
{
    commands.answers = {{"chage -l anna", "Password expires : Jan 01, 2008\n"
                                          "Last password change : Jan 02, 2008\n"}};
    write(118, IC::values::date(1200009600));
    write(91, IC::values::date(1200009600));
    EXPECT_EQ(commands.ran,
              (Lines{"chage -l anna", "chage -I 10 anna", "chage -l anna", "chage -M 9 anna"}));
    EXPECT_EQ(storedValue(anna(), 118), "date 1200009600 true");
    EXPECT_EQ(storedValue(anna(), 91), "date 1200009600 true");
}

TEST_F(UserWrite, OfADatePassesDateAndNameThroughWideText)
{
    for (unsigned int const id : {118U, 91U}) {
        WideTexts const texts;
        write(id, IC::values::text("2008-01-11 00:00:00"));
        EXPECT_EQ(sorted(texts.widened), (Lines{"2008-01-11 00:00:00", "anna"}));
        EXPECT_EQ(texts.narrowed, texts.widened);
    }
}

TEST_F(UserWrite, IsStoredEvenIfTheCommandFails)
{
    write(118, IC::values::text("tomorrow"));
    write(91, IC::values::text("tomorrow"));
    EXPECT_EQ(storedValue(anna(), 118), "text tomorrow true");
    EXPECT_EQ(storedValue(anna(), 91), "text tomorrow true");
    write(138, IC::values::number(1));
    EXPECT_EQ(storedValue(anna(), 138), "number 1 true");
    EXPECT_EQ(log.texts(6000).back(), "Cannot open process: command = userdel -r 1000");
}

TEST_F(UserWrite, IsStoredAfterItsAction)
{
    for (unsigned int const id : {117U, 118U, 91U, 138U}) {
        std::string const before = storedValue(anna(), id);
        Lines stored;
        libc::hooks().popen = [&](char const*, char const*) -> FILE* {
            stored.push_back(storedValue(anna(), id));
            return nullptr;
        };
        write(id, IC::values::text("1"));
        ASSERT_FALSE(stored.empty()) << id;
        EXPECT_EQ(stored, Lines(stored.size(), before)) << id;
        EXPECT_EQ(storedValue(anna(), id), "text 1 true");
    }
}

TEST_F(UserWrite, OfOneToDeleteRunsUserdelWithTheUidText)
{
    commands.answers["userdel -r 1000"] = "";
    write(138, IC::values::number(1));
    EXPECT_EQ(commands.ran, Lines{"userdel -r 1000"});
    EXPECT_EQ(storedValue(anna(), 138), "number 1 true");
}

TEST_F(UserWrite, OfAnythingThatReadsAsOneToDeleteRunsUserdel)
{
    write(138, IC::values::text("1"));
    write(138, IC::values::enumeration(1));
    write(138, IC::values::truth(true));
    EXPECT_EQ(commands.ran, Lines(3, "userdel -r 1000"));
}

TEST_F(UserWrite, OfAnyOtherValueToDeleteDoesNothing)
{
    for (IC::PropertyValue const& value : {IC::values::number(0), IC::values::number(2),
                                           IC::values::truth(false), IC::values::text("yes")})
        write(138, value);
    EXPECT_EQ(commands.ran, Lines{});
    EXPECT_EQ(storedValue(anna(), 138), "text yes true");
}

TEST_F(UserWrite, OfADeletionPassesTheUidThroughWideText)
{
    WideTexts const texts;
    write(138, IC::values::number(1));
    EXPECT_EQ(texts.widened, Lines{"1000"});
    EXPECT_EQ(texts.narrowed, Lines{"1000"});
}

TEST_F(UserWrite, OfAnyOtherPropertyIsOnlyStored)
{
    for (unsigned int const id :
         {123U, 125U, 108U, 109U, 89U,  90U,  311U, 312U, 158U, 159U, 120U,
          163U, 162U, 161U, 44U,  119U, 113U, 160U, 106U, 51U,  74U,  4711U})
        write(id, IC::values::text("1"));
    EXPECT_EQ(commands.ran, Lines{});
    EXPECT_FALSE(std::filesystem::exists("usrandpwd"));
    EXPECT_EQ(storedValue(anna(), 312), "text 1 true");
    EXPECT_EQ(storedValue(anna(), 4711), "text 1 true");
}

TEST_F(UserWrite, OfTheBuilderIsOnlyStored)
{
    IC::OSSWMI::MI_call = true;
    write(118, IC::values::text("2008-01-11 00:00:00"));
    write(91, IC::values::text("2008-01-11 00:00:00"));
    write(138, IC::values::number(1));
    IC::OSSWMI::MI_call = false;
    EXPECT_EQ(commands.ran, Lines{});
    EXPECT_EQ(storedValue(anna(), 138), "number 1 true");
}

TEST_F(UserWrite, LogsItsEntryAndExit)
{
    log.clear();
    write(312, IC::values::text("x"));
    EXPECT_EQ(log.texts(3000),
              (Lines{"UserNode::setProperty: entry", "UserNode::setProperty: exit"}));
}

TEST_F(UserWrite, DeletesAndPublishesNoNode)
{
    commands.answers["userdel -r 1000"] = "";
    write(138, IC::values::number(1));
    EXPECT_TRUE(frame.deleted.empty());
    EXPECT_TRUE(frame.published.empty());
}

} // namespace user_writes_test
