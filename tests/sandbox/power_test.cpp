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

class Power : public testing::Test
{
protected:
    Power()
    {
        machine::recordShell();
    }

    void expectRan(std::string const& command)
    {
        EXPECT_EQ(machine::ran(), Lines{command});
        EXPECT_EQ(mihost::refusedPowerCommands(), Lines{command});
    }

    /** Calls a member function of NQ::OsInfo without arguments; the object has no members. */
    bool call(char const* function)
    {
        auto* const member = reinterpret_cast<bool (*)(void*)>(plugin.symbol(function));
        char info = 0;
        return member(&info);
    }

    Recording recording;
    Plugin plugin;
};

TEST_F(Power, StatusOfflineHaltsTheMachine)
{
    EXPECT_TRUE(call("NQ::OsInfo::statusOffline()"));
    expectRan("/sbin/shutdown -h now");
    EXPECT_EQ(recording.texts(4000), Lines{"Halt after shutdown."});
}

TEST_F(Power, StatusResetRestartsTheMachine)
{
    EXPECT_TRUE(call("NQ::OsInfo::statusReset()"));
    expectRan("/sbin/shutdown -r now");
    EXPECT_EQ(recording.texts(4000), Lines{"Reboot after shutdown."});
}

/** The operating-system node of a plain machine, nothing recorded yet. */
class PowerRequest : public Power
{
protected:
    PowerRequest()
    {
        machine::lay("plain");
        plugin.initialize();
        machine::forget();
        recording.clear();
    }

    IC::MutableNode& os()
    {
        return plugin.node(IC::nodeType::operatingSystem);
    }

    unsigned char request(IC::PropertyValue const& value)
    {
        return os().setProperty(IC::property::requestedState, value).getStatus();
    }
};

TEST_F(PowerRequest, OfTwelveHaltsTheMachineAndIsStored)
{
    EXPECT_EQ(request({IC::EnumValue(12U), true}), 0);
    expectRan("/sbin/shutdown -h now");
    EXPECT_EQ(text(os(), IC::property::requestedState), "12");
    EXPECT_EQ(recording.texts(4000), Lines{"Halt after shutdown."});
}

TEST_F(PowerRequest, OfNineRestartsTheMachineAndIsStored)
{
    EXPECT_EQ(request({IC::EnumValue(9U), true}), 0);
    expectRan("/sbin/shutdown -r now");
    EXPECT_EQ(text(os(), IC::property::requestedState), "9");
    EXPECT_EQ(recording.texts(4000), Lines{"Reboot after shutdown."});
}

TEST_F(PowerRequest, MayBeANumberOrAText)
{
    EXPECT_EQ(request({IC::Number(12U), true}), 0);
    EXPECT_EQ(request({"9", true}), 0);
    EXPECT_EQ(machine::ran(), (Lines{"/sbin/shutdown -h now", "/sbin/shutdown -r now"}));
}

TEST_F(PowerRequest, OfAnyOtherNumberIsOnlyStored)
{
    for (unsigned int const number : {0U, 1U, 5U, 8U, 10U, 11U, 13U, 4294967295U}) {
        EXPECT_EQ(request({IC::EnumValue(number), true}), 0);
        EXPECT_EQ(text(os(), IC::property::requestedState), std::to_string(number));
    }
    EXPECT_EQ(machine::ran(), Lines());
    EXPECT_EQ(mihost::refusedPowerCommands(), Lines());
    EXPECT_EQ(recording.texts(4000), Lines());
}

TEST_F(PowerRequest, IsStoredEvenIfThereIsNoShutdownCommand)
{
    machine::remove("/sbin/shutdown");
    EXPECT_EQ(request({IC::EnumValue(12U), true}), 0);
    EXPECT_EQ(machine::ran(), Lines{"/sbin/shutdown -h now"});
    EXPECT_EQ(text(os(), IC::property::requestedState), "12");
}

} // namespace power_test
