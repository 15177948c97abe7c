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

    Lines names()
    {
        Lines found;
        for (driverInfo const& driver : list())
            found.push_back(driver.getName());
        return found;
    }

    FakeCommands commands;
};

/** Name, version and description. */
Lines factsOf(std::vector<driverInfo> const& drivers)
{
    Lines facts;
    for (driverInfo const& driver : drivers) {
        facts.push_back(driver.getName() + "|" + driver.getVersion() + "|" +
                        driver.getDescription());
        EXPECT_EQ(driver.getBuildNumber() + driver.getManufacturer(), "");
    }
    return facts;
}

TEST_F(DriverInventory, ListsModulesInTheOrderOfLsmod)
{
    commands.answers = {{"lsmod", std::string(header) + "xfs 1 0\next4 2 1 a,b\nzram 3 0\ng 1 0\n"},
                        {"modinfo xfs", "description:    SGI XFS\nversion:        1\n"},
                        {"modinfo ext4", "version:        2\ndescription:    Fourth\n"},
                        {"modinfo zram", "license:        GPL\n"},
                        {"modinfo g", ""}}; // not known to modinfo
    EXPECT_EQ(factsOf(list()),
              (Lines{"xfs|1|SGI XFS", "ext4|2|Fourth", "zram||Driver", "g||Driver"}));
    EXPECT_EQ(commands.ran,
              (Lines{"lsmod", "modinfo xfs", "modinfo ext4", "modinfo zram", "modinfo g"}));
    EXPECT_EQ(commands.modes, Lines(5, "r"));
    EXPECT_EQ(commands.open, 0);
}

TEST_F(DriverInventory, ReadsTheFactsOfAModule)
{
    std::string const longest(510 - 13, 'd');
    struct {
        char const* what;
        std::string modinfo;
        std::string facts;
        Lines errors;
    } const cases[] = {
        {"facts without a space",
         "version: 1\nversion:2\ndescription:disk\n",
         "loop|1|Driver",
         {"Invalid format: buffer2 = version:2\n", "Invalid format: buffer2 = description:disk\n"}},
        {"facts twice", "version: 1\ndescription: a\nversion: 2\ndescription: b\n", "loop|2|b", {}},
        {"a description of blanks", "description:     \n", "loop||", {}},
        {"510 characters", "description: " + longest + "\n", "loop||" + longest, {}},
        {"a longer line, which is read as two",
         "description: " + longest + "dversion: 7\n",
         "loop|7|" + longest + "d",
         {}},
        {"no line end", "version: 1", "loop|1|Driver", {}},
        {"NUL bytes",
         std::string("version: 1\0 2\ndescription:\0 x\n", 30),
         "loop|1|Driver",
         {"Invalid format: buffer2 = description:"}},
    };
    for (auto const& [what, modinfo, facts, errors] : cases) {
        commands.answers = {{"lsmod", "loop 1 0"}, {"modinfo loop", modinfo}};
        Recording const recording;
        EXPECT_EQ(factsOf(list()), Lines{facts}) << what;
        EXPECT_EQ(recording.texts(6000), errors) << what;
    }
}

TEST_F(DriverInventory, ReadsTheModulesOfLsmod)
{
    std::string const longest(503, 'm'); // its command fills its buffer
    struct {
        char const* what;
        std::string lsmod;
        Lines modules;
        Lines errors;
    } const cases[] = {
        {"the header only", header, {}, {}},
        {"nothing", "", {}, {}},
        {"blank lines",
         "\n \t\nloop 1 0\n",
         {"loop"},
         {"Invalid format: buffer1 = \n", "Invalid format: buffer1 =  \t\n"}},
        {"a module named like the header", "Module_mine 1 0\nloop 1 0\n", {"loop"}, {}},
        {"a line of two pieces",
         "loop" + std::string(507, ' ') + "tail 1 0\n",
         {"loop", "tail"},
         {}},
        {"a command that fits", longest + " 1\n", {longest}, {}},
        {"one that does not",
         longest + "m 1\nloop\n",
         {"loop"},
         {"Command too long: modinfo " + longest + "m"}},
        {"NUL bytes",
         std::string("\0loop\nlo\0op 1\n", 14),
         {"lo"},
         {"Invalid format: buffer1 = "}},
    };
    commands.otherwise = "";
    for (auto const& [what, lsmod, modules, errors] : cases) {
        commands.answers = {{"lsmod", lsmod}};
        commands.ran.clear();
        Recording const recording;
        EXPECT_EQ(names(), modules) << what;
        EXPECT_EQ(recording.texts(6000), errors) << what;
        EXPECT_EQ(commands.ran.size(), 1 + modules.size()) << what;
    }
}

