// Halting and restarting, against a command that only notes it.

#include "mihost/sandbox/Sandbox.h"
#include "tests/support/Machine.h"
#include "tests/support/Plugin.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

namespace
{

using Lines = std::vector<std::string>;

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

    /** A member function of NQ::OsInfo that takes nothing; the object itself holds nothing. */
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
    EXPECT_TRUE(call("_ZN2NQ6OsInfo13statusOfflineEv"));
    expectRan("/sbin/shutdown -h now");
    EXPECT_EQ(recording.texts(4000), Lines{"Halt after shutdown."});
}

TEST_F(Power, StatusResetRestartsTheMachine)
{
    EXPECT_TRUE(call("_ZN2NQ6OsInfo11statusResetEv"));
    expectRan("/sbin/shutdown -r now");
    EXPECT_EQ(recording.texts(4000), Lines{"Reboot after shutdown."});
}

} // namespace
