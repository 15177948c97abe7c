// Kernel modules as the real lsmod and modinfo describe them.

#include "TestPaths.h"
#include "host/Properties.h"
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

} // namespace drivers_test
