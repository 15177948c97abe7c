// No password ever reaches the logger, whole or in pieces, whatever is wrong with the call and
// whatever the tools print.

#include "nodes/OsNode.h"
#include "tests/support/Frame.h"
#include "tests/unit/Methods.h"
#include "util/MyProcess.h"

namespace
{

using Lines = std::vector<std::string>;

// Nothing else that is logged holds any of these.
Lines const pieces{"Zq7", "Wx9", "Kv3"};

class PasswordSecrecy : public MethodTest
{
protected:
    PasswordSecrecy()
    {
        quoteEverything();
    }

    /** Every command quotes its line and each piece in it, and then claims to have succeeded. */
    static void quoteEverything()
    {
        libc::hooks().popen = [](char const* command, char const*) -> FILE* {
            std::string output = std::string("sh: cannot read `") + command + "'\n";
            for (std::string const& piece : pieces)
                if (output.find(piece) != std::string::npos)
                    output += "sh: " + piece + ": not found\n";
            FILE* stream = std::tmpfile();
            std::fputs((output + "rc=0\n").c_str(), stream);
            std::rewind(stream);
            return stream;
        };
        libc::hooks().pclose = [](FILE* stream) { return std::fclose(stream); };
    }

    static void saySomethingHarmless()
    {
        libc::hooks().popen = [](char const*, char const*) -> FILE* {
            FILE* stream = std::tmpfile();
            std::fputs("usermod: no changes\n", stream);
            std::rewind(stream);
            return stream;
        };
    }

    static void refuseToStart()
    {
        libc::hooks().popen = [](char const*, char const*) -> FILE* { return nullptr; };
    }

    /** Writes the text as a host does. */
    void write(std::string const& text)
    {
        node_.setProperty(NODES::createUser, IC::PropertyValue(text, true));
    }

    static void expectNoPieceIn(Recording const& log, std::string const& text)
    {
        EXPECT_FALSE(log.records().empty());
        for (LogRecord const& record : log.records())
            for (std::string const& piece : pieces)
                ASSERT_EQ((record.text + record.function + record.file).find(piece),
                          std::string::npos)
                    << text << "\nlogged: " << record.text;
    }

