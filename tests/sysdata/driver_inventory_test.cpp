#include "sysdata/driverInfo_linux.h"
#include "tests/interpose/Libc.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace driver_inventory_test
{

using NQ::driverInfo;

constexpr char header[] = "Module                  Size  Used by\n";

class DriverInventory : public testing::Test
{
protected:
    std::vector<driverInfo> list()
    {
        std::vector<driverInfo> drivers;
        NQ::getDriverInfo(drivers);
        return drivers;
    }

    /** What a listing logs besides entry and exit lines. */
    Lines remarks()
    {
        Recording const recording;
        list();
        return recording.remarks();
    }

    Lines names()
    {
        Lines found;
        for (driverInfo const& driver : list())
            found.push_back(driver.getName());
        return found;
    }

    driverInfo only()
    {
        std::vector<driverInfo> const drivers = list();
        EXPECT_EQ(drivers.size(), 1U);
        return drivers.empty() ? driverInfo() : drivers.front();
    }

    FakeCommands commands;
};

TEST_F(DriverInventory, ListsModulesInTheOrderOfLsmod)
{
    commands.answers = {{"lsmod", std::string(header) + "xfs 1 0\next4 2 1 a,b\nzram 3 0\n"},
                        {"modinfo xfs", "description:    SGI XFS\nversion:        1\n"},
                        {"modinfo ext4", "version:        2\ndescription:    Fourth\n"},
                        {"modinfo zram", "license:        GPL\n"}};
    std::vector<driverInfo> const drivers = list();
    ASSERT_EQ(drivers.size(), 3U);
    EXPECT_EQ(drivers[0].getName(), "xfs");
    EXPECT_EQ(drivers[0].getVersion(), "1");
    EXPECT_EQ(drivers[0].getDescription(), "SGI XFS");
    EXPECT_EQ(drivers[1].getName(), "ext4");
    EXPECT_EQ(drivers[1].getVersion(), "2");
    EXPECT_EQ(drivers[1].getDescription(), "Fourth");
    EXPECT_EQ(drivers[2].getName(), "zram");
    EXPECT_EQ(drivers[2].getVersion(), "");
    EXPECT_EQ(drivers[2].getDescription(), "Driver");
    for (driverInfo const& driver : drivers) {
        EXPECT_EQ(driver.getBuildNumber(), "");
        EXPECT_EQ(driver.getManufacturer(), "");
    }
    EXPECT_EQ(commands.ran, (Lines{"lsmod", "modinfo xfs", "modinfo ext4", "modinfo zram"}));
    EXPECT_EQ(commands.modes, Lines(4, "r"));
    EXPECT_EQ(commands.open, 0);
}

TEST_F(DriverInventory, KeepsLsmodOpenWhileEachModinfoRuns)
{
    commands.answers = {{"lsmod", "a\nb\n"}, {"modinfo a", ""}, {"modinfo b", ""}};
    std::vector<int> openBefore;
    libc::hooks().popen = [this, &openBefore, fake = libc::hooks().popen.answer()](
                              char const* command, char const* mode) {
        openBefore.push_back(commands.open);
        return fake(command, mode);
    };
    list();
    EXPECT_EQ(openBefore, (std::vector<int>{0, 1, 1}));
}

TEST_F(DriverInventory, IsEmptyWithTheHeaderOnly)
{
    commands.answers = {{"lsmod", header}};
    EXPECT_TRUE(list().empty());
    EXPECT_EQ(commands.ran, Lines{"lsmod"});
}

TEST_F(DriverInventory, IsEmptyWhenLsmodPrintsNothing)
{
    commands.answers = {{"lsmod", ""}};
    EXPECT_EQ(remarks(), Lines{});
    EXPECT_TRUE(list().empty());
}

TEST_F(DriverInventory, ReplacesWhatTheVectorHeld)
{
    commands.answers = {{"lsmod", "loop 1 0\n"}, {"modinfo loop", ""}};
    std::vector<driverInfo> drivers(3);
    NQ::getDriverInfo(drivers);
    ASSERT_EQ(drivers.size(), 1U);
    EXPECT_EQ(drivers[0].getName(), "loop");
}

TEST_F(DriverInventory, IsEmptiedWhenLsmodCannotBeStarted)
{
    Recording const recording;
    std::vector<driverInfo> drivers(3);
    NQ::getDriverInfo(drivers);
    EXPECT_TRUE(drivers.empty());
    EXPECT_EQ(recording.texts(3000),
              (Lines{"getDriverInfo: entry", "Cannot open process: lsmod", "getDriverInfo: exit"}));
    EXPECT_EQ(recording.texts(6000), Lines{});
    EXPECT_EQ(commands.ran, Lines{"lsmod"});
}

TEST_F(DriverInventory, OmitsAModuleIfModinfoCannotBeStarted)
{
    commands.answers = {{"lsmod", "a\nb\nc\n"}, {"modinfo a", ""}, {"modinfo c", ""}};
    Recording const recording;
    EXPECT_EQ(names(), (Lines{"a", "c"}));
    EXPECT_TRUE(recording.has("Cannot open process: modinfo", 3000));
    EXPECT_EQ(recording.texts(6000), Lines{});
    EXPECT_EQ(commands.open, 0);
}

TEST_F(DriverInventory, KeepsAModuleThatModinfoDoesNotKnow)
{
    commands.answers = {{"lsmod", "ghost 1 0\n"}, {"modinfo ghost", ""}};
    driverInfo const driver = only();
    EXPECT_EQ(driver.getName(), "ghost");
    EXPECT_EQ(driver.getVersion(), "");
    EXPECT_EQ(driver.getDescription(), "Driver");
}

TEST_F(DriverInventory, ReportsABlankLineAndContinues)
{
    commands.answers = {{"lsmod", "\n \t\nloop 1 0\n"}, {"modinfo loop", ""}};
    Recording const recording;
    EXPECT_EQ(names(), Lines{"loop"});
    EXPECT_EQ(recording.texts(6000),
              (Lines{"Invalid format: buffer1 = \n", "Invalid format: buffer1 =  \t\n"}));
}

TEST_F(DriverInventory, SkipsAModuleNamedLikeTheHeader)
{
    commands.answers = {{"lsmod", "Module_mine 1 0\nloop 1 0\n"},
                        {"modinfo Module_mine", ""},
                        {"modinfo loop", ""}};
    EXPECT_EQ(names(), Lines{"loop"});
    EXPECT_EQ(commands.ran, (Lines{"lsmod", "modinfo loop"}));
}

TEST_F(DriverInventory, ReportsFactsWithoutASpace)
{
    commands.answers = {{"lsmod", "loop 1 0\n"},
                        {"modinfo loop", "version: 1\nversion:2\ndescription:disk\n"}};
    Recording const recording;
    driverInfo const driver = only();
    EXPECT_EQ(driver.getVersion(), "1");
    EXPECT_EQ(driver.getDescription(), "Driver");
    EXPECT_EQ(recording.texts(6000), (Lines{"Invalid format: buffer2 = version:2\n",
                                            "Invalid format: buffer2 = description:disk\n"}));
}

TEST_F(DriverInventory, GivesNoDefaultToADescriptionOfBlanks)
{
    commands.answers = {{"lsmod", "loop 1 0\n"}, {"modinfo loop", "description:     \n"}};
    EXPECT_EQ(only().getDescription(), "");
}

TEST_F(DriverInventory, LogsEveryStepInOrder)
{
    commands.answers = {{"lsmod", std::string(header) + "loop 1 0\n"},
                        {"modinfo loop", "version: 1\nlicense: GPL\n"}};
    Recording const recording;
    list();
    EXPECT_EQ(
        recording.texts(3000),
        (Lines{"getDriverInfo: entry", "buffer = Module                  Size  Used by\n",
               "buffer = loop 1 0\n", "buffer2 = version: 1\n", "strget: entry", "strget: exit",
               "setVersion: entry", "setVersion: exit", "buffer2 = license: GPL\n",
               "setDescription: entry", "setDescription: exit", "setName: entry", "setName: exit",
               "setBuildNumber: entry", "setBuildNumber: exit", "setManufacturer: entry",
               "setManufacturer: exit", "getDriverInfo: exit"}));
    EXPECT_EQ(recording.texts(6000), Lines{});
}

TEST_F(DriverInventory, LogsUnderItsOwnNameUnitAndCategory)
{
    commands.answers = {{"lsmod", "\nloop\ngone\n"}, {"modinfo loop", "version:1\n"}};
    Recording const recording;
    list();
    Lines said;
    for (LogRecord const& record : recording.records()) {
        bool const own = record.function == "getDriverInfo";
        if (own) {
            said.push_back(record.text);
            EXPECT_EQ(record.file, "driverInfo_linux");
            EXPECT_EQ(record.category, "Veltrix.IC.MI.OsSwMI.DriverInfo");
        }
    }
    Lines twice;
    for (char const* text :
         {"getDriverInfo: entry", "buffer = \n", "Invalid format: buffer1 = \n", "buffer = loop\n",
          "buffer2 = version:1\n", "Invalid format: buffer2 = version:1\n", "buffer = gone\n",
          "Cannot open process: modinfo", "getDriverInfo: exit"})
        twice.insert(twice.end(), 2, text);
    EXPECT_EQ(said, twice);
}

TEST_F(DriverInventory, ReadsALongModinfoLineAsSeveral)
{
    std::string const first = "description: " + std::string(511 - 13, 'd');
    std::string const second = "version: 7";
    commands.answers = {{"lsmod", "loop 1 0\n"}, {"modinfo loop", first + second + "\n"}};
    Recording const recording;
    driverInfo const driver = only();
    EXPECT_EQ(driver.getDescription(), std::string(498, 'd'));
    EXPECT_EQ(driver.getVersion(), "7");
    EXPECT_TRUE(recording.has("buffer2 = " + first, 3000));
    EXPECT_TRUE(recording.has("buffer2 = version: 7\n", 3000));
}

TEST_F(DriverInventory, ReadsALineOf510CharactersWhole)
{
    std::string const text(510 - 13, 'd');
    commands.answers = {{"lsmod", "loop 1 0\n"}, {"modinfo loop", "description: " + text + "\n"}};
    EXPECT_EQ(only().getDescription(), text);
    EXPECT_EQ(remarks().size(), 2U);
}

TEST_F(DriverInventory, ReadsALongLsmodLineAsSeveral)
{
    // 511 characters, of which the last are blanks; "tail" begins the second piece.
    std::string const line = "loop" + std::string(507, ' ') + "tail 1 0\n";
    commands.answers = {{"lsmod", line}, {"modinfo loop", ""}, {"modinfo tail", ""}};
    EXPECT_EQ(names(), (Lines{"loop", "tail"}));
}

TEST_F(DriverInventory, RunsTheLongestCommandThatFitsItsBuffer)
{
    std::string const module(503, 'm');
    commands.answers = {{"lsmod", module + " 1\n"}, {"modinfo " + module, ""}};
    EXPECT_EQ(names(), Lines{module});
}

TEST_F(DriverInventory, RunsNoCommandThatExceedsItsBuffer)
{
    std::string const module(504, 'm');
    commands.answers = {{"lsmod", module + " 1\nloop\n"}, {"modinfo loop", ""}};
    Recording const recording;
    EXPECT_EQ(names(), Lines{"loop"});
    EXPECT_EQ(commands.ran, (Lines{"lsmod", "modinfo loop"}));
    EXPECT_EQ(recording.texts(6000), Lines{"Command too long: modinfo " + module});
}

TEST_F(DriverInventory, ReadsALastLineWithoutALineEnd)
{
    commands.answers = {{"lsmod", "loop 1 0"}, {"modinfo loop", "version: 1"}};
    EXPECT_EQ(only().getVersion(), "1");
}

TEST_F(DriverInventory, EndsALineAtANulByte)
{
    commands.answers = {{"lsmod", std::string("\0loop\nlo\0op 1\n", 14)},
                        {"modinfo lo", std::string("version: 1\0 2\ndescription:\0 x\n", 30)}};
    Recording const recording;
    driverInfo const driver = only();
    EXPECT_EQ(driver.getName(), "lo");
    EXPECT_EQ(driver.getVersion(), "1");
    EXPECT_EQ(driver.getDescription(), "Driver");
    EXPECT_EQ(recording.texts(6000),
              (Lines{"Invalid format: buffer1 = ", "Invalid format: buffer2 = description:"}));
}

TEST_F(DriverInventory, SurvivesBinaryGarbage)
{
    std::string garbage;
    for (unsigned int i = 0; i < 5000; ++i)
        garbage.push_back(static_cast<char>((i * 7919U) >> 3));
    commands.answers = {{"lsmod", garbage + "\nloop 1 0\n"}, {"modinfo loop", garbage}};
    Lines const found = names();
    ASSERT_FALSE(found.empty());
    EXPECT_EQ(found.back(), "loop");
    EXPECT_EQ(commands.open, 0);
}

TEST_F(DriverInventory, ListsFourHundredModules)
{
    std::string lsmod = header;
    Lines expected;
    for (int i = 0; i < 400; ++i) {
        expected.push_back("module" + std::to_string(i));
        lsmod += expected.back() + " 16384 0\n";
        commands.answers["modinfo " + expected.back()] = "version: " + std::to_string(i) + "\n";
    }
    commands.answers["lsmod"] = lsmod;
    std::vector<driverInfo> const drivers = list();
    ASSERT_EQ(drivers.size(), 400U);
    for (std::size_t i = 0; i < drivers.size(); ++i) {
        EXPECT_EQ(drivers[i].getName(), expected[i]);
        EXPECT_EQ(drivers[i].getVersion(), std::to_string(i));
    }
    EXPECT_EQ(commands.ran.size(), 401U);
}

TEST_F(DriverInventory, CompletesARecordStepByStep)
{
    commands.answers = {{"lsmod", "loop 1 0\n"}, {"modinfo loop", ""}};
    Recording const recording;
    list();
    Lines expected{"getDriverInfo: entry", "buffer = loop 1 0\n"};
    for (std::string const setter :
         {"setVersion", "setDescription", "setName", "setBuildNumber", "setManufacturer"}) {
        expected.push_back(setter + ": entry");
        expected.push_back(setter + ": exit");
    }
    expected.emplace_back("getDriverInfo: exit");
    EXPECT_EQ(recording.texts(), expected);
}

TEST_F(DriverInventory, IgnoresTheExitStatusOfItsCommands)
{
    commands.answers = {{"lsmod", "loop 1 0\n"},
                        {"modinfo loop", "version: 1\ndescription: Disk\n"}};
    libc::hooks().pclose = [close = libc::hooks().pclose.answer()](FILE* stream) {
        close(stream);
        return 1 << 8;
    };
    driverInfo const driver = only();
    EXPECT_EQ(driver.getVersion(), "1");
    EXPECT_EQ(driver.getDescription(), "Disk");
}

} // namespace driver_inventory_test
