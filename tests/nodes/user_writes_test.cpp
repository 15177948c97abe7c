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
#include <filesystem>
#include <fstream>
#include <string>

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

TEST_F(PasswordWrite, PassesNameAndPasswordInAFileAndLogsNeither)
{
    commands.answers[setPasswords] = "";
    WideTexts const texts;
    write(117, IC::values::text("$6$salt$hash"));
    EXPECT_EQ(commands.ran, Lines{setPasswords});
    EXPECT_EQ(commands.modes, Lines{"r"});
    EXPECT_EQ(handedOver, Lines{"anna:$6$salt$hash\n"});
    EXPECT_EQ(commands.open, 0);
    EXPECT_EQ(storedValue(anna(), 117), "text $6$salt$hash true");
    EXPECT_TRUE(log.texts(6000).empty());
    EXPECT_EQ(sorted(texts.widened), (Lines{"$6$salt$hash", "anna"}));
    EXPECT_EQ(texts.narrowed, texts.widened);
    for (std::string const& text : log.texts())
        EXPECT_EQ(text.find("$6$salt$hash"), std::string::npos) << text;
}

TEST_F(PasswordWrite, EmptiesAFileThatExistsAndUsesTheCurrentName)
{
    std::ofstream("usrandpwd") << "root:x\nanna:an older and much longer password\n";
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

TEST_F(UserWrite, OfADateCountsFromItsOwnDateAndUsesItsTextForm)
{
    commands.answers = {{"chage -l anna", "Password expires : Jan 01, 2008\n"
                                          "Last password change : Jan 02, 2008\n"}};
    for (IC::PropertyValue const& date :
         {IC::values::text("2008-01-11 00:00:00"), IC::values::date(1200009600)}) {
        commands.ran.clear();
        write(118, date);
        write(91, date);
        EXPECT_EQ(commands.ran,
                  (Lines{"chage -l anna", "chage -I 10 anna", "chage -l anna", "chage -M 9 anna"}));
        EXPECT_EQ(storedValue(anna(), 118), shown(date));
        EXPECT_EQ(storedValue(anna(), 91), shown(date));
    }
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

TEST_F(UserWrite, OfAnyOneToDeleteRunsUserdelWithTheUid)
{
    WideTexts const texts;
    for (IC::PropertyValue const& value : {IC::values::text("1"), IC::values::enumeration(1),
                                           IC::values::truth(true), IC::values::number(1)}) {
        write(138, value);
        EXPECT_EQ(storedValue(anna(), 138), shown(value));
    }
    EXPECT_EQ(commands.ran, Lines(4, "userdel -r 1000"));
    EXPECT_EQ(texts.widened, Lines(4, "1000"));
    EXPECT_EQ(texts.narrowed, Lines(4, "1000"));
    EXPECT_TRUE(frame.deleted.empty());
    EXPECT_TRUE(frame.published.empty());
}

TEST_F(UserWrite, OfAnyOtherValueToDeleteDoesNothing)
{
    for (IC::PropertyValue const& value : {IC::values::number(0), IC::values::number(4294967295U),
                                           IC::values::truth(false), IC::values::text("yes")}) {
        write(138, value);
        EXPECT_EQ(storedValue(anna(), 138), shown(value));
    }
    EXPECT_EQ(commands.ran, Lines{});
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
    for (unsigned int const id : {117U, 118U, 91U, 138U}) {
        write(id, IC::values::number(1));
        EXPECT_EQ(storedValue(anna(), id), "number 1 true");
    }
    IC::OSSWMI::MI_call = false;
    EXPECT_EQ(commands.ran, Lines{});
    EXPECT_FALSE(std::filesystem::exists("usrandpwd"));
}

} // namespace user_writes_test
