// The example host that changes the machine.

#include "TestPaths.h"
#include "tests/support/Machine.h"

#include <filesystem>
#include <gtest/gtest.h>

namespace example_hosts_test
{

Outcome call(std::string const& text)
{
    auto const programs = std::filesystem::path(MIHOST_FILE).parent_path();
    return runToEnd({programs / "example_method_call", PLUGIN_FILE, text});
}

TEST(MethodCallHost, AddsAGroupAndShowsWhyItCannotAddItAgain)
{
    machine::lay("redhat");
    Outcome const added = call("LocalGroupAdd,GroupName:CMPI_string:builders");
    EXPECT_EQ(added.code, 0) << added.err;
    EXPECT_EQ(machine::entry("/etc/group", "builders").at(0), "builders");

    Outcome const again = call("LocalGroupAdd,GroupName:CMPI_string:builders");
    EXPECT_EQ(again.code, 1);
    EXPECT_NE(again.err.find("refused with status 1\noutputBuffer: groupadd: group 'builders' "),
              std::string::npos)
        << again.err;
}

} // namespace example_hosts_test
