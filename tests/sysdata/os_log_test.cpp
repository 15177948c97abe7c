#include "sysdata/osInfo_linux.h"

#include "tests/interpose/Libc.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/MutexCalls.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <functional>
#include <map>
#include <ostream>
#include <string>
#include <type_traits>
#include <vector>

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

struct LogCase {
    char const* function;
    std::function<void()> call;
};

[[maybe_unused]] void PrintTo(LogCase const& test, std::ostream* out)
{
    *out << test.function;
}

class OsInfoLog : public testing::TestWithParam<LogCase>
{
protected:
    OsInfoLog()
    {
        libc::hooks().lckpwdf = [] { return 0; };
        libc::hooks().ulckpwdf = [] { return 0; };
    }

private:
    libc::HookGuard const guard_;
    FakeFiles const noFiles_;
    FakeCommands const noCommands_;
};

std::string text = " x ";

INSTANTIATE_TEST_SUITE_P(
    Of, OsInfoLog,
    testing::Values(LogCase{"getDistributed", reading(&OsInfo::getDistributed)},
                    LogCase{"getProcessMaxNumber", reading(&OsInfo::getProcessMaxNumber)},
                    LogCase{"getProcessMaxMemory", reading(&OsInfo::getProcessMaxMemory)},
                    LogCase{"getLicensedUserCount", reading(&OsInfo::getLicensedUserCount)},
                    LogCase{"getVirtualMemorySize", reading(&OsInfo::getVirtualMemorySize)},
                    LogCase{"getVirtualMemoryFree", reading(&OsInfo::getVirtualMemoryFree)},
                    LogCase{"getOSCreateUser", reading(&OsInfo::getOSCreateUser)},
                    LogCase{"getPhysicalMemorySize", reading(&OsInfo::getPhysicalMemorySize)},
                    LogCase{"getPhysicalMemoryFree", reading(&OsInfo::getPhysicalMemoryFree)},
                    LogCase{"getSwapFileSize", reading(&OsInfo::getSwapFileSize)},
                    LogCase{"getSwapFileFree", reading(&OsInfo::getSwapFileFree)},
                    LogCase{"getSwapFileSizeStored", reading(&OsInfo::getSwapFileSizeStored)},
                    LogCase{"getProcessCount", reading(&OsInfo::getProcessCount)},
                    LogCase{"getLastBootTime", reading(&OsInfo::getLastBootTime)},
                    LogCase{"getUserCount", reading(&OsInfo::getUserCount)},
                    LogCase{"getInstallDate", reading(&OsInfo::getInstallDate)},
                    LogCase{"getOSName", reading(&OsInfo::getOSName)},
                    LogCase{"getOSReleaseName",
                            [] {
                                std::string out;
                                OsInfo().getOSReleaseName("/etc/release", out);
                            }},
                    LogCase{"getOSVersion", reading(&OsInfo::getOSVersion)},
                    LogCase{"getKestoVersion",
                            [] {
                                std::string out;
                                OsInfo().getKestoVersion("/etc/release", out);
                            }},
                    LogCase{"getLanguageEdition", reading(&OsInfo::getLanguageEdition)},
                    LogCase{"getCodeSet", reading(&OsInfo::getCodeSet)},
                    LogCase{"trimString", [] { OsInfo().trimString(text); }},
                    LogCase{"strreplace", [] { OsInfo().strreplace(text.data(), 'x', 'y'); }},
                    LogCase{"statusOffline", [] { OsInfo().statusOffline(); }},
                    LogCase{"statusReset", [] { OsInfo().statusReset(); }}),
    [](auto const& test) { return std::string(test.param.function); });

TEST_P(OsInfoLog, BeginsWithAnEntryAndEndsWithAnExitLine)
{
    Recording const log;
    GetParam().call();
    std::vector<std::string> const texts = log.texts();
    std::string const function = GetParam().function;
    ASSERT_GE(texts.size(), 2U);
    EXPECT_EQ(texts.front(), function + ": entry");
    EXPECT_EQ(texts.back(), function + ": exit");
    EXPECT_TRUE(log.has(function + ": entry", 3000));
    EXPECT_TRUE(log.has(function + ": exit", 3000));
}

TEST_P(OsInfoLog, GoesOnceToEachOfTheTwoLogsInTheFactsCategory)
{
    Recording const log;
    GetParam().call();
    std::vector<LogRecord> const records = log.records();
    ASSERT_EQ(records.size() % 2, 0U);
    for (std::size_t i = 0; i < records.size(); ++i) {
        LogRecord const& record = records[i];
        EXPECT_EQ(record.trace, i % 2 == 1);
        EXPECT_EQ(record.category, "Veltrix.IC.MI.OsSwMI.OsInfo");
        EXPECT_EQ(record.file, "OsSwMI");
        EXPECT_TRUE(record.extraIsNull);
        EXPECT_EQ(record.first, 0);
        EXPECT_EQ(record.second, 0);
        LogRecord const& level = records[i - i % 2];
        EXPECT_EQ(record.text, level.text);
        EXPECT_EQ(record.function, level.function);
        EXPECT_EQ(record.line, level.line);
        EXPECT_EQ(record.level, level.level);
    }
    EXPECT_EQ(records.front().function, GetParam().function);
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

TEST_P(OsInfoLog, HasNoFailuresExceptThoseOfMemory)
{
    libc::hooks().sysinfo = [](struct sysinfo*) { return -1; };
    std::map<std::string, std::string> const remarks = {
        {"getPhysicalMemorySize", "physicalMemorySize failed"},
        {"getPhysicalMemoryFree", "physicalMemoryFree failed"},
        {"statusOffline", "Halt after shutdown."},
        {"statusReset", "Reboot after shutdown."}};
    std::vector<std::string> expected;
    if (auto const found = remarks.find(GetParam().function); found != remarks.end())
        expected.push_back(found->second);
    Recording const log;
    GetParam().call();
    EXPECT_EQ(log.remarks(), expected);
}

TEST_P(OsInfoLog, TakesNoLockExceptForTheUserCount)
{
    int mutexes = 0;
    int accounts = 0;
    MutexCalls calls;
    calls.onLock = [&mutexes](NQ::Mutex const&, unsigned long) { ++mutexes; };
    libc::hooks().lckpwdf = [&accounts] {
        ++accounts;
        return 0;
    };
    GetParam().call();
    EXPECT_EQ(mutexes, 0);
    EXPECT_EQ(accounts, std::string(GetParam().function) == "getUserCount" ? 1 : 0);
}

} // namespace os_log_test
