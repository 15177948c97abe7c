#include "sysdata/osInfo_linux.h"

#include "tests/interpose/Libc.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <iterator>
#include <ostream>
#include <string>
#include <sys/sysinfo.h>
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
};

unsigned int read(NumberGetter get)
{
    unsigned int out = untouched;
    EXPECT_TRUE((OsInfo().*get)(out));
    return out;
}

TEST(OsInfoFixedValues, AreTheSameOnEveryMachineAndReadNothing)
{
    int asked = 0;
    auto const noteFile = [&asked](char const*, char const*) { ++asked; };
    libc::hooks().popen.watch(noteFile);
    libc::hooks().fopen.watch(noteFile);
    libc::hooks().uname.watch([&asked](struct utsname*) { ++asked; });
    libc::hooks().time.watch([&asked](std::time_t*) { ++asked; });
    libc::hooks().sysinfo.watch([&asked](Figures*) { ++asked; });
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
    EXPECT_EQ(asked, 0);
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
    testing::Values(RamCase{&OsInfo::getPhysicalMemorySize,
                            [](Figures& figures) -> unsigned long& { return figures.totalram; },
                            "physicalMemorySize failed", "getPhysicalMemorySize"},
                    RamCase{&OsInfo::getPhysicalMemoryFree,
                            [](Figures& figures) -> unsigned long& { return figures.freeram; },
                            "physicalMemoryFree failed", "getPhysicalMemoryFree"}),
    [](auto const& test) { return std::string(test.param.function); });

TEST_P(OsInfoRam, IsCountedInKibibytes)
{
    unsigned long const most = ~0UL;
    struct {
        unsigned long amount;
        unsigned int memoryUnit;
        unsigned int figure;
    } const cases[] = {
        {1024, 1, 1},
        {8UL << 20, 1, 8192},
        {2047, 1, 1},
        {1023, 1, 0},
        {0, 1, 0},
        {123456, 1024, 123456},
        {123456, 4096, 4 * 123456},
        // The unit is rounded down to whole kibibytes.
        {100, 1025, 100},
        {100, 2047, 100},
        {100, 2048, 200},
        // Nothing is written for other units.
        {123456, 0, untouched},
        {123456, 2, untouched},
        {123456, 512, untouched},
        {123456, 1023, untouched},
        // The product has 32 bits, and so has the amount after it is shifted.
        {0x40000000, 4096, 0},
        {0x40000001, 4096, 4},
        {0xFFFFFFFF, 2048, 0xFFFFFFFE},
        {3, 0x80000000, 0x600000},
        {most, 1, static_cast<unsigned int>(most >> 10)},
    };
    Recording const log;
    for (auto const& [amount, memoryUnit, figure] : cases)
        EXPECT_EQ(of(amount, memoryUnit), figure) << amount << " times " << memoryUnit;
    EXPECT_EQ(kernel_.calls, static_cast<int>(std::size(cases)));
    EXPECT_TRUE(log.remarks().empty());
}

TEST(OsInfoFigure, IgnoresTheMemoryUnitAndIsZeroIfSysinfoFails)
{
    struct {
        NumberGetter get;
        unsigned int expected;
    } const figures[] = {{&OsInfo::getSwapFileSize, 5000},
                         {&OsInfo::getSwapFileFree, 1500},
                         {&OsInfo::getSwapFileSizeStored, 3500},
                         {&OsInfo::getProcessCount, 65535}};
    for (auto const& [get, expected] : figures) {
        Kernel kernel;
        kernel.figures.totalswap = 5000;
        kernel.figures.freeswap = 1500;
        kernel.figures.procs = 65535;
        for (unsigned int const memoryUnit : {0U, 1U, 512U, 1024U, 4096U}) {
            kernel.figures.mem_unit = memoryUnit;
            EXPECT_EQ(read(get), expected) << memoryUnit;
        }
        EXPECT_EQ(kernel.calls, 5);
        kernel.fails = true;
        Recording const log;
        EXPECT_EQ(read(get), 0U);
        EXPECT_TRUE(log.remarks().empty());
    }
}

TEST(OsInfoLastBootTime, IsTheClockLessTheUptimeEachTime)
{
    Kernel kernel;
    time_t now = 1273659825;
    libc::hooks().time = [&now](std::time_t*) { return now; };
    kernel.figures.uptime = 1000;
    long out = untouched;
    EXPECT_TRUE(OsInfo().getLastBootTime(out));
    EXPECT_EQ(out, 1273658825);
    EXPECT_EQ(kernel.calls, 1);
    now = 1273660000;
    kernel.figures.uptime = 5;
    EXPECT_TRUE(OsInfo().getLastBootTime(out));
    EXPECT_EQ(out, 1273659995);
    EXPECT_EQ(kernel.calls, 2);
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

TEST_P(OsInfoRam, LogsItsFailureToBothLogsBeforeItIsZero)
{
    kernel_.fails = true;
    struct : mihost::LogSink {
        void write(mihost::LogMessage const& message) override
        {
            if (message.text == std::string(GetParam().failure) && message.level == 3000) {
                EXPECT_STREQ(message.function, GetParam().function);
                seen.push_back(out);
            }
        }
        unsigned int out = untouched;
        std::vector<unsigned int> seen;
    } sink;
    mihost::setLogSink(&sink);
    EXPECT_TRUE((OsInfo().*GetParam().get)(sink.out));
    mihost::setLogSink(nullptr);
    EXPECT_EQ(sink.out, 0U);
    EXPECT_EQ(sink.seen, std::vector<unsigned int>(2, untouched));
}

} // namespace os_figures_test
