// Kernel modules as the real lsmod and modinfo describe them.

#include "TestPaths.h"
#include "host/Properties.h"
#include "tests/support/Lines.h"
#include "tests/support/Machine.h"
#include "tests/support/Plugin.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <ostream>
#include <sys/mount.h>
#include <sys/utsname.h>

namespace drivers_test
{

/** What a driver node shows. */
struct Driver {
    std::string name;
    std::string version;
    std::string description;
};

bool operator==(Driver const& one, Driver const& other)
{
    return one.name == other.name && one.version == other.version &&
           one.description == other.description;
}

std::ostream& operator<<(std::ostream& out, Driver const& driver)
{
    return out << '{' << driver.name << ", " << driver.version << ", " << driver.description << '}';
}

class Drivers : public testing::Test
{
protected:
    std::vector<Driver> shown()
    {
        plugin.initialize();
        std::vector<Driver> drivers;
        for (IC::MutableNode const* node : plugin.nodes(IC::nodeType::driver))
            drivers.push_back({text(*node, IC::property::name), text(*node, IC::property::version),
                               node->getDescription()});
        return drivers;
    }

    Plugin plugin;
};

TEST_F(Drivers, AreShownForModulesOfEveryOddForm)
{
    machine::lay("odd-modules");
    EXPECT_EQ(shown(),
              (std::vector<Driver>{{"e1000", "7.3.21-k8-NAPI", "Intel(R) PRO/1000 Network Driver"},
                                   {"ext4", "", "Fourth Extended Filesystem"},
                                   {"nodesc", "0.1", "Driver"},
                                   {"twice", "2.0", "second description"},
                                   {"blank", "", ""},
                                   {"tight", "", "Driver"},
                                   {"ghost", "", "Driver"},
                                   {"wide", "3", std::string(495, 'd')}}));
}

TEST_F(Drivers, AreFourHundredForAsManyModules)
{
    machine::fake("/usr/sbin/lsmod", "echo Module Size Used by\nseq -f 'module%g 4096 0' 400\n");
    machine::fake("/usr/sbin/modinfo", "echo \"version: of $1\"\n");
    std::vector<Driver> const drivers = shown();
    ASSERT_EQ(drivers.size(), 400U);
    EXPECT_EQ(drivers.front(), (Driver{"module1", "of module1", "Driver"}));
    EXPECT_EQ(drivers.back(), (Driver{"module400", "of module400", "Driver"}));
    EXPECT_EQ(plugin.nodes(IC::nodeType::driver).back()->getIndex(), 400U);
}

TEST_F(Drivers, AreThoseOfTheKernel)
{
    Lines const modules = linesOf(contentOf("/proc/modules"));
    std::vector<Driver> const drivers = shown();
    ASSERT_EQ(drivers.size(), modules.size());
    for (std::size_t at = 0; at < modules.size(); ++at)
        EXPECT_EQ(drivers[at].name, modules[at].substr(0, modules[at].find(' ')));
}

TEST_F(Drivers, AreDescribedByTheModulesThemselves)
{
    utsname system{};
    ASSERT_EQ(uname(&system), 0);
    std::string const folder = std::string("/lib/modules/") + system.release + "/extra";
    std::filesystem::create_directories(folder);
    std::filesystem::copy_file(MODULE_FILE, folder + "/mi_disk.ko");
    machine::run("depmod -a 2>/dev/null");
    // An invented list of modules, which lsmod reads.
    ASSERT_EQ(mount("none", "/proc", "tmpfs", 0, nullptr), 0);
    machine::write("/proc/modules", "mi_disk 16384 1 - Live 0x0000000000000000\n"
                                    "mi_ghost 4096 0 - Live 0x0000000000000000\n");
    EXPECT_EQ(shown(), (std::vector<Driver>{{"mi_disk", "1.4.2", "A disk of memory"},
                                            {"mi_ghost", "", "Driver"}}));
    umount2("/proc", MNT_DETACH); // sanitizers read the real one at the end
}

TEST_F(Drivers, AreNoneOnAMachineWithoutLsmod)
{
    machine::remove("/usr/sbin/lsmod");
    Recording const recording;
    EXPECT_TRUE(shown().empty());
    // The shell starts and does not find lsmod, which looks like no modules.
    EXPECT_FALSE(recording.has("Cannot open process: lsmod", 3000));
}

TEST_F(Drivers, HaveOnlyNamesOnAMachineWithoutModinfo)
{
    machine::lay("odd-modules");
    machine::remove("/usr/sbin/modinfo");
    std::vector<Driver> const drivers = shown();
    ASSERT_EQ(drivers.size(), 8U);
    for (Driver const& driver : drivers)
        EXPECT_EQ(driver, (Driver{driver.name, "", "Driver"}));
}

TEST_F(Drivers, SurviveGarbageFromEveryCommand)
{
    machine::fake("/usr/sbin/lsmod", "head -c 3000 /dev/zero; echo; echo loop 1\n"
                                     "printf '\\377\\001\\n   \\n'; head -c 2000 /dev/zero\n");
    machine::fake("/usr/sbin/modinfo", "printf 'version: 1\\000\\n'; head -c 4000 /dev/zero\n"
                                       "printf 'description:'\n");
    std::vector<Driver> const drivers = shown();
    ASSERT_EQ(drivers.size(), 2U);
    EXPECT_EQ(drivers[0], (Driver{"loop", "1", "Driver"}));
    EXPECT_EQ(drivers[1].name, "\377\001");
}

} // namespace drivers_test
