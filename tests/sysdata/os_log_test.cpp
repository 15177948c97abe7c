#include "sysdata/osInfo_linux.h"

#include "tests/interpose/Libc.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/Lines.h"
#include "tests/support/MutexCalls.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <functional>
#include <string>
#include <type_traits>

namespace os_log_test
{

using NQ::OsInfo;

template <class Value> std::function<void()> reading(bool (OsInfo::*get)(Value&))
{
    return [get] {
        Value out{};
        (OsInfo().*get)(out);
    };
}

std::string text = " x ";

struct {
    std::string function;
    std::function<void()> call;
    std::string remark = ""; // if sysinfo fails
    int accountLocks = 0;
} const cases[] = {
    {"getDistributed", reading(&OsInfo::getDistributed)},
    {"getProcessMaxNumber", reading(&OsInfo::getProcessMaxNumber)},
    {"getProcessMaxMemory", reading(&OsInfo::getProcessMaxMemory)},
    {"getLicensedUserCount", reading(&OsInfo::getLicensedUserCount)},
    {"getVirtualMemorySize", reading(&OsInfo::getVirtualMemorySize)},
    {"getVirtualMemoryFree", reading(&OsInfo::getVirtualMemoryFree)},
    {"getOSCreateUser", reading(&OsInfo::getOSCreateUser)},
    {"getPhysicalMemorySize", reading(&OsInfo::getPhysicalMemorySize), "physicalMemorySize failed"},
    {"getPhysicalMemoryFree", reading(&OsInfo::getPhysicalMemoryFree), "physicalMemoryFree failed"},
    {"getSwapFileSize", reading(&OsInfo::getSwapFileSize)},
    {"getSwapFileFree", reading(&OsInfo::getSwapFileFree)},
    {"getSwapFileSizeStored", reading(&OsInfo::getSwapFileSizeStored)},
    {"getProcessCount", reading(&OsInfo::getProcessCount)},
    {"getLastBootTime", reading(&OsInfo::getLastBootTime)},
    {"getUserCount", reading(&OsInfo::getUserCount), "", 1},
    {"getInstallDate", reading(&OsInfo::getInstallDate)},
    {"getOSName", reading(&OsInfo::getOSName)},
    {"getOSReleaseName", [] { OsInfo().getOSReleaseName("/etc/release", text); }},
    {"getOSVersion", reading(&OsInfo::getOSVersion)},
    {"getKestoVersion", [] { OsInfo().getKestoVersion("/etc/release", text); }},
    {"getLanguageEdition", reading(&OsInfo::getLanguageEdition)},
    {"getCodeSet", reading(&OsInfo::getCodeSet)},
    {"trimString", [] { OsInfo().trimString(text); }},
    {"strreplace", [] { OsInfo().strreplace(text.data(), 'x', 'y'); }},
    {"statusOffline", [] { OsInfo().statusOffline(); }, "Halt after shutdown."},
    {"statusReset", [] { OsInfo().statusReset(); }, "Reboot after shutdown."}};

TEST(OsInfoLog, HasEntryAndExitOfEachOperationAndItsRemark)
{
    FakeFiles const noFiles;
    FakeCommands const noCommands;
    for (auto const& [function, call, remark, accountLocks] : cases) {
        SCOPED_TRACE(function);
        libc::hooks().sysinfo = [](struct sysinfo*) { return -1; };
        int mutexes = 0;
        int accounts = 0;
        MutexCalls calls;
        calls.onLock = [&mutexes](NQ::Mutex const&, unsigned long) { ++mutexes; };
        libc::hooks().lckpwdf.watch([&accounts] { ++accounts; });
        Recording const log;
        call();
        ASSERT_GE(log.texts().size(), 2U);
        EXPECT_EQ(log.texts().front(), function + ": entry");
        EXPECT_EQ(log.texts().back(), function + ": exit");
        EXPECT_EQ(log.remarks(), remark.empty() ? Lines{} : Lines{remark});
        EXPECT_EQ(log.records().front().level, 3000);
        EXPECT_EQ(log.records().back().level, 3000);
        for (LogRecord const& record : log.records()) {
            EXPECT_EQ(record.category, "Veltrix.IC.MI.OsSwMI.OsInfo");
            EXPECT_EQ(record.file, "OsSwMI");
        }
        EXPECT_EQ(log.records().front().function, function);
        EXPECT_EQ(mutexes, 0);
        EXPECT_EQ(accounts, accountLocks);
    }
}

TEST(OsInfo, HasNoMembersAndLogsNoConstruction)
{
    EXPECT_TRUE(std::is_empty_v<OsInfo>);
    EXPECT_FALSE(std::is_polymorphic_v<OsInfo>);
    Recording const log;
    {
        OsInfo const info;
    }
    EXPECT_TRUE(log.records().empty());
}

} // namespace os_log_test
