#include "sysdata/driverInfo_linux.h"
#include "sysdata/driverInfo_parse.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <optional>
#include <string>

namespace
{

using namespace NQ::driverLines;

std::optional<std::string> moduleOf(std::string const& line)
{
    char module[lineSize] = "";
    return findModule(line.c_str(), module) ? std::optional<std::string>(module) : std::nullopt;
}

TEST(DriverLines, YieldTheFirstWordAsTheModule)
{
    for (char const* line : {"ext4                 823296  1\n", " \t ext4 823296 1\n",
                             "ext4\t823296\n", "ext4", "ext4\n"})
        EXPECT_EQ(moduleOf(line), "ext4") << line;
    for (char const* line : {"\n", "", "  \t \r\n"})
        EXPECT_EQ(moduleOf(line), std::nullopt) << line;
    for (std::size_t const length : {511U, 5000U}) // never more than the buffer
        EXPECT_EQ(moduleOf(std::string(length, 'a')), std::string(511, 'a'));
}

TEST(DriverHeader, IsRecognisedByItsFirstSixCharacters)
{
    for (char const* word : {"Module", "Module_of_mine", "Modules"})
        EXPECT_TRUE(isHeader(word)) << word;
    for (char const* word : {"Modul", "module", "aModule", ""})
        EXPECT_FALSE(isHeader(word)) << word;
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

TEST(DriverFacts, AreTakenAfterTheBlanksOfTheirLine)
{
    struct {
        char const* line;
        char const* version;
        char const* description;
    } const cases[] = {
        {"version:        7.3.21-k8-NAPI\n", "7.3.21-k8-NAPI", ""},
        {"description:    Intel(R) PRO/1000 Network Driver\n", "",
         "Intel(R) PRO/1000 Network Driver"},
        {"version: 1.0  \r\n", "1.0  \r", ""},
        {"version: 1.0", "1.0", ""},
        {"version:1.0 beta 2\n", "beta 2", ""}, // from the first space on
    };
    for (auto const& [line, version, description] : cases) {
        Facts facts;
        EXPECT_TRUE(facts.take(line)) << line;
        EXPECT_EQ(facts.driver.getVersion(), version);
        EXPECT_EQ(facts.driver.getDescription(), description);
        EXPECT_EQ(facts.seen.version, *version != '\0');
        EXPECT_EQ(facts.seen.description, *description != '\0');
    }
}

TEST(DriverFacts, AreTakenFromExactKeysAtTheStartOnly)
{
    Facts facts;
    for (char const* line : {"srcversion:     0D3AAC3E6C2A4A0A0F0E9F1\n",
                             "vermagic:       6.1.0-13-amd64 SMP preempt mod_unload modversions\n",
                             "rhelversion:    9.3\n", " version: 1.0\n", "\tdescription: disk\n",
                             "Version: 1.0\n", "version 1.0\n", "description disk\n", "versio", ""})
        EXPECT_TRUE(facts.take(line)) << line;
    EXPECT_FALSE(facts.seen.version);
    EXPECT_FALSE(facts.seen.description);
    EXPECT_EQ(facts.driver.getVersion(), "");
}

TEST(DriverFacts, LetTheLastOccurrenceWin)
{
    Facts facts;
    for (char const* line :
         {"version: 1\n", "description: first\n", "version: 2\n", "description: second\n"})
        EXPECT_TRUE(facts.take(line));
    EXPECT_EQ(facts.driver.getVersion(), "2");
    EXPECT_EQ(facts.driver.getDescription(), "second");
    EXPECT_TRUE(facts.seen.version);
    EXPECT_TRUE(facts.seen.description);
    EXPECT_TRUE(facts.take("description:    \n")); // seen, and empty
    EXPECT_EQ(facts.driver.getDescription(), "");
}

TEST(DriverFacts, AreRefusedWithoutASpace)
{
    Facts facts;
    facts.take("version: 1\n");
    for (char const* line : {"version:2\n", "version:\n", "version:\t2\n", "description:\n"})
        EXPECT_FALSE(facts.take(line)) << line;
    EXPECT_EQ(facts.driver.getVersion(), "1");
    EXPECT_TRUE(facts.seen.version);
    EXPECT_FALSE(facts.seen.description);
}

TEST(DriverCompletion, DefaultsWhatWasNeverSeen)
{
    Facts facts;
    facts.driver.setBuildNumber("1");
    facts.driver.setManufacturer("m");
    Recording const log;
    complete(facts.driver, facts.seen, "loop");
    EXPECT_EQ(log.texts(), (Lines{"setVersion: entry", "setVersion: exit", "setDescription: entry",
                                  "setDescription: exit", "setName: entry", "setName: exit",
                                  "setBuildNumber: entry", "setBuildNumber: exit",
                                  "setManufacturer: entry", "setManufacturer: exit"}));
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