TEST_F(DriverInventory, KeepsLsmodOpenWhileEachModinfoRuns)
{
    commands.answers = {{"lsmod", "a\nb\n"}, {"modinfo a", ""}, {"modinfo b", ""}};
    std::vector<int> openBefore;
    libc::hooks().popen = [&, fake = libc::hooks().popen.answer()](char const* command,
                                                                   char const* mode) {
        openBefore.push_back(commands.open);
        return fake(command, mode);
    };
    list();
    EXPECT_EQ(openBefore, (std::vector<int>{0, 1, 1}));
}

TEST_F(DriverInventory, ReplacesWhatTheVectorHeld)
{
    Recording const recording;
    std::vector<driverInfo> drivers(3);
    NQ::getDriverInfo(drivers); // lsmod cannot be started
    EXPECT_TRUE(drivers.empty());
    EXPECT_EQ(recording.texts(3000),
              (Lines{"getDriverInfo: entry", "Cannot open process: lsmod", "getDriverInfo: exit"}));
    EXPECT_EQ(recording.texts(6000), Lines{});
    EXPECT_EQ(commands.ran, Lines{"lsmod"});
    commands.answers = {{"lsmod", "loop 1 0\n"}, {"modinfo loop", ""}};
    drivers.resize(3);
    std::vector<std::size_t> atStart;
    libc::hooks().popen.watch([&](char const*, char const*) { atStart.push_back(drivers.size()); });
    NQ::getDriverInfo(drivers);
    EXPECT_EQ(atStart, std::vector<std::size_t>(2, 0)); // emptied first
    EXPECT_EQ(factsOf(drivers), Lines{"loop||Driver"});
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

TEST_F(DriverInventory, LogsEveryStepInOrder)
{
    commands.answers = {{"lsmod", std::string(header) + "loop 1 0\n"},
                        {"modinfo loop", "version: 1\nlicense: GPL\n"}};
    Recording const recording;
    Lines closedAfter;
    libc::hooks().pclose.watch([&](FILE*) { closedAfter.push_back(recording.texts().back()); });
    list();
    EXPECT_EQ(closedAfter, Lines(2, "setManufacturer: exit")); // before the exit
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
    for (LogRecord const& record : recording.records())
        if (record.function == "getDriverInfo") {
            said.push_back(record.text);
            EXPECT_EQ(record.file, "driverInfo_linux");
            EXPECT_EQ(record.category, "Veltrix.IC.MI.OsSwMI.DriverInfo");
        }
    Lines twice;
    for (char const* text :
         {"getDriverInfo: entry", "buffer = \n", "Invalid format: buffer1 = \n", "buffer = loop\n",
          "buffer2 = version:1\n", "Invalid format: buffer2 = version:1\n", "buffer = gone\n",
          "Cannot open process: modinfo", "getDriverInfo: exit"})
        twice.insert(twice.end(), 2, text);
    EXPECT_EQ(said, twice);
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
        std::string const module = "module" + std::to_string(i);
        lsmod += module + " 16384 0\n";
        commands.answers["modinfo " + module] = "version: " + std::to_string(i) + "\n";
        expected.push_back(module + "|" + std::to_string(i) + "|Driver");
    }
    commands.answers["lsmod"] = lsmod;
    EXPECT_EQ(factsOf(list()), expected);
    EXPECT_EQ(commands.ran.size(), 401U);
}

TEST_F(DriverInventory, IgnoresTheExitStatusOfItsCommands)
{
    commands.answers = {{"lsmod", "loop 1 0\n"},
                        {"modinfo loop", "version: 1\ndescription: Disk\n"}};
    commands.status = 1 << 8;
    EXPECT_EQ(factsOf(list()), Lines{"loop|1|Disk"});
}

} // namespace driver_inventory_test
