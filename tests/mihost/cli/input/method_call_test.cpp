#include "mihost/cli/input/MethodCall.h"
#include "tests/mihost/cli/Refusal.h"

#include <gtest/gtest.h>

namespace method_call_test
{

using mihost::parseCall;
using mihost::takeApart;

std::string noSecret(std::string const& name)
{
    ADD_FAILURE() << name << "  must not be prompted for";
    return "";
}

std::string textFor(std::string const& method, std::vector<std::string> const& words)
{
    return textOf(parseCall(method, words, noSecret));
}

TEST(MethodCall, BecomesTextWithItsParametersInOrder)
{
    EXPECT_EQ(textFor("UserAdd", {"UserName=jdoe", "Comment=Test"}),
              "UserAdd,UserName:CMPI_string:jdoe,Comment:CMPI_string:Test");
    EXPECT_EQ(textFor("UserAdd", {"HomeDir=/home/j", "UserName=jdoe", "daysExpireAfter=3"}),
              "UserAdd,HomeDir:CMPI_string:/home/j,UserName:CMPI_string:jdoe,"
              "daysExpireAfter:CMPI_uint32:3");
    EXPECT_EQ(textFor("GetShadowing", {}), "GetShadowing");
    EXPECT_EQ(textFor("UserSetAttrib", {"UserName=jdoe", "passwordExpirationDate=2010-12-31"}),
              "UserSetAttrib,UserName:CMPI_string:jdoe,"
              "passwordExpirationDate:CMPI_dateTime:20101231000000.000000+000");
}

TEST(MethodCall, AsksForAPasswordGivenAsADash)
{
    std::string asked;
    auto const call =
        parseCall("UserSetPassword", {"UserName=jdoe", "Password=-"}, [&](std::string const& name) {
            asked = name;
            return std::string("geheim");
        });
    EXPECT_EQ(asked, "Password");
    EXPECT_EQ(textOf(call),
              "UserSetPassword,UserName:CMPI_string:jdoe,Password:CMPI_string:geheim");
}

TEST(MethodCall, IsRefusedForUnknownUnnamedMissingOrDoubleNames)
{
    EXPECT_EQ(refusal([] { textFor("Useradd", {}); }),
              "no method 'Useradd' (did you mean UserAdd?)");
    EXPECT_NE(refusal([] { textFor("Adduser", {}); }).find("UserAdd, UserDel"), std::string::npos);
    EXPECT_EQ(refusal([] { textFor("LocalGroupAdd", {"Name=staff"}); }),
              "LocalGroupAdd has no parameter 'Name' (it has GroupName)");
    EXPECT_EQ(refusal([] { textFor("LocalGroupAddUser", {"jdoe"}); }),
              "'jdoe' is not NAME=VALUE (LocalGroupAddUser takes LocalGroupName, DomainAndMember)");
    EXPECT_EQ(refusal([] { textFor("GetShadowing", {"now"}); }),
              "'now' is not NAME=VALUE (GetShadowing takes none)");
    EXPECT_EQ(refusal([] { textFor("UserDel", {}); }),
              "UserDel needs UserName, login name (see 'mihost methods UserDel')");
    EXPECT_EQ(refusal([] {
                  textFor("UserDel", {"UserName=a", "UserName=b"});
              }),
              "UserName is given twice");
    EXPECT_EQ(refusal([] {
                  textFor("UserSetPassword", {"UserName=a", "Password"});
              }),
              "Password needs a value (write Password=VALUE)");
    EXPECT_EQ(refusal([] { textFor("UserDel", {"UserName"}); }),
              "UserName needs a value (write UserName=VALUE)");
    EXPECT_EQ(refusal([] { textFor("UserDel", {"UserName="}); }), "UserName is empty");
}

// The plug-in has the shell print the exit status of any line with this word.
TEST(MethodCall, IsRefusedIfTheWordUseraddWouldMakeItFail)
{
    EXPECT_EQ(
        refusal([] { textFor("UserDel", {"UserName=useraddbot"}); }),
        "UserName contains 'useradd', so the plug-in would report UserDel as failed even if it "
        "succeeds (use the account tools themselves)");
    for (char const* text : {"UserAdd,UserName:CMPI_string:a.useradd",
                             "LocalGroupAdd,GroupName:CMPI_string:useradders",
                             "LocalGroupAddUser,LocalGroupName:CMPI_string:useradders,"
                             "DomainAndMember:CMPI_string:jdoe",
                             "UserSetPassword,UserName:CMPI_string:jdoe,"
                             "Password:CMPI_string:useradd1",
                             "UserSetHomeDir,UserName:CMPI_string:jdoe,"
                             "HomeDir:CMPI_string:/home/useradd"})
        EXPECT_NE(refusal([text] { takeApart(text); }), "accepted") << text;
}

TEST(MethodCall, MayContainTheWordUseraddInUserAdd)
{
    for (char const* text :
         {"UserAdd,UserName:CMPI_string:jdoe,Comment:CMPI_string:made by useradd",
          "UserAdd,UserName:CMPI_string:jdoe,Password:CMPI_string:useradd1",
          "UserSetFullName,UserName:CMPI_string:jdoe,FullName:CMPI_string:User Add"})
        EXPECT_EQ(refusal([text] { takeApart(text); }), "accepted") << text;
}

TEST(MethodCallText, IsParsedAndComposedAgain)
{
    for (char const* text : {"UserDel,UserName:CMPI_string:jdoe", "GetShadowing",
                             "UserAdd,UserName:CMPI_string:jdoe,Comment:CMPI_string:John Smith",
                             "UserSetAttrib,UserName:CMPI_string:jdoe,"
                             "passwordExpirationDate:CMPI_dateTime:20101231235959.000000-060"})
        EXPECT_EQ(textOf(takeApart(text)), text);
}

TEST(MethodCallText, IsRefusedIfThePluginWouldReadLessOfIt)
{
    // at a blank value the plug-in stops parsing without an error
    EXPECT_NE(refusal([] { takeApart("UserDel,UserName:CMPI_string:"); }), "accepted");
    EXPECT_NE(refusal([] { takeApart("UserDel,UserName"); }), "accepted");
    // the plug-in would read 12 of this
    EXPECT_NE(
        refusal([] { takeApart("UserAdd,UserName:CMPI_string:jdoe,Comment:CMPI_string:12:30"); }),
        "accepted");
    EXPECT_EQ(refusal([] { takeApart("UserDel,UserName:CMPI_boolean:jdoe"); }),
              "UserName has the type CMPI_string, not 'CMPI_boolean'");
    EXPECT_NE(refusal([] { takeApart("UserDel,GroupName:CMPI_string:jdoe"); }), "accepted");
    EXPECT_NE(refusal([] { takeApart("rm -rf /"); }), "accepted");
    EXPECT_NE(refusal([] { takeApart(",,"); }), "accepted");
}

TEST(MethodCallText, IsRefusedWithADateTimeOfAnotherForm)
{
    for (char const* value :
         {"2010-12-31", "20101231", "20101331000000.000000+000", "20101231000000.000000 000",
          "20101231000000.00000+0000", "201012310000000000000+000"})
        EXPECT_NE(refusal([value] {
                      takeApart(std::string("UserSetAttrib,UserName:CMPI_string:jdoe,"
                                            "passwordExpirationDate:CMPI_dateTime:") +
                                value);
                  }),
                  "accepted")
            << value;
}

TEST(MethodCall, IsDangerousIfItDeletesRoot)
{
    EXPECT_EQ(dangerOf(takeApart("UserDel,UserName:CMPI_string:root")), "delete the account root");
    EXPECT_EQ(dangerOf(takeApart("UserDel,UserName:CMPI_string:jdoe")), "");
    EXPECT_EQ(dangerOf(takeApart("UserAdd,UserName:CMPI_string:root")), "");
}

} // namespace method_call_test
