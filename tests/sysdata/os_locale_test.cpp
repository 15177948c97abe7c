#include "sysdata/osInfo_linux.h"

#include "tests/support/Lines.h"
#include "tests/support/WideTexts.h"

#include <gtest/gtest.h>

#include <clocale>
#include <cstdlib>
#include <string>

namespace os_locale_test
{

using NQ::OsInfo;

/** What one operation yields with these variables; null: not set. */
std::string read(bool (OsInfo::*get)(std::string&), char const* lang, char const* characterType)
{
    unsetenv("LANG");
    unsetenv("LC_CTYPE");
    if (lang)
        setenv("LANG", lang, 1);
    if (characterType)
        setenv("LC_CTYPE", characterType, 1);
    std::string out = "before";
    EXPECT_TRUE((OsInfo().*get)(out));
    return out;
}

struct Case {
    char const* lang;
    char const* found;
};

TEST(LanguageEdition, IsTheLocaleWithoutItsCodeSetAndWithHyphens)
{
    Case const cases[] = {
        {"en_US.UTF-8", "en-US"},
        {"de_DE", "de-DE"},
        {"C", "C"},
        {"POSIX", "en-US"},
        {"  POSIX ", "en-US"},
        {"posix", "posix"},
        {"POSIX.UTF-8", "POSIX"},
        {"", ""},
        {"sr_RS@latin_old", "sr-RS@latin-old"}, // kept, since it follows no dot
        {"sr_RS.UTF-8@latin", "sr-RS"},
        {"en_US.a.b", "en-US.a"},
        {"en_US.", "en-US"},
        {".UTF-8", ""},
        {"  en_US.UTF-8  ", "en-US"},
        {"  en_US  ", "en-US"},
        {"\ten_US\t", "\ten-US\t"},
        {"en US", "en US"},
    };
    for (auto const& [lang, found] : cases)
        EXPECT_EQ(read(&OsInfo::getLanguageEdition, lang, nullptr), found) << lang;
}

TEST(LanguageEdition, FallsBackToTheCharacterType)
{
    auto const of = [](char const* lang, char const* characterType) {
        return read(&OsInfo::getLanguageEdition, lang, characterType);
    };
    EXPECT_EQ(of(nullptr, nullptr), "");
    EXPECT_EQ(of("", ""), "");
    EXPECT_EQ(of(nullptr, "POSIX"), "en-US");
    EXPECT_EQ(of(nullptr, "fr_FR.ISO-8859-1"), "fr-FR");
    EXPECT_EQ(of("", "fr_FR.ISO-8859-1"), "fr-FR");
    EXPECT_EQ(of("en_US.UTF-8", "fr_FR.ISO-8859-1"), "en-US");
    EXPECT_EQ(of("   ", "fr_FR"), "");
}

TEST(CodeSet, IsWhatFollowsTheFirstDot)
{
    Case const cases[] = {
        {"en_US.UTF-8", "UTF-8"},
        {"en_US.a.b", "a.b"},
        {"sr_RS.UTF-8@latin", "UTF-8@latin"},
        {"POSIX", "UTF-8"},
        {" POSIX  ", "UTF-8"},
        {"posix", "posix"},
        {"POSIX@x", "POSIX@x"},
        {"POSIX.ISO-8859-1", "ISO-8859-1"},
        {"en_US", "en_US"}, // the whole locale if it has no dot
        {"C", "C"},
        {"  en_US  ", "en_US"},
        {" en_US.UTF-8  ", "UTF-8"},
    };
    for (auto const& [lang, found] : cases)
        EXPECT_EQ(read(&OsInfo::getCodeSet, lang, nullptr), found) << lang;
}

TEST(CodeSet, IsThatOfTheProcessWhenNothingElseRemains)
{
    std::setlocale(LC_ALL, "C");
    for (char const* lang : {static_cast<char const*>(nullptr), "", "   ", "en_US."})
        EXPECT_EQ(read(&OsInfo::getCodeSet, lang, "fr_FR.ISO-8859-1"), "ANSI_X3.4-1968");
    ASSERT_NE(std::setlocale(LC_ALL, "C.UTF-8"), nullptr);
    EXPECT_EQ(read(&OsInfo::getCodeSet, "en_US.", nullptr), "UTF-8");
}

TEST(Locale, IsConvertedByTheHost)
{
    std::setlocale(LC_ALL, "C");
    WideTexts const texts;
    read(&OsInfo::getLanguageEdition, "", "fr_FR");
    read(&OsInfo::getCodeSet, "en_US.", nullptr);
    EXPECT_EQ(texts.made, (Lines{"", "fr_FR", "en_US.", "ANSI_X3.4-1968"}));
}

} // namespace os_locale_test
