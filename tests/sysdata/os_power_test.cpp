#include "sysdata/osInfo_linux.h"

#include "tests/interpose/Libc.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <string>

namespace os_power_test
{

using NQ::OsInfo;

struct {
    bool (OsInfo::*act)();
    std::string function;
    std::string announcement;
    std::string command;
} const actions[] = {
    {&OsInfo::statusOffline, "statusOffline", "Halt after shutdown.", "/sbin/shutdown -h now"},
    {&OsInfo::statusReset, "statusReset", "Reboot after shutdown.", "/sbin/shutdown -r now"}};

TEST(OsInfoPower, AnnouncesItselfAtLevel4000AndThenRunsTheCommand)
{
    for (auto const& [act, function, announcement, command] : actions) {
        FakeCommands const commands; // none reaches the machine
        Recording const log;
        Lines saidBefore;
        libc::hooks().popen.watch([&](char const*, char const*) { saidBefore = log.texts(4000); });
        EXPECT_TRUE((OsInfo().*act)());
        EXPECT_EQ(commands.ran, Lines{command});
        EXPECT_EQ(commands.modes, Lines{"r"});
        EXPECT_EQ(saidBefore, Lines{announcement});
        EXPECT_EQ(log.remarks(), Lines{announcement});
        EXPECT_EQ(log.sources(), Lines{function + " OsSwMI Veltrix.IC.MI.OsSwMI.OsInfo"});
    }
}

TEST(OsInfoPower, ClosesThePipeAndReadsNothingFromIt)
{
    for (auto const& action : actions) {
        FakeCommands commands;
        commands.answers[action.command] = "shutdown: Permission denied\n";
        long read = -1;
        libc::hooks().pclose.watch([&read](FILE* stream) { read = std::ftell(stream); });
        EXPECT_TRUE((OsInfo().*action.act)());
        EXPECT_EQ(commands.ran, Lines{action.command});
        EXPECT_EQ(commands.open, 0);
        EXPECT_EQ(read, 0);
    }
}

} // namespace os_power_test
