#include "sysdata/osInfo_linux.h"

#include <gtest/gtest.h>

#include <clocale>
#include <cstdlib>
#include <string>

namespace os_locale_test
{

using NQ::OsInfo;

void set(char const* name, char const* value)
{
    if (value)
        setenv(name, value, 1);
    else
        unsetenv(name);
}

std::string languageEdition(char const* lang, char const* characterType = nullptr)
{
    set("LANG", lang);
    set("LC_CTYPE", characterType);
    std::string out = "before";
    EXPECT_TRUE(OsInfo().getLanguageEdition(out));
    return out;
}

std::string codeSet(char const* lang, char const* characterType = nullptr)
{
    set("LANG", lang);
    set("LC_CTYPE", characterType);
    std::string out = "before";
    EXPECT_TRUE(OsInfo().getCodeSet(out));
    return out;
}

TEST(LanguageEdition, IsTheLocaleWithoutItsCodeSetAndWithHyphens)
{
    EXPECT_EQ(languageEdition("en_US.UTF-8"), "en-US");
    EXPECT_EQ(languageEdition("de_DE"), "de-DE");
    EXPECT_EQ(languageEdition("C"), "C");
}

TEST(LanguageEdition, IsAmericanEnglishForPosix)
{
    EXPECT_EQ(languageEdition("POSIX"), "en-US");
    EXPECT_EQ(languageEdition(nullptr, "POSIX"), "en-US");
    EXPECT_EQ(languageEdition("  POSIX "), "en-US");
    EXPECT_EQ(languageEdition("posix"), "posix");
    EXPECT_EQ(languageEdition("POSIX.UTF-8"), "POSIX");
}

TEST(LanguageEdition, IsEmptyWithoutALocale)
{
    EXPECT_EQ(languageEdition(nullptr), "");
    EXPECT_EQ(languageEdition(""), "");
    EXPECT_EQ(languageEdition("", ""), "");
}

TEST(LanguageEdition, FallsBackToTheCharacterType)
{
    EXPECT_EQ(languageEdition(nullptr, "fr_FR.ISO-8859-1"), "fr-FR");
    EXPECT_EQ(languageEdition("", "fr_FR.ISO-8859-1"), "fr-FR");
    EXPECT_EQ(languageEdition("en_US.UTF-8", "fr_FR.ISO-8859-1"), "en-US");
}

TEST(LanguageEdition, DoesNotFallBackFromALanguageOfBlanks)
{
    EXPECT_EQ(languageEdition("   ", "fr_FR"), "");
}

TEST(LanguageEdition, KeepsAModifierThatFollowsNoDot)
{
    EXPECT_EQ(languageEdition("sr_RS@latin_old"), "sr-RS@latin-old");
    EXPECT_EQ(languageEdition("sr_RS.UTF-8@latin"), "sr-RS");
}

TEST(LanguageEdition, IsCutAtTheLastDot)
{
    EXPECT_EQ(languageEdition("en_US.a.b"), "en-US.a");
    EXPECT_EQ(languageEdition("en_US."), "en-US");
    EXPECT_EQ(languageEdition(".UTF-8"), "");
}

TEST(LanguageEdition, LosesTheBlanksAroundIt)
{
    EXPECT_EQ(languageEdition("  en_US.UTF-8  "), "en-US");
    EXPECT_EQ(languageEdition("  en_US  "), "en-US");
    EXPECT_EQ(languageEdition("\ten_US\t"), "\ten-US\t");
    EXPECT_EQ(languageEdition("en US"), "en US");
}

TEST(CodeSet, IsWhatFollowsTheFirstDot)
{
    EXPECT_EQ(codeSet("en_US.UTF-8"), "UTF-8");
    EXPECT_EQ(codeSet("en_US.a.b"), "a.b");
    EXPECT_EQ(codeSet("sr_RS.UTF-8@latin"), "UTF-8@latin");
}

TEST(CodeSet, IsUtf8ForPosix)
{
    EXPECT_EQ(codeSet("POSIX"), "UTF-8");
    EXPECT_EQ(codeSet(" POSIX  "), "UTF-8");
    EXPECT_EQ(codeSet("posix"), "posix");
    EXPECT_EQ(codeSet("POSIX@x"), "POSIX@x");
    EXPECT_EQ(codeSet("POSIX.ISO-8859-1"), "ISO-8859-1");
}

TEST(CodeSet, IsTheWholeLocaleWhenItHasNoDot)
{
    EXPECT_EQ(codeSet("en_US"), "en_US");
    EXPECT_EQ(codeSet("C"), "C");
}

TEST(CodeSet, LosesTheBlanksAroundTheLocale)
{
    EXPECT_EQ(codeSet("  en_US  "), "en_US");
    EXPECT_EQ(codeSet(" en_US.UTF-8  "), "UTF-8");
}

TEST(CodeSet, IsThatOfTheProcessWhenNothingElseRemains)
{
    std::setlocale(LC_ALL, "C");
    EXPECT_EQ(codeSet(nullptr), "ANSI_X3.4-1968");
    EXPECT_EQ(codeSet(""), "ANSI_X3.4-1968");
    EXPECT_EQ(codeSet("   "), "ANSI_X3.4-1968");
    EXPECT_EQ(codeSet("en_US."), "ANSI_X3.4-1968");
    ASSERT_NE(std::setlocale(LC_ALL, "C.UTF-8"), nullptr);
    EXPECT_EQ(codeSet("en_US."), "UTF-8");
}

TEST(CodeSet, DoesNotFallBackToTheCharacterType)
{
    std::setlocale(LC_ALL, "C");
    EXPECT_EQ(codeSet(nullptr, "fr_FR.ISO-8859-1"), "ANSI_X3.4-1968");
}

} // namespace os_locale_test
