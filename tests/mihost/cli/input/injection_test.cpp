// Every byte in every place of every argument: what mihost accepts reaches the shell unchanged.

#include "mihost/cli/input/MethodCall.h"
#include "mihost/cli/input/ValueText.h"
#include "mihost/cli/plugin/CommandGuard.h"
#include "mihost/cli/system/Failure.h"
#include "tests/mihost/cli/input/RightValue.h"
#include "tests/sysdata/MethodTest.h"

#include <array>
#include <optional>

namespace injection_test
{

using mihost::Form;

/** Longer texts with a meaning in a shell. */
constexpr char const* attacks[] = {
    "x;reboot",    "x|reboot", "x&reboot", "x`reboot`", "x$(reboot)", "x${IFS}y", "x\nreboot",
    "x\r\nreboot", "x>/tmp/x", "x</tmp/x", "x'y",       "x\"y",       "x\\",      "x\\;reboot",
    "x*",          "x?",       "x[a]",     "x{a,b}",    "~root",      "x~y",      "#x",
    "x!y",         "x=y",      "x%y",      "x^y",       "(x)",        "x,y",      "x:y",
    "x\xC2\x85y",  "x\xFFy",   "-x",       "+1",        "x\ty",       "x\x1B[2J", "",
    "x\" \"y",     "x 2>&1",   "--help",
};

/** @return the attacks, and the text with each byte from 1 to 255 at its start, middle and end */
std::vector<std::string> variantsOf(std::string const& right)
{
    std::vector<std::string> variants(std::begin(attacks), std::end(attacks));
    for (int byte = 1; byte < 256; ++byte)
        for (std::size_t const at : {std::size_t{0}, right.size() / 2, right.size()}) {
            variants.push_back(right);
            variants.back().insert(at, 1, static_cast<char>(byte));
        }
    return variants;
}

/** @return the call with one value replaced; nothing if mihost refuses it */
std::optional<std::string> callText(mihost::Method const& method, mihost::Parameter const& replaced,
                                    std::string const& value)
{
    std::vector<std::string> words;
    for (mihost::Parameter const& parameter : method.parameters)
        words.push_back(parameter.name + std::string("=") +
                        (&parameter == &replaced ? value : rightValue(parameter.form)));
    try {
        return textOf(mihost::parseCall(method.name, words, [](std::string const&) { return ""; }));
    } catch (mihost::Failure const& failure) {
        EXPECT_EQ(failure.code(), mihost::BadUsage);
        EXPECT_EQ(std::string(failure.what()).find('\n'), std::string::npos);
        return std::nullopt;
    }
}

std::string escaped(std::string const& value)
{
    std::string text;
    for (char const byte : value)
        text += byte == ' ' ? "\\ " : std::string(1, byte);
    return text;
}

/** @return the lines of a harmless call with its one value replaced */
std::vector<std::string> replaceIn(std::vector<std::string> lines, std::string const& old,
                                   std::string const& now)
{
    for (std::string& line : lines)
        for (std::size_t at = 0; (at = line.find(old, at)) != std::string::npos; at += now.size())
            line.replace(at, old.size(), now);
    return lines;
}

class Injection : public MethodTest
{
protected:
    std::vector<std::string> linesOf(std::string const& callText)
    {
        commands_.ran.clear();
        call(callText);
        return commands_.ran;
    }
};

TEST_F(Injection, IntoAnyParameterOfAnyMethodRunsNothingElse)
{
    commands_.answers["/usr/bin/id \"marker\" 2>&1"] = "uid=1(marker) gid=1(jdoe) groups=1(jdoe)\n";
    commands_.otherwise = "";
    for (mihost::Method const& method : mihost::methods())
        for (mihost::Parameter const& parameter : method.parameters) {
            bool const isText = parameter.form != Form::Digits && parameter.form != Form::Day;
            // A value that occurs nowhere else in the lines.
            std::string const marker = parameter.form == Form::Path ? "/marker" : "marker";
            auto const harmless = isText ? callText(method, parameter, marker) : std::nullopt;
            for (std::string const& value : variantsOf(rightValue(parameter.form))) {
                auto const text = callText(method, parameter, value);
                if (!text)
                    continue;
                std::string const member = "/usr/bin/id \"" + value + "\" 2>&1";
                commands_.answers[member] = "uid=1(x) gid=1(jdoe) groups=1(jdoe)\n";
                std::vector<std::string> const ran = linesOf(*text);
                for (std::string const& line : ran)
                    EXPECT_EQ(mihost::objectionToCommand(line), std::nullopt) << line;
                if (harmless) {
                    EXPECT_EQ(ran, replaceIn(linesOf(*harmless), marker, escaped(value)));
                }
                if (std::string(parameter.name) == "DomainAndMember")
                    commands_.answers.erase(member);
            }
        }
}

TEST_F(Injection, IntoAMethodNameOrAParameterNameRunsNothing)
{
    auto const refuses = [](std::string const& method, std::string const& word) {
        EXPECT_THROW(mihost::parseCall(method, {word}, [](std::string const&) { return ""; }),
                     mihost::Failure)
            << method << " " << word;
    };
    for (std::string const& variant : variantsOf("UserDel"))
        refuses(variant, "UserName=jdoe");
    for (std::string const& variant : variantsOf("UserName"))
        if (variant != "UserName=") // the value is "=jdoe" then
            refuses("UserDel", variant + "=jdoe");
}

TEST_F(Injection, IntoAMethodCallTextIsRefusedOrHarmless)
{
    std::string const right = "UserAdd,UserName:CMPI_string:jdoe,HomeDir:CMPI_string:/home/j,"
                              "passwordExpirationDate:CMPI_dateTime:20301231000000.000000+000";
    for (unsigned int byte = 1; byte < 256; ++byte)
        for (std::size_t at = byte % 3; at <= right.size(); at += 3) { // a third of the places
            std::string text = right;
            text.insert(at, 1, static_cast<char>(byte));
            try {
                mihost::takeApart(text);
            } catch (mihost::Failure const&) {
                continue;
            }
            for (std::string const& line : linesOf(text))
                EXPECT_EQ(mihost::objectionToCommand(line), std::nullopt) << line;
        }
}

TEST_F(Injection, IntoAPropertyThatActsLeavesHashesDatesAndNumbers)
{
    for (mihost::NodeKind const& kind : mihost::nodeKinds())
        for (mihost::Property const& property : kind.properties) {
            if (!property.has(mihost::Property::Acts) || property.form == Form::MethodCall)
                continue;
            for (std::string const right : {"$6$salt$hash", "2030-12-31", "true", "9"})
                for (std::string const& value : variantsOf(right)) {
                    try {
                        auto const taken =
                            static_cast<std::string>(mihost::parseValue(property, value));
                        EXPECT_EQ(taken.find_first_not_of("0123456789-: $./abcdefghijklmnopqrstuvwx"
                                                          "yzABCDEFGHIJKLMNOPQRSTUVWXYZ=,+_!*"),
                                  std::string::npos)
                            << property.name << " " << value;
                        if (property.form == Form::Hash) {
                            EXPECT_EQ(taken.find_first_of(": \n"), std::string::npos) << value;
                        }
                    } catch (mihost::Failure const& failure) {
                        EXPECT_EQ(failure.code(), mihost::BadUsage);
                    }
                }
        }
}

} // namespace injection_test
