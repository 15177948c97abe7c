// script/bootstrap on machines of other families than Debian's.

#include "TestPaths.h"
#include "tests/support/Machine.h"

#include <filesystem>
#include <gtest/gtest.h>

namespace bootstrap_test
{

std::string const scripts = TESTS_DIR "/../script/";

constexpr char fedora[] = "ID=fedora\nVERSION_ID=43\n";
constexpr char opensuse[] = "ID=\"opensuse-leap\"\nID_LIKE=\"suse opensuse\"\n";

/** A machine of a family with RPM packages, which has all but these. */
void makeMachine(std::string const& release, std::string const& lacking)
{
    machine::write("/etc/os-release", release);
    machine::fake("/usr/bin/rpm", "case $4 in " + lacking + ") exit 1 ;; esac\n");
    for (char const* tool : {"/usr/bin/apt-get", "/usr/bin/dpkg-query"})
        machine::fake(tool, "echo $0 >>/run/debian-tools\n");
}

Outcome run(std::string const& script, std::string const& argument = "build")
{
    return runToEnd({"/bin/bash", scripts + script, argument});
}

TEST(Bootstrap, NamesThePackagesThatAreMissing)
{
    struct Row {
        std::string release;
        char const* lacking;
        char const* argument;
        std::string command;
    };
    for (Row const& row : {
             Row{fedora, "cmake | gcc-c++ | json-devel", "build",
                 "dnf install gcc-c++ cmake json-devel"},
             Row{opensuse, "ninja | nlohmann_json-devel | shadow", "test",
                 "zypper install ninja nlohmann_json-devel shadow"},
             Row{"ID=\"rocky\"\nID_LIKE=\"rhel centos fedora\"\n", "fmt-devel", "build",
                 "dnf install fmt-devel"},
             // Where Debian has two packages and three:
             Row{fedora, "clang-tools-extra", "check", "dnf install clang-tools-extra"},
             Row{opensuse, "clang", "check", "zypper install clang"},
         }) {
        makeMachine(row.release, row.lacking);
        Outcome const outcome = run("bootstrap", row.argument);
        EXPECT_EQ(outcome.code, 1) << row.command;
        EXPECT_EQ(outcome.err,
                  "bootstrap: packages are missing (as root, run '" + row.command + "')\n");
    }
}

TEST(Bootstrap, SucceedsIfNoPackageIsMissing)
{
    for (char const* release : {fedora, opensuse}) {
        makeMachine(release, "none");
        for (char const* what : {"build", "test", "integration", "check"}) {
            Outcome const outcome = run("bootstrap", what);
            EXPECT_EQ(outcome.code, 0) << what;
            EXPECT_EQ(outcome.out + outcome.err, "") << what;
        }
    }
    EXPECT_FALSE(std::filesystem::exists("/run/debian-tools"));
}

TEST(Bootstrap, ContinuesIfItKnowsNoPackageNames)
{
    makeMachine("ID=arch\n", "*");
    Outcome const outcome = run("bootstrap");
    EXPECT_EQ(outcome.code, 0);
    EXPECT_EQ(outcome.err.rfind("bootstrap: the package names of 'arch' are not known; ", 0), 0U)
        << outcome.err;
    EXPECT_FALSE(std::filesystem::exists("/run/debian-tools"));
}

TEST(Bootstrap, StopsRunAndTestBeforeTheyBuild)
{
    makeMachine(fedora, "cmake");
    machine::fake("/usr/bin/cmake", "echo built >>/run/built\n");
    for (char const* script : {"run", "test"}) {
        Outcome const outcome = run(script, script == std::string("run") ? "tree" : "dev");
        EXPECT_EQ(outcome.code, 1) << script;
        EXPECT_EQ(outcome.out, "") << script;
        EXPECT_EQ(outcome.err,
                  "bootstrap: packages are missing (as root, run 'dnf install cmake')\n");
    }
    EXPECT_FALSE(std::filesystem::exists("/run/built"));
}

} // namespace bootstrap_test
