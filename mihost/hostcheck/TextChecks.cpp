// Conversion between texts and wide texts.

#include "host/make_string.h"
#include "mihost/hostcheck/Check.h"

namespace hostcheck
{

namespace
{

using NQ::make_string;
using NQ::make_wstring;

struct Character {
    char const* utf8;
    wchar_t const* wide;
};

constexpr Character characters[] = {
    {"a", L"a"},
    {"\xC3\xA9", L"\u00E9"},
    {"\xE2\x82\xAC", L"\u20AC"},
    {"\xF0\x9D\x84\x9E", L"\U0001D11E"},
};

std::string fromPointer()
{
    return firstOf(
        {equal("a copy", make_string("text"), "text"),
         equal("a copy of bytes that are not UTF-8", make_string("\xFF\xC3"), "\xFF\xC3")});
}

std::string fromNull()
{
    return equal("the text of a null pointer", make_string(static_cast<char const*>(nullptr)), "");
}

std::string toWide()
{
    for (Character const& character : characters) {
        std::wstring const wide = make_wstring(character.utf8);
        if (wide != character.wide)
            return equal("the length of one wide character", static_cast<long long>(wide.size()),
                         1) +
                   " for UTF-8 of " + std::to_string(std::string(character.utf8).size()) + " bytes";
    }
    return "";
}

std::string fromWide()
{
    for (Character const& character : characters)
        if (std::string problem =
                equal("UTF-8", make_string(std::wstring(character.wide)), character.utf8);
            !problem.empty())
            return problem;
    return "";
}

std::string thereAndBack(std::string const& text)
{
    return equal("the text after the way to wide text and back", make_string(make_wstring(text)),
                 text);
}

std::string oddTextsBack()
{
    for (std::string const& text : oddTexts())
        if (std::string problem = thereAndBack(text); !problem.empty())
            return problem;
    return "";
}

std::string invalidBack()
{
    // A byte alone, cut sequences, overlong forms, a surrogate, beyond the last character.
    for (char const* text : {"\xFF", "a\x80z", "\xC3", "\xE2\x82", "\xF0\x9D\x84", "\xC0\xAF",
                             "\xE0\x80\xAF", "\xED\xA0\x80", "\xED\xB2\x80", "\xF4\x90\x80\x80"})
        if (std::string problem = thereAndBack(text); !problem.empty())
            return problem;
    return "";
}

} // namespace

Checks textChecks()
{
    constexpr char const* toWideName = "NQ::make_wstring(std::string const&)";
    return {
        {"NQ::make_string(char const*)", "copies the text", fromPointer},
        {"NQ::make_string(char const*)", "is empty for a null pointer", fromNull},
        {toWideName, "makes one wide character of each UTF-8 character", toWide},
        {"NQ::make_string(std::wstring const&)", "writes UTF-8", fromWide},
        {toWideName, "keeps bytes that are not UTF-8", invalidBack},
        {toWideName, "loses nothing of empty, long and odd texts", oddTextsBack},
    };
}

} // namespace hostcheck
