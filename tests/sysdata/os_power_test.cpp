#include "sysdata/osInfo_linux.h"

#include "tests/interpose/Libc.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <ostream>
#include <string>
#include <unistd.h>
#include <vector>

namespace os_power_test
{

using NQ::OsInfo;

struct PowerCase {
    bool (OsInfo::*act)();
    char const* function;
    char const* announcement;
    char const* command;
};

[[maybe_unused]] void PrintTo(PowerCase const& test, std::ostream* out)
{
    *out << test.function;
}

class OsInfoPower : public testing::TestWithParam<PowerCase>
{
protected:
    FakeCommands commands_; // no command reaches the machine
};

INSTANTIATE_TEST_SUITE_P(Of, OsInfoPower,
                         testing::Values(PowerCase{&OsInfo::statusOffline, "statusOffline",
                                                   "Halt after shutdown.", "/sbin/shutdown -h now"},
                                         PowerCase{&OsInfo::statusReset, "statusReset",
                                                   "Reboot after shutdown.",
                                                   "/sbin/shutdown -r now"}),
                         [](auto const& test) { return std::string(test.param.function); });

TEST_P(OsInfoPower, AnnouncesItselfAtLevel4000AndThenRunsTheCommand)
{
    Recording const log;
    std::vector<std::string> saidBefore;
    libc::hooks().popen = [&](char const* command, char const* mode) -> FILE* {
        commands_.ran.push_back(std::string(command) + "|" + mode);
        saidBefore = log.texts(4000);
        return nullptr;
    };
    EXPECT_TRUE((OsInfo().*GetParam().act)());
    EXPECT_EQ(commands_.ran, std::vector<std::string>{std::string(GetParam().command) + "|r"});
    EXPECT_EQ(saidBefore, std::vector<std::string>{GetParam().announcement});
    EXPECT_EQ(log.remarks(), std::vector<std::string>{GetParam().announcement});
    for (LogRecord const& record : log.records())
        EXPECT_EQ(record.function, GetParam().function);
}

TEST_P(OsInfoPower, ClosesThePipeAndReadsNeitherOutputNorStatus)
{
    commands_.answers[GetParam().command] = "shutdown: Permission denied\n";
    EXPECT_TRUE((OsInfo().*GetParam().act)());
    EXPECT_EQ(commands_.ran, std::vector<std::string>{GetParam().command});
    EXPECT_EQ(commands_.open, 0);
}

TEST_P(OsInfoPower, ReadsNothingFromTheCommandsPipe)
{
    FILE* const output = std::tmpfile();
    std::fputs("shutdown: Permission denied\n", output);
    std::rewind(output);
    libc::hooks().popen = [&](char const*, char const*) { return output; };
    long read = -1;
    libc::hooks().pclose = [&read](FILE* stream) {
        read = lseek(fileno(stream), 0, SEEK_CUR);
        return std::fclose(stream);
    };
    EXPECT_TRUE((OsInfo().*GetParam().act)());
    EXPECT_EQ(read, 0);
}

} // namespace os_power_test
