// Which commands run through NQ::MyProcess, which a host may replace, and which open their own
// pipe.

#include "util/MyProcess.h"

#include "nodes/UserNode.h"
#include "sysdata/driverInfo_linux.h"
#include "sysdata/logInfo_linux.h"
#include "sysdata/osInfo_linux.h"
#include "sysdata/userInfo_linux.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/FakeFiles.h"
#include "tests/support/SystemLog.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <vector>

namespace
{

using Commands = std::vector<std::string>;

Commands& throughTheRunner()
{
    static Commands commands;
    return commands;
}

} // namespace

FILE* NQ::MyProcess::mypopen(char const* command, char const* mode)
{
    throughTheRunner().push_back(std::string(command) + "|" + mode);
    stream_ = popen(command, mode);
    return stream_;
}

namespace
{

class CommandRunner : public testing::Test
{
protected:
    CommandRunner()
    {
        std::filesystem::create_directories(files_.realPath("/here"));
        std::filesystem::current_path(files_.realPath("/here")); // "usrandpwd" is written there
        throughTheRunner().clear();
        commands_.otherwise = "";
    }

    void TearDown() override
    {
        std::filesystem::current_path("/");
    }

    FakeFiles const files_;
    FakeCommands commands_; // none reaches the machine
};

TEST_F(CommandRunner, RunsThePowerActions)
{
    NQ::OsInfo info;
    info.statusReset();
    info.statusOffline();
    EXPECT_EQ(throughTheRunner(), (Commands{"/sbin/shutdown -r now|r", "/sbin/shutdown -h now|r"}));
}

TEST_F(CommandRunner, RunsTheCommandsOfTheDriverInventory)
{
    commands_.answers["lsmod"] = "loop 1 0\n";
    std::vector<NQ::driverInfo> drivers;
    NQ::getDriverInfo(drivers);
    EXPECT_EQ(throughTheRunner(), (Commands{"lsmod|r", "modinfo loop|r"}));
}

TEST_F(CommandRunner, RunsTheCommandsOfTheLogReader)
{
    std::string const wc = systemLog::count;
    commands_.answers = systemLog::answers({"Nov 20 10:11:12 host"});
    long time = 0;
    NQ::logInfo().getCreationTime(time, 1);
    EXPECT_EQ(throughTheRunner(),
              (Commands{wc + "|r", wc + "|r", wc + "|r", systemLog::line(1) + "|r", "date|r"}));
}

TEST_F(CommandRunner, RunsTheOperationsOnAnAccount)
{
    NQ::userInfo user;
    user.setDelete("jdoe");
    user.setInactivityTimeout("1970-01-03 00:00:00", "jdoe");
    user.setPasswordExpiration("1970-01-03 00:00:00", "jdoe");
    ASSERT_EQ(throughTheRunner().size(), 5U);
    EXPECT_EQ(throughTheRunner()[0], "userdel -r jdoe|r");
    EXPECT_EQ(throughTheRunner()[1], "chage -l jdoe|r");
    EXPECT_EQ(throughTheRunner()[2].rfind("chage -I ", 0), 0U);
    EXPECT_EQ(throughTheRunner()[3], "chage -l jdoe|r");
    EXPECT_EQ(throughTheRunner()[4].rfind("chage -M ", 0), 0U);
}

TEST_F(CommandRunner, RunsChpasswdForAUsersNewPassword)
{
    IC::UserNode node(9, 7, {7}, 46, 1);
    node.setProperty(117, IC::PropertyValue("secret", true));
    EXPECT_EQ(throughTheRunner(), Commands{"chpasswd -e < usrandpwd ; rm -f usrandpwd|r"});
}

TEST_F(CommandRunner, DoesNotRunMethodsOrLockQueries)
{
    NQ::OsInfo info;
    info.setCreateUser("UserDel,UserName:CMPI_string:jdoe");
    char user[] = "jdoe";
    NQ::userInfo().findIsAcctDisabled(user);
    EXPECT_EQ(commands_.ran,
              (Commands{"/usr/sbin/userdel jdoe 2>&1", "/usr/bin/passwd -S jdoe 2>&1"}));
    EXPECT_EQ(throughTheRunner(), Commands());
}

} // namespace
