#include "frame/ComputerInfo.h"

#include "tests/interpose/Libc.h"
#include "tests/support/Lines.h"
#include "tests/support/Recording.h"
#include "tests/support/WideTexts.h"

#include <gtest/gtest.h>

#include <cstring>
#include <string>
#include <sys/utsname.h>

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

    bool fails_ = false;
};

TEST_F(ComputerName, IsTheMachinesNodeNameConvertedByTheHost)
{
    for (bool const fails : {false, true}) {
        fails_ = fails;
        Recording const log;
        WideTexts const texts;
        std::string name = "before";
        EXPECT_EQ(ComputerInfo::getComputerName(name), !fails);
        EXPECT_EQ(name, fails ? "before" : "harbour");
        EXPECT_EQ(texts.made, fails ? Lines{} : Lines{"harbour"});
        EXPECT_EQ(log.texts(), (Lines{"getComputerName: entry", "getComputerName: exit"}));
        EXPECT_EQ(log.texts(3000).size(), 2U);
        EXPECT_EQ(log.sources(), Lines{"getComputerName OsSwMI Veltrix.IC.MI.OsSwMI"});
    }
}

} // namespace computer_name_test
