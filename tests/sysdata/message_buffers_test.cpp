// Every message is assembled in a buffer of the host's, fixed texts included.

#include "host/VXMessageBuffer.h"
#include "sysdata/driverInfo_linux.h"
#include "sysdata/osInfo_linux.h"
#include "sysdata/userInfo_linux.h"
#include "tests/support/Libc.h"
#include "tests/support/Next.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <atomic>

namespace
{
std::atomic<std::size_t> taken{0}; // texts that were taken out of buffers
}

namespace VXLog
{

std::string VXMessageBuffer::str(VXMessageBuffer& end)
{
    static auto* const real = next<std::string(VXMessageBuffer*, VXMessageBuffer&)>(
        "_ZN5VXLog15VXMessageBuffer3strB5cxx11ERS0_");
    ++taken;
    return real(this, end);
}

std::string VXMessageBuffer::str(std::ostream& end)
{
    static auto* const real = next<std::string(VXMessageBuffer*, std::ostream&)>(
        "_ZN5VXLog15VXMessageBuffer3strB5cxx11ERSo");
    ++taken;
    return real(this, end);
}

} // namespace VXLog

TEST(Messages, TakeABufferEach)
{
    libc::HookGuard const guard;
    libc::hooks().popen = [](char const*, char const*) -> FILE* { return nullptr; };
    libc::hooks().sysinfo = [](struct sysinfo*) { return -1; };
    Recording const recording;
    taken = 0;

    std::vector<NQ::driverInfo> drivers;
    NQ::getDriverInfo(drivers);
    NQ::userInfo().setPasswordExpiration("2030-01-01 00:00:00", "jdoe");
    NQ::OsInfo info;
    unsigned int memory = 0;
    info.getPhysicalMemoryFree(memory);
    info.setCreateUser("UserAdd,UserName:CMPI_string");
    info.setCreateUser("UserAdd,UserName:CMPI_boolean:x");
    info.setCreateUser("UserAdd,UserName:CMPI_string:" + std::string(5000, 'x'));
    info.statusOffline();

    std::vector<std::string> const texts = recording.texts();
    for (char const* fixed : {"Cannot open process: lsmod", "Cannot open process: chage -M",
                              "This parameter is blank ---exiting ", "physicalMemoryFree failed",
                              "Unknown parameter type: CMPI_boolean", "Halt after shutdown.",
                              "Command line too long: /usr/sbin/useradd"})
        EXPECT_EQ(std::count(texts.begin(), texts.end(), fixed), 1) << fixed;
    EXPECT_EQ(taken, texts.size());
}
