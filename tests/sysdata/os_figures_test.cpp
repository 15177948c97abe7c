#include "sysdata/osInfo_linux.h"

#include "tests/interpose/Libc.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <ostream>
#include <string>
#include <sys/sysinfo.h>
#include <utility>
#include <vector>

namespace os_figures_test
{

using NQ::OsInfo;
using Figures = struct sysinfo;
using NumberGetter = bool (OsInfo::*)(unsigned int&);

constexpr unsigned int untouched = 4711;

/** The kernel answers every sysinfo call with these figures, or fails. */
class Kernel
{
public:
    Kernel()
    {
        libc::hooks().sysinfo = [this](Figures* out) {
            ++calls;
            // A failed call may leave anything here, so it must not be used.
            *out = figures;
            return fails ? -1 : 0;
        };
    }

    Figures figures{};
    bool fails = false;
    int calls = 0;

private:
    libc::HookGuard const guard_;
};

unsigned int read(NumberGetter get)
{
    unsigned int out = untouched;
    EXPECT_TRUE((OsInfo().*get)(out));
    return out;
}

TEST(OsInfoFixedValues, AreTheSameOnEveryMachine)
{
    Kernel kernel;
    kernel.fails = true;
    EXPECT_EQ(read(&OsInfo::getProcessMaxNumber), 32000U);
    EXPECT_EQ(read(&OsInfo::getProcessMaxMemory), 0U);
    EXPECT_EQ(read(&OsInfo::getLicensedUserCount), 0U);
    EXPECT_EQ(read(&OsInfo::getVirtualMemorySize), 0U);
    EXPECT_EQ(read(&OsInfo::getVirtualMemoryFree), 0U);

    bool distributed = true;
    EXPECT_TRUE(OsInfo().getDistributed(distributed));
    EXPECT_FALSE(distributed);

    std::string createUser = "before";
    EXPECT_TRUE(OsInfo().getOSCreateUser(createUser));
    EXPECT_EQ(createUser, "");

    EXPECT_EQ(kernel.calls, 0);
}

unsigned long& totalRam(Figures& figures)
{
    return figures.totalram;
}

unsigned long& freeRam(Figures& figures)
{
    return figures.freeram;
}

struct RamCase {
    NumberGetter get;
    unsigned long& (*field)(Figures& figures);
    char const* failure;
    char const* function;
};

[[maybe_unused]] void PrintTo(RamCase const& test, std::ostream* out)
{
    *out << test.function;
}

class OsInfoRam : public testing::TestWithParam<RamCase>
{
protected:
    unsigned int of(unsigned long amount, unsigned int memoryUnit)
    {
        // Every other field has a value that would be noticed.
        kernel_.figures.totalram = kernel_.figures.freeram = 11 << 20;
        kernel_.figures.totalhigh = kernel_.figures.bufferram = 13 << 20;
        GetParam().field(kernel_.figures) = amount;
        kernel_.figures.mem_unit = memoryUnit;
        return read(GetParam().get);
    }

