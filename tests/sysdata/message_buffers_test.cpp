// Every message is assembled in its own buffer of the host, fixed texts included.

#include "sysdata/driverInfo_linux.h"
#include "sysdata/osInfo_linux.h"
#include "sysdata/userInfo_linux.h"
#include "tests/interpose/Host.h"
#include "tests/interpose/Libc.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <algorithm>

TEST(Messages, UseOneBufferEach)
{
    libc::hooks().popen = [](char const*, char const*) -> FILE* { return nullptr; };
    libc::hooks().sysinfo = [](struct sysinfo*) { return -1; };
    Recording const recording;
    std::size_t taken = 0;
    host::hooks().textOfBuffer.watch(
        [&taken](VXLog::VXMessageBuffer*, VXLog::VXMessageBuffer&) { ++taken; });
    host::hooks().textOfStream.watch([&taken](VXLog::VXMessageBuffer*, std::ostream&) { ++taken; });

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
