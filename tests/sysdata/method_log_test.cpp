// What an administration method logs, line by line. Of a call with a password, the tokens, the
// parameter's value, and that value in a tool's output are withheld.

#include "tests/sysdata/MethodTest.h"

#include <algorithm>

namespace method_log_test
{

class MethodLog : public MethodTest
{
protected:
    /** Level, function and text of every message of one call, without the runner's own lines. */
    static Lines linesOf(std::string const& text)
    {
        Recording const log;
        call(text);
        return linesIn(log);
    }

    static Lines linesIn(Recording const& log)
    {
        Lines lines;
        for (LogRecord const& record : log.records())
            if (!record.trace && record.function != "executeCommand")
                lines.push_back(std::to_string(record.level) + ' ' + record.function + " | " +
                                record.text);
        return lines;
    }

    /** The messages of one call about its tools' output. */
    Lines outputsOf(std::string const& method, Params const& params)
    {
        Recording const log;
        execute(method, params);
        Lines outputs;
        for (std::string const& text : log.texts(3000))
            if (text.rfind("outputBuffer: ", 0) == 0)
                outputs.push_back(text);
        return outputs;
    }

    /** What is logged when usermod prints this about a call with this password. */
    std::string shown(std::string const& output, std::string const& password)
    {
        commands_.otherwise = output;
        Lines const outputs =
            outputsOf("UserSetPassword", {text("UserName", "jdoe"), text("Password", password)});
        return outputs.size() == 1 ? outputs.front() : "(not one)";
    }
};

/** Lines between the entry and the exit of the property's entry point and of the parser. */
std::vector<std::string> parsed(std::vector<std::string> lines)
{
    lines.insert(lines.begin(),
                 {"3000 setCreateUser | OsNode::setCreateUser: entry",
                  "3000 parseMethodAndParams | OsNode::parseMethodAndParams: entry"});
    lines.emplace_back("3000 parseMethodAndParams | OsNode::parseMethodAndParams: exit");
    return lines;
}

std::vector<std::string> executed(std::vector<std::string> before, std::vector<std::string> lines)
{
    before.emplace_back("3000 executeMethod | OsNode::executeMethod: entry");
    before.insert(before.end(), lines.begin(), lines.end());
    before.insert(before.end(), {"3000 executeMethod | OsNode::executeMethod: exit",
                                 "3000 setCreateUser | OsNode::setCreateUser: exit"});
    return before;
}

char const tokenizeEntry[] = "3000 Tokenize | Tokenize: entry";
char const tokenizeExit[] = "3000 Tokenize | Tokenize: exit";

std::string token(std::string const& text)
{
    return "3000 Tokenize | str.substr(lastPos, pos - lastPos) = " + text;
}

std::string said(std::string const& text)
{
    return "3000 parseMethodAndParams | " + text;
}

TEST_F(MethodLog, HoldsEveryLineOfACallWithoutAPassword)
{
    EXPECT_EQ(linesOf("UserDel,UserName:CMPI_string:jdoe"),
              executed(parsed({tokenizeEntry, token("UserDel"), token("UserName:CMPI_string:jdoe"),
                               tokenizeExit, said("method=UserDel"), tokenizeEntry,
                               token("UserName"), token("CMPI_string"), token("jdoe"), tokenizeExit,
                               said("paramInfo.name=UserName"), said("paramInfo.type=CMPI_string"),
                               said("paramInfo.value=jdoe")}),
                       {"3000 executeMethod | outputBuffer: "}));
}

TEST_F(MethodLog, WithholdsTokensAndValueOfAPassword)
{
    commands_.answers["/usr/sbin/usermod -p Zq7Wx9 jdoe 2>&1"] = "usermod: no changes\n";
    EXPECT_EQ(linesOf("UserSetPassword,UserName:CMPI_string:jdoe,Password:CMPI_string:Zq7Wx9"),
              executed(parsed({tokenizeEntry, tokenizeExit, said("method=UserSetPassword"),
                               tokenizeEntry, tokenizeExit, said("paramInfo.name=UserName"),
                               said("paramInfo.type=CMPI_string"), said("paramInfo.value=jdoe"),
                               tokenizeEntry, tokenizeExit, said("paramInfo.name=Password"),
                               said("paramInfo.type=CMPI_string")}),
                       {"3000 executeMethod | outputBuffer: usermod: no changes\n",
                        "3000 executePasswordEncryption | executePasswordEncryption: entry",
                        "3000 executePasswordEncryption | executePasswordEncryption: exit"}));
}

TEST_F(MethodLog, WithholdsTheTokensOfEveryItemBesideAPassword)
{
    // The piece after the comma is a separate item, and not a parameter.
    Lines const lines = linesOf("GetShadowing,Password:CMPI_string:Zq7,Wx9,A:CMPI_string:b");
    EXPECT_EQ(lines, executed(parsed({tokenizeEntry, tokenizeExit, said("method=GetShadowing"),
                                      tokenizeEntry, tokenizeExit, said("paramInfo.name=Password"),
                                      said("paramInfo.type=CMPI_string"), tokenizeEntry,
                                      tokenizeExit, said("This parameter is blank ---exiting ")}),
                              {}));
}

TEST_F(MethodLog, JudgesEachItemByItselfWhenNoParameterIsAPassword)
{
    Lines const lines = linesOf("UserSetFullName,UserName:CMPI_string:jdoe,"
                                "FullName:CMPI_string:Password Reset Desk");
    EXPECT_EQ(
        lines,
        executed(parsed({tokenizeEntry, tokenizeExit, said("method=UserSetFullName"), tokenizeEntry,
                         token("UserName"), token("CMPI_string"), token("jdoe"), tokenizeExit,
                         said("paramInfo.name=UserName"), said("paramInfo.type=CMPI_string"),
                         said("paramInfo.value=jdoe"), tokenizeEntry, tokenizeExit,
                         said("paramInfo.name=FullName"), said("paramInfo.type=CMPI_string"),
                         said("paramInfo.value=Password Reset Desk")}),
                 {"3000 executeMethod | outputBuffer: "}));
}

TEST_F(MethodLog, TreatsNoOtherNameAndNoDateAsAPassword)
{
    for (char const* name : {"daysMustKeepPassword", "Passwords", "password", "MyPassword"}) {
        Lines const lines =
            linesOf(std::string("GetShadowing,") + name + ":CMPI_uint32:3,A:CMPI_string:b");
        EXPECT_NE(std::find(lines.begin(), lines.end(), said("paramInfo.value=3")), lines.end())
            << name;
        EXPECT_NE(std::find(lines.begin(), lines.end(), token("A")), lines.end()) << name;
    }
    Lines const lines = linesOf("GetShadowing,Password:CMPI_dateTime:20101231000000.000000+000");
    EXPECT_EQ(lines.at(lines.size() - 5), said("paramInfo.value=2010-12-31"));
}

TEST_F(MethodLog, DoesNotTreatAMethodOfThatNameAsAPassword)
{
    EXPECT_EQ(linesOf("Password,A:CMPI_string:b"),
              executed(parsed({tokenizeEntry, tokenizeExit, said("method=Password"), tokenizeEntry,
                               token("A"), token("CMPI_string"), token("b"), tokenizeExit,
                               said("paramInfo.name=A"), said("paramInfo.type=CMPI_string"),
                               said("paramInfo.value=b")}),
                       {"6000 executeMethod | Unknown method: Password"}));
}

TEST_F(MethodLog, WithholdsAPasswordOfTextOrNumberType)
{
    for (char const* type : {"CMPI_string", "CMPI_uint32"})
        EXPECT_EQ(linesOf(std::string("GetShadowing,Password:") + type + ":1234"),
                  executed(parsed({tokenizeEntry, tokenizeExit, said("method=GetShadowing"),
                                   tokenizeEntry, tokenizeExit, said("paramInfo.name=Password"),
                                   said(std::string("paramInfo.type=") + type)}),
                           {}));
}

TEST_F(MethodLog, NamesAnUnknownMethodInFull)
{
    for (char const* method : {"Unknown", "ResetPassword", "UserSetPassword UserName=jdoe"}) {
        Recording const log;
        EXPECT_FALSE(call(method));
        EXPECT_TRUE(log.has(std::string("method=") + method, 3000));
        EXPECT_EQ(log.texts(6000), Lines{std::string("Unknown method: ") + method});
    }
}

TEST_F(MethodLog, NamesAnUnknownTypeInFullBesideAPassword)
{
    Lines lines =
        parsed({tokenizeEntry, tokenizeExit, said("method=UserAdd"), tokenizeEntry, tokenizeExit,
                said("paramInfo.name=Password"), said("paramInfo.type=CMPI_string"), tokenizeEntry,
                tokenizeExit, said("paramInfo.name=Active"), said("paramInfo.type=PasswordType"),
                "6000 parseMethodAndParams | Unknown parameter type: PasswordType"});
    lines.emplace_back("3000 setCreateUser | OsNode::setCreateUser: exit");
    EXPECT_EQ(linesOf("UserAdd,Password:CMPI_string:Zq7Wx9,Active:PasswordType:true"), lines);
}

TEST_F(MethodLog, EndsAtADateThatCannotBeRead)
{
    Lines lines = parsed({tokenizeEntry, token("UserAdd"), token("D:CMPI_dateTime:soon"),
                          tokenizeExit, said("method=UserAdd"), tokenizeEntry, token("D"),
                          token("CMPI_dateTime"), token("soon"), tokenizeExit,
                          said("paramInfo.name=D"), said("paramInfo.type=CMPI_dateTime")});
    lines.emplace_back("3000 setCreateUser | OsNode::setCreateUser: exit");
    EXPECT_EQ(linesOf("UserAdd,D:CMPI_dateTime:soon"), lines);
}

TEST_F(MethodLog, HasNoParserLinesForATextWithoutItems)
{
    Lines const parser = parsed({tokenizeEntry, tokenizeExit});
    EXPECT_EQ(linesOf(",,"), executed(parser, {"6000 executeMethod | Unknown method: "}));
}

TEST_F(MethodLog, NamesTheFunctionThatRanTheTool)
{
    commands_.otherwise = "uid=7(a) gid=7(a) groups=7(a)\n";
    Recording const log;
    execute("UserAdd", {text("UserName", "jdoe")});
    execute("LocalGroupAddUser", {text("LocalGroupName", "g"), text("DomainAndMember", "a")});
    std::string const output = "outputBuffer: uid=7(a) gid=7(a) groups=7(a)\n";
    Lines outputs;
    for (std::string const& line : linesIn(log))
        if (line.find("outputBuffer") != std::string::npos)
            outputs.push_back(line);
    EXPECT_EQ(outputs, (Lines{"3000 executeMethod | " + output, // useradd
                              "3000 groupMemberChanges | " + output,
                              "3000 groupMemberChanges | " + output}));

    commands_.otherwise = "rc=0\n";
    Recording const added;
    execute("UserAdd", {text("UserName", "jdoe")});
    EXPECT_EQ(linesIn(added).at(1), "3000 executeMethod | outputBuffer: rc=0\n");
    EXPECT_EQ(linesIn(added).at(2), "3000 executeMethod | outputBuffer: rc=0\n"); // chage
}

TEST_F(MethodLog, NamesTheExecutorForAnUnknownType)
{
    Recording const log;
    EXPECT_EQ(execute("UserAdd", {{"Active", "CMPI_boolean", "true"}}), 1);
    EXPECT_EQ(linesIn(log), (Lines{"3000 executeMethod | OsNode::executeMethod: entry",
                                   "6000 executeMethod | Unknown parameter type: CMPI_boolean",
                                   "3000 executeMethod | OsNode::executeMethod: exit"}));
}

TEST_F(MethodLog, HidesThePasswordWithinAToolsOutput)
{
    struct {
        std::string output;
        char const* password;
        std::string logged;
    } const cases[] = {
        {"", "Zq7Wx9", ""},
        {"\n", "Zq7Wx9", "\n"},
        {"usermod: no changes", "Zq7Wx9", "usermod: no changes"},
        {"usermod: no changes\n", "Zq7Wx9", "usermod: no changes\n"},
        {"sh: 1: Password: not found\n", "Zq7Wx9", "sh: 1: Password: not found\n"},
        {"a\n\nb", "Zq7Wx9", "a\n\nb"},
        {"rc=12\nno newline", "Zq7Wx9", "rc=12\nno newline"},
        {"sh: 1: Zq7: not found", "Zq7", "sh: 1: (hidden): not found"},
        {"Zq7", "Zq7", "(hidden)"},
        {"Zq7Zq7 ZZq77 Zq\n", "Zq7", "(hidden)(hidden) Z(hidden)7 Zq\n"},
        {"(hidden) hidden", "hidden", "((hidden)) (hidden)"},
        {"usermod: Zq", "Zq7", "usermod: Zq"},
        {"usermod: Zq7", "Zq7", "usermod: (hidden)"},
        // with escaped blanks, too
        {"-p a\\ b\\ c: a b c, a b", "a b c", "-p (hidden): (hidden), a b"},
        {"\\ , ", " ", "(hidden),(hidden)"},
    };
    for (auto const& [output, password, logged] : cases)
        EXPECT_EQ(shown(output, password), "outputBuffer: " + logged);
}

TEST_F(MethodLog, HidesEachPasswordAndNothingForAnEmptyOne)
{
    commands_.otherwise = "abc ab\n";
    EXPECT_EQ(outputsOf("UserSetPassword", {text("Password", "ab"), text("Password", "abc")}),
              Lines{"outputBuffer: (hidden) (hidden)\n"});
    EXPECT_EQ(outputsOf("UserSetPassword", {text("Password", "abc"), text("Password", "ab")}),
              Lines{"outputBuffer: (hidden) (hidden)\n"});
    EXPECT_EQ(outputsOf("UserSetPassword",
                        {text("UserName", "jdoe"), text("Password", ""), text("Comment", "ab")}),
              Lines{"outputBuffer: abc ab\n"});
}

TEST_F(MethodLog, HidesThePasswordInTheOutputOfTheAgeingToolToo)
{
    commands_.otherwise = "Zq7 rc=0";
    EXPECT_EQ(outputsOf("UserAdd", {text("UserName", "jdoe"), text("Password", "Zq7")}),
              (Lines{"outputBuffer: (hidden) rc=0", "outputBuffer: (hidden) rc=0"}));
}

TEST_F(MethodLog, NeverHoldsThePasswordWhateverByteIsInIt)
{
    for (int byte = 1; byte < 256; ++byte) {
        char const c = static_cast<char>(byte);
        if (c == ',' || c == ':') // what follows is not part of the password
            continue;
        std::string const password = std::string("Zq7") + c + "Wx9";
        commands_.otherwise = "sh: cannot read " + password + "\n";
        Recording const log;
        call("UserSetPassword,UserName:CMPI_string:jdoe,Password:CMPI_string:" + password);
        for (std::string const& text : log.texts())
            ASSERT_EQ(text.find(password), std::string::npos) << byte << ": " << text;
    }
}

TEST_F(MethodLog, NeverHoldsAPasswordThatDoesNotFit)
{
    for (std::size_t const size : {254U, 255U, 5000U}) {
        Recording const log;
        call("UserSetPassword,UserName:CMPI_string:jdoe,Password:CMPI_string:" +
             std::string(size, 'Z'));
        for (std::string const& text : log.texts())
            ASSERT_EQ(text.find("ZZ"), std::string::npos) << text;
    }
}

TEST_F(MethodLog, NamesOnlyTheProgramOfALineThatCannotBeStarted)
{
    commands_.otherwise.reset();
    Recording const log;
    execute("UserSetPassword", {text("UserName", "jdoe"), text("Password", "Zq7")});
    EXPECT_EQ(log.texts(6000), Lines{"Cannot open process: /usr/sbin/usermod"});
}

} // namespace method_log_test