    Kernel kernel_;
};

INSTANTIATE_TEST_SUITE_P(
    Of, OsInfoRam,
    testing::Values(RamCase{&OsInfo::getPhysicalMemorySize, totalRam, "physicalMemorySize failed",
                            "getPhysicalMemorySize"},
                    RamCase{&OsInfo::getPhysicalMemoryFree, freeRam, "physicalMemoryFree failed",
                            "getPhysicalMemoryFree"}),
    [](auto const& test) { return std::string(test.param.function); });

TEST_P(OsInfoRam, IsCountedInKibibytesWhenTheUnitIsOneByte)
{
    EXPECT_EQ(of(1024, 1), 1U);
    EXPECT_EQ(of(8UL << 20, 1), 8192U);
    EXPECT_EQ(of(2047, 1), 1U);
    EXPECT_EQ(of(1023, 1), 0U);
    EXPECT_EQ(of(0, 1), 0U);
}

TEST_P(OsInfoRam, IsTheFieldItselfWhenTheUnitIsAKibibyte)
{
    EXPECT_EQ(of(123456, 1024), 123456U);
}

TEST_P(OsInfoRam, IsFourTimesTheFieldWhenTheUnitIs4096)
{
    EXPECT_EQ(of(123456, 4096), 4U * 123456U);
}

TEST_P(OsInfoRam, RoundsTheUnitDownToWholeKibibytes)
{
    EXPECT_EQ(of(100, 1025), 100U);
    EXPECT_EQ(of(100, 2047), 100U);
    EXPECT_EQ(of(100, 2048), 200U);
}

TEST_P(OsInfoRam, IsNotWrittenForAUnitOfZeroOrBetween2And1023)
{
    for (unsigned int const memoryUnit : {0U, 2U, 512U, 1023U})
        EXPECT_EQ(of(123456, memoryUnit), untouched) << memoryUnit;
}

TEST_P(OsInfoRam, WrapsAt32Bits)
{
    EXPECT_EQ(of(0x40000000, 4096), 0U);
    EXPECT_EQ(of(0x40000001, 4096), 4U);
    EXPECT_EQ(of(0xFFFFFFFF, 2048), 0xFFFFFFFEU);
    EXPECT_EQ(of(3, 0x80000000), 0x600000U);
}

TEST_P(OsInfoRam, IsZeroAndLogsThatSysinfoFailed)
{
    kernel_.fails = true;
    Recording const log;
    EXPECT_EQ(of(123456, 1), 0U);
    std::string const function = GetParam().function;
    EXPECT_EQ(log.texts(3000), (std::vector<std::string>{function + ": entry", GetParam().failure,
                                                         function + ": exit"}));
    for (LogRecord const& record : log.records())
        EXPECT_EQ(record.function, function);
}

TEST_P(OsInfoRam, LogsNoRemarkOtherwise)
{
    Recording const log;
    of(123456, 1);
    of(123456, 512);
    EXPECT_TRUE(log.remarks().empty());
}

TEST_P(OsInfoRam, CallsSysinfoOnceForEachRead)
{
    of(1024, 1);
    of(1024, 1);
    EXPECT_EQ(kernel_.calls, 2);
}

struct FigureCase {
    NumberGetter get;
    char const* function;
    unsigned int expected;
};

[[maybe_unused]] void PrintTo(FigureCase const& test, std::ostream* out)
{
    *out << test.function;
}

class OsInfoFigure : public testing::TestWithParam<FigureCase>
{
protected:
    OsInfoFigure()
    {
        kernel_.figures.totalswap = 5000;
        kernel_.figures.freeswap = 1500;
        kernel_.figures.procs = 65535;
        kernel_.figures.mem_unit = 4096;
    }