    Frame frame_;
    IC::OsNode node_{9, 7, {7}, 17, 0};
};

TEST_F(PasswordSecrecy, HoldsForEveryMethodAndEveryPlaceOfTheParameter)
{
    for (char const* method :
         {"UserAdd", "UserDel", "UserSetAttrib", "LocalGroupAdd", "LocalGroupDel", "GetShadowing",
          "LocalGroupAddUser", "LocalGroupDelUser", "UserSetFullName", "UserSetScriptPath",
          "UserSetHomeDir", "UserSetPassword", "Unknown"}) {
        for (char const* params : {",Password:CMPI_string:Zq7Wx9",
                                   ",Password:CMPI_string:Zq7Wx9,UserName:CMPI_string:jdoe",
                                   ",UserName:CMPI_string:jdoe,Password:CMPI_string:Zq7Wx9",
                                   ",Password:CMPI_string:Zq7Wx9,A:CMPI_boolean:b",
                                   ",Password:CMPI_string:Zq7Wx9,A:CMPI_dateTime:b"}) {
            std::string const text = std::string(method) + params;
            Recording const log;
            write(text);
            expectNoPieceIn(log, text);
        }
    }
}

TEST_F(PasswordSecrecy, HoldsForEveryByteWithinThePassword)
{
    for (int byte = 1; byte < 256; ++byte) {
        for (char const* method : {"UserAdd", "UserSetPassword"}) {
            std::string const text =
                std::string(method) + ",UserName:CMPI_string:jdoe,Password:CMPI_string:Zq7" +
                static_cast<char>(byte) + "Wx9" + static_cast<char>(byte) + "Kv3";
            Recording const log;
            write(text);
            expectNoPieceIn(log, text);
        }
    }
}

TEST_F(PasswordSecrecy, HoldsForCallsWithTheWrongSeparators)
{
    for (char const* text :
         {"Password:CMPI_string:Zq7Wx9", "Password:Zq7Wx9", "Password,Zq7Wx9", "Password=Zq7Wx9",
          "UserSetPassword,Password:Zq7Wx9", "UserSetPassword,Password:Zq7Wx9:CMPI_string",
          "UserSetPassword,Password:CMPI_uint32:Zq7Wx9",
          "UserSetPassword,Password:CMPI_dateTime:Zq7Wx9",
          "UserSetPassword,Password:CMPI_string:Zq7,Wx9:Kv3,Kv3:Zq7:Wx9",
          "UserSetPassword,:Password::CMPI_string::Zq7,Wx9:Kv3",
          "UserSetPassword;UserName:CMPI_string:jdoe;Password:CMPI_string:Zq7Wx9",
          "UserSetPassword,UserName:CMPI_string:jdoe;Password:CMPI_string:Zq7,Wx9:Kv3",
          "UserSetPassword,UserName:CMPI_string:jdoe Password=Zq7Wx9",
          "UserSetPassword UserName=jdoe Password=Zq7Wx9",
          "UserSetPassword,UserName=jdoe Password=Zq7:Wx9:Kv3",
          "UserSetPassword,UserName:Password=Zq7:Wx9:Kv3",
          "UserSetPassword,UserName:CMPI_string,Password:CMPI_string:Zq7Wx9",
          "Zq7=Password:UserSetPassword"}) {
        Recording const log;
        write(text);
        expectNoPieceIn(log, text);
    }
}

TEST_F(PasswordSecrecy, HoldsForPasswordsThatDoNotFit)
{
    std::string longest;
    while (longest.size() < 6000)
        longest += "Zq7Wx9Kv3";
    for (std::size_t const size : {254U, 255U, 5000U}) {
        std::string const text = "UserSetPassword,UserName:CMPI_string:jdoe,Password:CMPI_string:" +
                                 longest.substr(0, size);
        Recording const log;
        write(text);
        expectNoPieceIn(log, text);
    }
}

TEST_F(PasswordSecrecy, HoldsWhereNoCommandCanBeStarted)
{
    refuseToStart();
    Recording const log;
    write("UserSetPassword,UserName:CMPI_string:jdoe,Password:CMPI_string:Zq7Wx9");
    expectNoPieceIn(log, "");
    EXPECT_TRUE(log.has("Cannot open process: /usr/sbin/usermod", 6000));
}

TEST_F(PasswordSecrecy, HoldsForCallsOfSingleFunctions)
{
    Recording const log;
    char password[] = "Zq7Wx9";
    char user[] = "jdoe";
    NQ::OsInfo().executePasswordEncryption(password, user);
    execute("Password:CMPI_string:Zq7Wx9", {});
    execute("UserAdd", {{"Password", "Password=Zq7Wx9", "Kv3"}});
    execute("UserSetPassword", {text("UserName", "jdoe"), text("Password", "Zq7,Wx9:Kv3")});
    std::vector<std::string> tokens;
    NQ::Tokenize("Password:CMPI_string:Zq7Wx9", tokens, ":");
    expectNoPieceIn(log, "");
}

TEST_F(PasswordSecrecy, LeavesTheCodeOfUseraddInTheLog)
{
    Recording const log;
    execute("UserAdd", {text("UserName", "jdoe"), text("Password", "Zq7Wx9")});
    EXPECT_EQ(log.remarks().at(0), "outputBuffer: (not shown)\n(not shown)\n(not shown)\nrc=0\n");
}

TEST_F(PasswordSecrecy, LeavesOutputThatQuotesNothingInTheLog)
{
    saySomethingHarmless();
    Recording const log;
    execute("UserSetPassword", {text("UserName", "jdoe"), text("Password", "Zq7Wx9")});
    EXPECT_EQ(log.remarks().at(0), "outputBuffer: usermod: no changes\n");
    refuseToStart();
    Recording const silent;
    execute("UserSetPassword", {text("UserName", "jdoe"), text("Password", "Zq7Wx9")});
    EXPECT_TRUE(silent.has("outputBuffer: ", 3000));
}

TEST_F(PasswordSecrecy, CoversOutputThatHoldsTheWordWhereTheCallHasNoPassword)
{
    libc::hooks().popen = nullptr;
    libc::FakeCommands commands;
    commands.otherwise = "userdel: Password=Zq7Wx9\nrc=12x\nrc=X12\nrc=X\n rc=1\nrc=12\nno newline";
    Recording const log;
    execute("UserDel", {text("UserName", "jdoe")});
    EXPECT_EQ(log.remarks(), Lines{"outputBuffer: (not shown)\n(not shown)\n(not shown)\n"
                                   "(not shown)\n(not shown)\nrc=12\n(not shown)\n"});
}

TEST_F(PasswordSecrecy, LeavesTheMessagesWithoutTheText)
{
    Recording const log;
    write("Password=Zq7Wx9");
    write("UserAdd,A:Password=Zq7Wx9:b");
    EXPECT_TRUE(log.has("method=", 3000));
    EXPECT_EQ(log.texts(6000), (Lines{"Unknown method: ", "Unknown parameter type: "}));
}

TEST_F(PasswordSecrecy, LeavesNamesThatMerelyHoldTheWordInTheLog)
{
    Recording const log;
    write("UserSetAttrib,daysMustKeepPassword:CMPI_uint32:3");
    EXPECT_TRUE(log.has("paramInfo.name=daysMustKeepPassword", 3000));
    write("ResetPassword");
    EXPECT_TRUE(log.has("method=ResetPassword", 3000));
    EXPECT_TRUE(log.has("Unknown method: ResetPassword", 6000));
    write("UserAdd,daysKeepPassword:KeepPassword:3");
    EXPECT_TRUE(log.has("Unknown parameter type: KeepPassword", 6000));
}

} // namespace
