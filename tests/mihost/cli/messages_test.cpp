// The form of every message that the program can print: "mihost: ", what was being done, what is
// wrong, and in parentheses what to do; one line, in lower case, without a full stop.

#include "TestPaths.h"
#include "tests/support/Lines.h"
#include "tests/support/MessageForm.h"

#include <algorithm>
#include <cctype>
#include <filesystem>
#include <gtest/gtest.h>
#include <optional>
#include <regex>

namespace messages_test
{

namespace fs = std::filesystem;

/** A string literal; adjacent ones count as one. */
struct Literal {
    std::size_t start; // in the code
    std::size_t end;
    std::string text;
};

/** A source file: its code, with blanks in place of comments and of what literals contain. */
struct Source {
    std::string code;
    std::vector<Literal> literals;
};

/** The length of a comment or a character literal that begins here; 0 if there is none. */
std::size_t lengthOfOther(std::string const& text, std::size_t at)
{
    auto const to = [&text, at](char const* end, std::size_t from) {
        std::size_t const found = text.find(end, at + from);
        return found == std::string::npos ? text.size() - at : found - at;
    };
    if (text.compare(at, 2, "//") == 0)
        return to("\n", 2);
    if (text.compare(at, 2, "/*") == 0)
        return to("*/", 2) + 2;
    bool const isDigitSeparator = at > 0 && std::isalnum(static_cast<unsigned char>(text[at - 1]));
    if (text[at] != '\'' || isDigitSeparator)
        return 0;
    return text[at + 1] == '\\' ? to("'", 3) + 1 : 3;
}

/** The index after the literal that begins with the quote here; its text is appended. */
std::size_t endOfLiteral(std::string const& text, std::size_t at, std::string& content)
{
    for (++at; at < text.size() && text[at] != '"'; ++at) {
        if (text[at] == '\\')
            content += text[at++];
        content += text[at];
    }
    return at + 1;
}

Source sourceOf(std::string const& text)
{
    Source source{text, {}};
    for (std::size_t at = 0; at < text.size();) {
        std::size_t end = at + lengthOfOther(text, at);
        if (end == at && text[at] == '"') {
            bool const continues =
                !source.literals.empty() &&
                source.code.find_first_not_of(" \n", source.literals.back().end) == at;
            if (!continues)
                source.literals.push_back({at, at, ""});
            end = endOfLiteral(text, at, source.literals.back().text);
            source.literals.back().end = end;
        } else if (end == at) {
            ++at;
            continue;
        }
        source.code.replace(at, end - at, end - at, text[at] == '"' ? '"' : ' ');
        at = end;
    }
    return source;
}

bool isSentence(std::string const& text)
{
    return std::count(text.begin(), text.end(), ' ') >= 2;
}

/** @return the messages in statements that fail, warn or give a reason */
std::vector<std::string> messagesOf(Source const& source)
{
    static std::regex const start(
        "\\b(return|throw|warn|check|failed|declined|warnings|problem|findings|Failure)\\b");
    std::vector<std::string> messages;
    std::size_t done = 0;
    for (auto at = std::sregex_iterator(source.code.begin(), source.code.end(), start);
         at != std::sregex_iterator(); ++at) {
        auto const from = static_cast<std::size_t>(at->position());
        std::size_t const to = source.code.find(';', from);
        if (from < done)
            continue;
        for (Literal const& literal : source.literals)
            if (literal.start >= from && literal.end <= to && isSentence(literal.text))
                messages.push_back(literal.text);
        done = to;
    }
    return messages;
}

/** The same for a literal, without the values that it is filled with. */
std::optional<std::string> flawOfLiteral(std::string const& message)
{
    return flawOf(std::regex_replace(message, std::regex("\\{[^}]*\\}"), ""));
}

TEST(MessageForm, IsOneLineInLowerCaseWithoutAFullStop)
{
    // These print results, not messages.
    std::vector<std::string> const others = {
        "BoundedText.cpp", "CatalogueText.cpp", "GroupView.cpp", "MachineMetrics.cpp",
        "Power.cpp",       "Report.cpp",        "Timing.cpp",    "UserView.cpp"};
    std::size_t found = 0;
    for (char const* folder : {"/../mihost/cli", "/../mihost/sandbox", "/../mihost/accel"})
        for (auto const& entry :
             fs::recursive_directory_iterator(TESTS_DIR + std::string(folder))) {
            std::string const name = entry.path().filename().string();
            if (!entry.is_regular_file() ||
                std::find(others.begin(), others.end(), name) != others.end())
                continue;
            for (std::string const& message : messagesOf(sourceOf(contentOf(entry.path())))) {
                ++found;
                if (auto const flaw = flawOfLiteral(message))
                    ADD_FAILURE() << name << ": '" << message << "' " << *flaw;
            }
        }
    EXPECT_GT(found, 250U);
}

TEST(MessageForm, IsSeenInEachMessageOfASource)
{
    Source const source =
        sourceOf("// \"not a message at all\"\n"
                 "throw Failure(BadUsage, fmt::format(\"{}: no such \"\n"
                 "    \"thing as '{}'\", ';', name));\n"
                 "char const* const text = \"nor is this one\";\n"
                 "return is ? \"one reason; of two\" : \"the other \\\"reason\\\"\";\n");
    EXPECT_EQ(messagesOf(source),
              (std::vector<std::string>{"{}: no such thing as '{}'", "one reason; of two",
                                        "the other \\\"reason\\\""}));
}

TEST(MessageForm, HasNoneOfTheseFlaws)
{
    EXPECT_EQ(flawOf("no node '{}' (see 'mihost tree')"), std::nullopt);
    EXPECT_EQ(flawOf("UserName contains a blank"), std::nullopt);
    EXPECT_EQ(flawOf("and more ..."), std::nullopt);
    EXPECT_EQ(flawOf("no node '{}' (write user:NAME; see 'mihost tree')"), std::nullopt);
    EXPECT_EQ(flawOf("No such node"), "begins with a capital letter");
    EXPECT_EQ(flawOf("there is no such node."), "ends with a full stop");
    EXPECT_EQ(flawOf("there is no\\nsuch node"), "has more than one line");
    EXPECT_EQ(flawOf("no such node; see 'mihost tree'"), "has what to do outside of parentheses");
    EXPECT_EQ(flawOf(std::string(161, 'x')), "is too long");
    EXPECT_EQ(flawOfLiteral("{" + std::string(200, 'x') + "}"), std::nullopt);
    EXPECT_EQ(flawOf("call UserAdd: '" + std::string(200, 'x') + "' failed"), std::nullopt);
    EXPECT_EQ(flawOf("call UserAdd: failed; a command printed: No."), std::nullopt);
}

TEST(MessageForm, IsCheckedInEachLineOfStandardError)
{
    EXPECT_EQ(flawOfMessages("mihost: no node 'x'\nBut this is a command's.\n"), std::nullopt);
    EXPECT_EQ(flawOfMessages("mihost: no node 'x'\nmihost: Oh\n"),
              "'mihost: Oh' begins with a capital letter");
}

} // namespace messages_test
