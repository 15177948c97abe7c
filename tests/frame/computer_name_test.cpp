#include "frame/ComputerInfo.h"

#include "tests/interpose/Libc.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"
#include "tests/support/WideTexts.h"

#include <gtest/gtest.h>

#include <cstring>
#include <string>
#include <sys/utsname.h>
#include <vector>

namespace computer_name_test
{

using NQ::ComputerInfo;

/** A machine whose names all differ; uname can fail. */
class ComputerName : public testing::Test
{
protected:
    ComputerName()
    {
        libc::hooks().uname = [this](utsname* system) {
            std::strcpy(system->sysname, "kernel");
            std::strcpy(system->nodename, "harbour");
            std::strcpy(system->release, "6.1.0");
            std::strcpy(system->machine, "x86_64");
            return fails_ ? -1 : 0;
        };
    }

    libc::HookGuard const guard_;
    bool fails_ = false;
};

TEST_F(ComputerName, IsTheMachinesNodeName)
{
    std::string name = "before";
    EXPECT_TRUE(ComputerInfo::getComputerName(name));
    EXPECT_EQ(name, "harbour");
}

TEST_F(ComputerName, FailsIfUnameFails)
{
    fails_ = true;
    std::string name = "before";
    EXPECT_FALSE(ComputerInfo::getComputerName(name));
    EXPECT_EQ(name, "before");
}

TEST_F(ComputerName, IsConvertedByTheHost)
{
    WideTexts const texts;
    std::string name;
    ComputerInfo::getComputerName(name);
    EXPECT_EQ(texts.made, Lines{"harbour"});
}

TEST_F(ComputerName, LogsEntryAndExitUnderTheFramesName)
{
    for (bool const fails : {false, true}) {
        fails_ = fails;
        Recording const log;
        std::string name;
        ComputerInfo::getComputerName(name);
        EXPECT_EQ(log.texts(3000), (Lines{"getComputerName: entry", "getComputerName: exit"}));
        EXPECT_EQ(log.texts().size(), 2U);
        for (LogRecord const& record : log.records()) {
            EXPECT_EQ(record.file, "OsSwMI");
            EXPECT_EQ(record.category, "Veltrix.IC.MI.OsSwMI");
        }
    }
}

} // namespace computer_name_test
