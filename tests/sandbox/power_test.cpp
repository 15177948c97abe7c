// Halting and restarting, with a command that only records it.

#include "host/Properties.h"
#include "mihost/sandbox/Sandbox.h"
#include "tests/support/Lines.h"
#include "tests/support/Machine.h"
#include "tests/support/Plugin.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

namespace power_test
{

struct Request {
    char const* name;
    IC::PropertyValue value;
    char const* command;
    char const* announcement;
};

class Power : public testing::TestWithParam<Request>
{
};

TEST_P(Power, RequestRunsTheCommandAndIsStored)
{
    machine::lay("plain");
    Plugin plugin;
    plugin.initialize();
    machine::recordShell();
    Recording const recording;
    IC::MutableNode& os = plugin.node(IC::nodeType::operatingSystem);
    EXPECT_EQ(os.setProperty(IC::property::requestedState, GetParam().value).getStatus(), 0);
    EXPECT_EQ(machine::ran(), Lines{GetParam().command});
    EXPECT_EQ(mihost::refusedPowerCommands(), Lines{GetParam().command});
    EXPECT_EQ(text(os, IC::property::requestedState), static_cast<std::string>(GetParam().value));
    EXPECT_EQ(recording.texts(4000), Lines{GetParam().announcement});
}

INSTANTIATE_TEST_SUITE_P(All, Power,
                         testing::Values(Request{"Restart",
                                                 {IC::EnumValue(9U), true},
                                                 "/sbin/shutdown -r now",
                                                 "Reboot after shutdown."},
                                         Request{"Halt",
                                                 {IC::Number(12U), true},
                                                 "/sbin/shutdown -h now",
                                                 "Halt after shutdown."}),
                         [](auto const& request) { return std::string(request.param.name); });

TEST(PowerWithoutShutdown, IsStoredAfterACommandThatIsMissing)
{
    machine::lay("plain");
    Plugin plugin;
    plugin.initialize();
    machine::remove("/sbin/shutdown");
    machine::recordShell();
    IC::MutableNode& os = plugin.node(IC::nodeType::operatingSystem);
    EXPECT_EQ(os.setProperty(IC::property::requestedState, {IC::EnumValue(12U), true}).getStatus(),
              0);
    EXPECT_EQ(machine::ran(), Lines{"/sbin/shutdown -h now"});
    EXPECT_EQ(text(os, IC::property::requestedState), "12");
}

} // namespace power_test