    Kernel kernel_;
};

INSTANTIATE_TEST_SUITE_P(
    Of, OsInfoFigure,
    testing::Values(FigureCase{&OsInfo::getSwapFileSize, "getSwapFileSize", 5000},
                    FigureCase{&OsInfo::getSwapFileFree, "getSwapFileFree", 1500},
                    FigureCase{&OsInfo::getSwapFileSizeStored, "getSwapFileSizeStored", 3500},
                    FigureCase{&OsInfo::getProcessCount, "getProcessCount", 65535}),
    [](auto const& test) { return std::string(test.param.function); });

TEST_P(OsInfoFigure, IgnoresTheMemoryUnit)
{
    for (unsigned int const memoryUnit : {0U, 1U, 512U, 1024U, 4096U}) {
        kernel_.figures.mem_unit = memoryUnit;
        EXPECT_EQ(read(GetParam().get), GetParam().expected) << memoryUnit;
    }
    EXPECT_EQ(kernel_.calls, 5);
}

TEST_P(OsInfoFigure, IsZeroIfSysinfoFails)
{
    kernel_.fails = true;
    Recording const log;
    EXPECT_EQ(read(GetParam().get), 0U);
    EXPECT_TRUE(log.remarks().empty());
}

TEST(OsInfoLastBootTime, IsTheClockLessTheUptime)
{
    Kernel kernel;
    kernel.figures.uptime = 1000;
    libc::hooks().time = [](std::time_t*) { return time_t{1273659825}; };
    long out = untouched;
    EXPECT_TRUE(OsInfo().getLastBootTime(out));
    EXPECT_EQ(out, 1273658825);
}

TEST(OsInfoLastBootTime, FailsIfSysinfoFails)
{
    Kernel kernel;
    kernel.fails = true;
    Recording const log;
    long out = untouched;
    EXPECT_FALSE(OsInfo().getLastBootTime(out));
    EXPECT_EQ(out, static_cast<long>(untouched));
    EXPECT_TRUE(log.remarks().empty());
}

TEST_P(OsInfoRam, IsShiftedBeforeItIsCutTo32Bits)
{
    unsigned long const most = ~0UL;
    EXPECT_EQ(of(most, 1), static_cast<unsigned int>(most >> 10));
    if (sizeof(unsigned long) > 4) {
        EXPECT_EQ(of(static_cast<unsigned long>(17179869184ULL), 1), 16777216U); // 16 GiB
    }
}

TEST_P(OsInfoRam, LogsItsFailureToBothLogsBeforeItIsZero)
{
    using Operation = mihost::LogMessage::Operation;
    kernel_.fails = true;
    struct : mihost::LogSink {
        void write(mihost::LogMessage const& message) override
        {
            if (message.text == failure && message.level == 3000)
                seen.emplace_back(message.operation, out);
        }
        std::string failure;
        unsigned int out = untouched;
        std::vector<std::pair<Operation, unsigned int>> seen;
    } sink;
    sink.failure = GetParam().failure;
    mihost::setLogSink(&sink);
    EXPECT_TRUE((OsInfo().*GetParam().get)(sink.out));
    mihost::setLogSink(nullptr);
    EXPECT_EQ(sink.out, 0U);
    ASSERT_EQ(sink.seen.size(), 2U);
    EXPECT_TRUE(sink.seen[0] == std::pair(Operation::Log, untouched));
    EXPECT_TRUE(sink.seen[1] == std::pair(Operation::Trace, untouched));
}

TEST(OsInfoLastBootTime, ReadsSysinfoAndTheClockEachTime)
{
    Kernel kernel;
    time_t now = 1273659825;
    libc::hooks().time = [&now](std::time_t*) { return now; };
    kernel.figures.uptime = 1000;
    long out = 0;
    EXPECT_TRUE(OsInfo().getLastBootTime(out));
    EXPECT_EQ(kernel.calls, 1);
    now = 1273660000;
    kernel.figures.uptime = 5;
    EXPECT_TRUE(OsInfo().getLastBootTime(out));
    EXPECT_EQ(out, 1273659995);
    EXPECT_EQ(kernel.calls, 2);
}

TEST(OsInfoFixedValues, UseNoFilesCommandsOrClock)
{
    Kernel const kernel; // its guard removes the hooks
    int asked = 0;
    auto const open = [&asked](char const*, char const*) -> FILE* {
        ++asked;
        return nullptr;
    };
    libc::hooks().popen = open;
    libc::hooks().fopen = open;
    libc::hooks().uname = [&asked](struct utsname*) {
        ++asked;
        return -1;
    };
    libc::hooks().time = [&asked](std::time_t*) {
        ++asked;
        return time_t{0};
    };
    for (NumberGetter const get :
         {&OsInfo::getProcessMaxNumber, &OsInfo::getProcessMaxMemory, &OsInfo::getLicensedUserCount,
          &OsInfo::getVirtualMemorySize, &OsInfo::getVirtualMemoryFree})
        read(get);
    bool distributed = true;
    OsInfo().getDistributed(distributed);
    std::string text;
    OsInfo().getOSCreateUser(text);
    EXPECT_EQ(asked, 0);
}

} // namespace os_figures_test
