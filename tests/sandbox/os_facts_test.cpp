// The operating-system node on each kind of machine.

#include "host/Properties.h"
#include "tests/support/Machine.h"
#include "tests/support/Plugin.h"

#include <gtest/gtest.h>
#include <sys/stat.h>
#include <sys/utsname.h>

namespace os_facts_test
{

struct KnownMachine {
    char const* name;
    char const* osName;
    std::string version;
    unsigned int users;
    char const* datedFile; // whose last status change is the install date; null for none
};

std::string kernelRelease()
{
    utsname system{};
    uname(&system);
    return system.release;
}

void PrintTo(KnownMachine const& machine, std::ostream* out)
{
    *out << machine.name;
}

class OsFacts : public testing::TestWithParam<KnownMachine>
{
};

TEST_P(OsFacts, ComeFromTheFilesOfTheMachine)
{
    machine::lay(GetParam().name);
    Plugin plugin;
    plugin.initialize();
    IC::MutableNode const& os = plugin.node(IC::nodeType::operatingSystem);
    EXPECT_EQ(text(os, IC::property::name), GetParam().osName);
    EXPECT_EQ(text(os, IC::property::version), GetParam().version);
    EXPECT_EQ(text(os, IC::property::userCount), std::to_string(GetParam().users));
    struct stat status {
    };
    if (GetParam().datedFile) {
        ASSERT_EQ(stat(GetParam().datedFile, &status), 0);
    }
    auto const installDate = property(os, IC::property::installDate);
    ASSERT_TRUE(installDate);
    EXPECT_EQ(installDate->getKind(), IC::PropertyValue::DateKind);
    EXPECT_EQ(installDate->getNumber(), status.st_ctime);
}

INSTANTIATE_TEST_SUITE_P(
    Machines, OsFacts,
    testing::Values(KnownMachine{"redhat", "Example Linux Server release 5.4 (Harbour)", "5.4", 4,
                                 "/etc/redhat-release"},
                    KnownMachine{"suse", "Example Linux Enterprise Server 10 (i586)", "10.3", 4,
                                 "/etc/SuSE-release"},
                    KnownMachine{"unitedlinux", "Example United 1.0 (i586)", kernelRelease(), 2,
                                 "/etc/UnitedLinux-release"},
                    KnownMachine{"keyvalue", "Example Appliance", "10.2", 3, nullptr},
                    KnownMachine{"plain", "Linux", "(status 1)", 2, nullptr}),
    [](auto const& machine) { return std::string(machine.param.name); });

} // namespace os_facts_test
