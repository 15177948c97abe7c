#include "sysdata/driverInfo_linux.h"
#include "sysdata/driverInfo_parse.h"

#include <gtest/gtest.h>

#include <string>

namespace
{

using namespace NQ::driverLines;

struct Word {
    bool found;
    std::string text;
};

Word wordOf(std::string const& line)
{
    char module[lineSize] = "";
    bool const found = findModule(line.c_str(), module);
    return {found, module};
}

/** A record and its counts, fed line by line. */
struct Facts {
    bool take(std::string line)
    {
        line.push_back('\0');
        return takeFact(line.data(), driver, seen);
    }

    NQ::driverInfo driver;
    Seen seen;
};

TEST(DriverLines, YieldTheFirstWordAsTheModule)
{
    Word const word = wordOf("ext4                 823296  1\n");
    EXPECT_TRUE(word.found);
    EXPECT_EQ(word.text, "ext4");
}

TEST(DriverLines, SkipBlanksAndTabsBeforeTheModule)
{
    EXPECT_EQ(wordOf(" \t ext4 823296 1\n").text, "ext4");
    EXPECT_EQ(wordOf("ext4\t823296\n").text, "ext4");
}

TEST(DriverLines, YieldAModuleWithNothingAfterIt)
{
    EXPECT_EQ(wordOf("ext4").text, "ext4");
    EXPECT_EQ(wordOf("ext4\n").text, "ext4");
}

TEST(DriverLines, YieldNoModuleIfTheyAreBlank)
{
    EXPECT_FALSE(wordOf("\n").found);
    EXPECT_FALSE(wordOf("").found);
    EXPECT_FALSE(wordOf("  \t \r\n").found);
}

TEST(DriverLines, NeverOverflowTheModuleBuffer)
{
    EXPECT_EQ(wordOf(std::string(511, 'a')).text, std::string(511, 'a'));
    EXPECT_EQ(wordOf(std::string(5000, 'a')).text, std::string(511, 'a'));
}

TEST(DriverHeader, IsRecognisedByItsFirstSixCharacters)
{
    EXPECT_TRUE(isHeader("Module"));
    EXPECT_TRUE(isHeader("Module_of_mine"));
    EXPECT_TRUE(isHeader("Modules"));
}

TEST(DriverHeader, IsNotAnyOtherWord)
{
    EXPECT_FALSE(isHeader("Modul"));
    EXPECT_FALSE(isHeader("module"));
    EXPECT_FALSE(isHeader("aModule"));
    EXPECT_FALSE(isHeader(""));
}

TEST(DriverFacts, TakeTheVersionAfterTheBlanks)
{
    Facts facts;
    EXPECT_TRUE(facts.take("version:        7.3.21-k8-NAPI\n"));
    EXPECT_EQ(facts.driver.getVersion(), "7.3.21-k8-NAPI");
    EXPECT_TRUE(facts.seen.version);
    EXPECT_FALSE(facts.seen.description);
}

TEST(DriverFacts, TakeTheDescriptionAfterTheBlanks)
{
    Facts facts;
    EXPECT_TRUE(facts.take("description:    Intel(R) PRO/1000 Network Driver\n"));
    EXPECT_EQ(facts.driver.getDescription(), "Intel(R) PRO/1000 Network Driver");
    EXPECT_TRUE(facts.seen.description);
    EXPECT_FALSE(facts.seen.version);
}

TEST(DriverFacts, KeepBlanksAndCarriageReturnsAtTheEnd)
{
    Facts facts;
    facts.take("version: 1.0  \r\n");
    EXPECT_EQ(facts.driver.getVersion(), "1.0  \r");
}

TEST(DriverFacts, TakeALineWithoutALineEnd)
{
    Facts facts;
    facts.take("version: 1.0");
    EXPECT_EQ(facts.driver.getVersion(), "1.0");
}

TEST(DriverFacts, BeginAtTheFirstSpaceOfTheLine)
{
    Facts facts;
    EXPECT_TRUE(facts.take("version:1.0 beta 2\n"));
    EXPECT_EQ(facts.driver.getVersion(), "beta 2");
}

TEST(DriverFacts, AreNotTakenFromKeysThatMerelyEndInVersion)
{
    Facts facts;
    EXPECT_TRUE(facts.take("srcversion:     0D3AAC3E6C2A4A0A0F0E9F1\n"));
    EXPECT_TRUE(facts.take("vermagic:       6.1.0-13-amd64 SMP preempt mod_unload modversions\n"));
    EXPECT_TRUE(facts.take("rhelversion:    9.3\n"));
    EXPECT_FALSE(facts.seen.version);
    EXPECT_EQ(facts.driver.getVersion(), "");
}

TEST(DriverFacts, AreNotTakenFromKeysAfterABlank)
{
    Facts facts;
    EXPECT_TRUE(facts.take(" version: 1.0\n"));
    EXPECT_TRUE(facts.take("\tdescription: disk\n"));
    EXPECT_FALSE(facts.seen.version);
    EXPECT_FALSE(facts.seen.description);
}

TEST(DriverFacts, AreTakenFromExactKeysOnly)
{
    Facts facts;
    EXPECT_TRUE(facts.take("Version: 1.0\n"));
    EXPECT_TRUE(facts.take("version 1.0\n"));
    EXPECT_TRUE(facts.take("description disk\n"));
    EXPECT_TRUE(facts.take("versio"));
    EXPECT_TRUE(facts.take(""));
    EXPECT_FALSE(facts.seen.version);
    EXPECT_FALSE(facts.seen.description);
}

TEST(DriverFacts, LetTheLastOccurrenceWin)
{
    Facts facts;
    facts.take("version: 1\n");
    facts.take("description: first\n");
    facts.take("version: 2\n");
    facts.take("description: second\n");
    EXPECT_EQ(facts.driver.getVersion(), "2");
    EXPECT_EQ(facts.driver.getDescription(), "second");
    EXPECT_TRUE(facts.seen.version);
    EXPECT_TRUE(facts.seen.description);
}

TEST(DriverFacts, AreRefusedWithoutASpace)
{
    Facts facts;
    facts.take("version: 1\n");
    EXPECT_FALSE(facts.take("version:2\n"));
    EXPECT_FALSE(facts.take("version:\n"));
    EXPECT_FALSE(facts.take("version:\t2\n"));
    EXPECT_FALSE(facts.take("description:\n"));
    EXPECT_EQ(facts.driver.getVersion(), "1");
    EXPECT_TRUE(facts.seen.version);
    EXPECT_FALSE(facts.seen.description);
}

TEST(DriverFacts, CountAValueOfBlanksAsSeenAndEmpty)
{
    Facts facts;
    EXPECT_TRUE(facts.take("description: something\n"));
    EXPECT_TRUE(facts.take("description:    \n"));
    EXPECT_EQ(facts.driver.getDescription(), "");
    EXPECT_TRUE(facts.seen.description);
}

TEST(DriverCompletion, DefaultsWhatWasNeverSeen)
{
    Facts facts;
    facts.driver.setBuildNumber("1");
    facts.driver.setManufacturer("m");
    complete(facts.driver, facts.seen, "loop");
    EXPECT_EQ(facts.driver.getName(), "loop");
    EXPECT_EQ(facts.driver.getVersion(), "");
    EXPECT_EQ(facts.driver.getDescription(), "Driver");
    EXPECT_EQ(facts.driver.getBuildNumber(), "");
    EXPECT_EQ(facts.driver.getManufacturer(), "");
}

TEST(DriverCompletion, KeepsWhatWasSeenEvenIfItIsEmpty)
{
    Facts facts;
    facts.take("version: 3\n");
    facts.take("description:  \n");
    complete(facts.driver, facts.seen, "loop");
    EXPECT_EQ(facts.driver.getVersion(), "3");
    EXPECT_EQ(facts.driver.getDescription(), "");
}

} // namespace
