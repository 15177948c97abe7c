// The operating-system node on each kind of machine.

#include "host/Properties.h"
#include "tests/support/Machine.h"
#include "tests/support/Plugin.h"

#include <gtest/gtest.h>
#include <optional>
#include <sys/stat.h>
#include <sys/utsname.h>

namespace os_facts_test
{

struct KnownMachine {
    char const* name;
    char const* osName;
    std::optional<std::string> version;
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
protected:
    OsFacts()
    {
        machine::lay(GetParam().name);
        plugin_.initialize();
    }

    IC::MutableNode& os() const
    {
        return plugin_.node(IC::nodeType::operatingSystem);
    }

    std::optional<IC::PropertyValue> fact(unsigned int id) const
    {
        return property(os(), id);
    }

private:
    Plugin plugin_;
};

TEST_P(OsFacts, NameIsTheFirstLineOfTheReleaseFile)
{
    EXPECT_EQ(text(os(), IC::property::name), GetParam().osName);
}

TEST_P(OsFacts, VersionComesFromTheReleaseFile)
{
    auto const version = fact(IC::property::version);
    ASSERT_EQ(version.has_value(), GetParam().version.has_value());
    if (version) {
        EXPECT_EQ(static_cast<std::string>(*version), *GetParam().version);
    }
}

TEST_P(OsFacts, UserCountIncludesOrdinaryAccountsAndSuperusers)
{
    ASSERT_TRUE(fact(IC::property::userCount));
    EXPECT_EQ(fact(IC::property::userCount)->getNumber(), GetParam().users);
}

TEST_P(OsFacts, InstallDateIsTheReleaseFilesLastChange)
{
    long long expected = 0;
    if (GetParam().datedFile) {
        struct stat status {
        };
        ASSERT_EQ(stat(GetParam().datedFile, &status), 0);
        expected = status.st_ctime;
    }
    ASSERT_TRUE(fact(IC::property::installDate));
    EXPECT_EQ(fact(IC::property::installDate)->getKind(), IC::PropertyValue::DateKind);
    EXPECT_EQ(fact(IC::property::installDate)->getNumber(), expected);
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
                    KnownMachine{"plain", "Linux", std::nullopt, 2, nullptr}),
    [](auto const& machine) { return std::string(machine.param.name); });

} // namespace os_facts_test
