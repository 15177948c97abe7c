#include "mihost/cli/input/InputValidation.h"
#include "mihost/cli/input/MethodCall.h"
#include "tests/mihost/cli/Refusal.h"
#include "tests/mihost/cli/input/RightValue.h"

#include <functional>
#include <gtest/gtest.h>

namespace input_validation_test
{

using mihost::Form;
using mihost::objection;
using mihost::parseCall;

/** Calls look(method, parameter, words) for every parameter of every method.
 *
 * words(value) returns all parameters of the method as NAME=VALUE, this one with that value.
 */
void forEachParameter(
    std::function<void(mihost::Method const&, mihost::Parameter const&,
                       std::function<std::vector<std::string>(std::string const&)> const&)> const&
        look)
{
    for (auto const& method : mihost::methods())
        for (auto const& parameter : method.parameters)
            look(method, parameter, [&](std::string const& value) {
                std::vector<std::string> words;
                for (auto const& other : method.parameters)
                    words.push_back(std::string(other.name) + "=" +
                                    (&other == &parameter ? value : rightValue(other.form)));
                return words;
            });
}

std::string noSecret(std::string const&)
{
    ADD_FAILURE() << "nothing must be prompted for";
    return "";
}

constexpr char forbidden[] = "|&;<>()$`\\\"'*?[]#~=%!{}^,:";

TEST(MethodCallValues, AreRefusedForEachForbiddenByte)
{
    forEachParameter([](auto const& method, auto const& parameter, auto const& wordsWith) {
        std::string const right = rightValue(parameter.form);
        EXPECT_EQ(refusal([&] { parseCall(method.name, wordsWith(right), noSecret); }), "accepted")
            << method.name << " " << parameter.name;
        for (int byte = 0; byte < 256; ++byte) {
            char const character = static_cast<char>(byte);
            bool const isControl = byte < 0x20 || byte == 0x7F;
            bool const isForbidden = isControl || byte >= 0x80 || // alone, such a byte is not UTF-8
                                     std::string(forbidden).find(character) != std::string::npos;
            if (!isForbidden)
                continue;
            for (std::size_t const at : {std::size_t{0}, right.size() / 2, right.size()}) {
                std::string value = right;
                value.insert(at, 1, character);
                EXPECT_NE(refusal([&] { parseCall(method.name, wordsWith(value), noSecret); }),
                          "accepted")
                    << method.name << " " << parameter.name << " byte " << byte << " at " << at;
            }
        }
    });
}

TEST(MethodCallTexts, AreRefusedForEachForbiddenByte)
{
    forEachParameter([](auto const& method, auto const& parameter, auto const& wordsWith) {
        std::string const right = rightValue(parameter.form);
        auto const call = parseCall(method.name, wordsWith(right), noSecret);
        for (int byte = 0; byte < 256; ++byte) {
            char const character = static_cast<char>(byte);
            bool const isControl = byte < 0x20 || byte == 0x7F;
            // A comma begins a new item and a colon a new part, which are refused as such.
            if (!isControl && byte < 0x80 &&
                std::string(forbidden).find(character) == std::string::npos)
                continue;
            auto broken = call;
            for (auto& argument : broken.arguments)
                if (argument.parameter == &parameter)
                    argument.value.insert(1, 1, character) += "x";
            EXPECT_NE(refusal([&] { mihost::takeApart(textOf(broken)); }), "accepted")
                << method.name << " " << parameter.name << " byte " << byte;
        }
    });
}

TEST(MethodCallValues, MayHoldHarmlessCharactersAndEscapedBlanks)
{
    for (Form const form : {Form::AccountName, Form::Words, Form::Password})
        EXPECT_EQ(objection(form, "aZ09@+-./_Jürgen李"), std::nullopt);
    EXPECT_EQ(objection(Form::Words, "John Smith"), std::nullopt);
    EXPECT_EQ(objection(Form::Path, "/home/john smith"), std::nullopt);
    EXPECT_EQ(objection(Form::AccountName, "john smith"), "contains a blank");
    EXPECT_EQ(objection(Form::Password, "john smith"), "contains a blank");
}

TEST(MethodCallValues, AreRefusedIfTheyLookLikeAnOption)
{
    EXPECT_EQ(objection(Form::AccountName, "-r"),
              "begins with '-', so a command would read it as an option");
    EXPECT_NE(objection(Form::Password, "-n"), std::nullopt);
    EXPECT_EQ(objection(Form::Words, "-r"), std::nullopt); // always follows its option
}

TEST(Names, AreRefusedIfToolsWouldReadThemAsIdsOrPaths)
{
    EXPECT_EQ(objection(Form::PlainName, "1001"),
              "consists of digits only, so tools would read it as an id");
    EXPECT_EQ(objection(Form::AccountName, "1001"), std::nullopt); // such an account may exist
    for (Form const form : {Form::AccountName, Form::PlainName})
        EXPECT_EQ(objection(form, "+1"), "begins with '+', so tools would read it as an id");
    for (char const* path : {"/", "a/b", ".", ".."})
        EXPECT_EQ(objection(Form::PlainName, path), "would be read as a path") << path;
    for (char const* right : {"1a", "a1", "a+", "...", "a.b", "_x"})
        EXPECT_EQ(objection(Form::PlainName, right), std::nullopt) << right;
}

TEST(Names, OfDigitsOnlyAreRefusedForNewAccountsAndGroups)
{
    for (auto const& [method, words] :
         std::initializer_list<std::pair<char const*, std::vector<std::string>>>{
             {"UserAdd", {"UserName=1001"}},
             {"LocalGroupAdd", {"GroupName=1001"}},
             {"LocalGroupAddUser", {"LocalGroupName=1001", "DomainAndMember=jdoe"}},
             {"LocalGroupDelUser", {"LocalGroupName=1001", "DomainAndMember=jdoe"}}})
        EXPECT_NE(refusal([&, method = method, &words = words] {
                      parseCall(method, words, noSecret);
                  }).find("consists of digits only"),
                  std::string::npos)
            << method;
    EXPECT_EQ(refusal([] { parseCall("UserDel", {"UserName=1001"}, noSecret); }), "accepted");
    EXPECT_EQ(refusal([] { mihost::takeApart("UserAdd,UserName:CMPI_string:1001"); }),
              "UserName consists of digits only, so tools would read it as an id");
}

TEST(MethodCallValues, AreNeitherEmptyNorLongerThan254Bytes)
{
    for (Form const form :
         {Form::AccountName, Form::Words, Form::Password, Form::Path, Form::Digits, Form::Day})
        EXPECT_EQ(objection(form, ""), "is empty");
    EXPECT_EQ(objection(Form::Words, std::string(254, 'a')), std::nullopt);
    EXPECT_NE(objection(Form::Words, std::string(255, 'a')), std::nullopt);
    EXPECT_EQ(objection(Form::Words, std::string(252, 'a') + " "), std::nullopt);
    EXPECT_NE(objection(Form::Words, std::string(253, 'a') + " "), std::nullopt);
}

TEST(MethodCallValues, OfNumbersDaysAndPathsHaveTheirForm)
{
    for (char const* right : {"0", "7", "99999", "999999999"})
        EXPECT_EQ(objection(Form::Digits, right), std::nullopt) << right;
    for (char const* wrong : {"-1", "+1", "1.5", "x", "1x", " 1", "1 ", "1000000000"})
        EXPECT_NE(objection(Form::Digits, wrong), std::nullopt) << wrong;
    for (char const* right : {"2030-12-31", "2028-02-29", "1901-01-01"})
        EXPECT_EQ(objection(Form::Day, right), std::nullopt) << right;
    for (char const* wrong : {"2030-13-01", "2030-00-10", "2030-02-30", "2029-02-29", "2030-1-1",
                              "31.12.2030", "20301231", "1900-12-31", "2030-12-31 00"})
        EXPECT_EQ(objection(Form::Day, wrong), "is not a day (use YYYY-MM-DD, such as 2030-12-31)")
            << wrong;
    EXPECT_EQ(objection(Form::Path, "home"), "is not an absolute path (it must begin with '/')");
}

TEST(Objections, NameTheCharacterButNeverOneOfAPassword)
{
    EXPECT_EQ(objection(Form::Words, "a;b"), "contains the shell metacharacter ';'");
    EXPECT_EQ(objection(Form::Words, "a,b"), "contains the separator ','");
    EXPECT_EQ(objection(Form::Words, "a\nb"), "contains the control character '\\n'");
    EXPECT_EQ(objection(Form::Words, "a\xC2\x85"), "contains the control character '\\u0085'");
    EXPECT_EQ(objection(Form::Words, "a\xFF"), "contains the byte \\xff, which is not UTF-8");
    std::string const reason = objection(Form::Password, "geheim;").value();
    EXPECT_EQ(reason.find("geheim"), std::string::npos);
    EXPECT_EQ(reason.find(';', 0), reason.find("; letters"));
}

TEST(PasswordHashes, AreAcceptedAsTheShadowFileHasThem)
{
    for (char const* right : {"$6$salt$hashhash/.", "$y$j9T$abc./$def", "$1$ab$cd", "abJnggxhB/yWI",
                              "!", "!!", "*", "!$6$salt$hash"})
        EXPECT_EQ(mihost::objectionToHash(right), std::nullopt) << right;
}

TEST(PasswordHashes, AreNeitherPlainPasswordsNorBreakALine)
{
    for (char const* wrong : {"", "secret", "$6$salt$ha:sh", "$6$salt$ha\nsh", "$6", "x y",
                              "$6$sa lt$hash", "abJnggxhB/yW:"})
        EXPECT_NE(mihost::objectionToHash(wrong), std::nullopt) << wrong;
}

} // namespace input_validation_test
