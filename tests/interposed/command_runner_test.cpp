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
#include "tests/support/TimeZone.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <functional>
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
    throughTheRunner().emplace_back(command);
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
        commands_.otherwise = "";
    }

    void TearDown() override
    {
        std::filesystem::current_path("/");
    }

    FakeFiles const files_;
    FakeCommands commands_; // none reaches the machine
};

TEST_F(CommandRunner, RunsEveryCommandButMethodsAndLockQueries)
{
    std::string const wc = systemLog::count;
    commands_.answers = systemLog::answers({"Nov 20 10:11:12 host"});
    commands_.answers["lsmod"] = "loop 1 0\n";
    commands_.answers["chage -l jdoe"] = "";
    NQ::OsInfo info;
    NQ::userInfo user;
    struct {
        std::function<void()> run;
        Commands commands;
    } const cases[] = {
        {[&info] { info.statusReset(); }, {"/sbin/shutdown -r now"}},
        {[&info] { info.statusOffline(); }, {"/sbin/shutdown -h now"}},
        {[] {
             std::vector<NQ::driverInfo> drivers;
             NQ::getDriverInfo(drivers);
         },
         {"lsmod", "modinfo loop"}},
        {[] {
             long time = 0;
             NQ::logInfo().getCreationTime(time, 1);
         },
         {wc, wc, wc, systemLog::line(1), "date"}},
        {[&user] { user.setDelete("jdoe"); }, {"userdel -r jdoe"}},
        {[&user] { user.setInactivityTimeout("1970-01-03 00:00:00", "jdoe"); },
         {"chage -l jdoe", "chage -I 2 jdoe"}},
        {[&user] { user.setPasswordExpiration("1970-01-03 00:00:00", "jdoe"); },
         {"chage -l jdoe", "chage -M 2 jdoe"}},
        {[] { IC::UserNode(9, 7, {7}, 46, 1).setProperty(117, IC::PropertyValue("secret", true)); },
         {"chpasswd -e < usrandpwd ; rm -f usrandpwd"}},
        {[&info] { info.setCreateUser("UserDel,UserName:CMPI_string:jdoe"); }, {}},
        {[&user] {
             char name[] = "jdoe";
             user.findIsAcctDisabled(name);
         },
         {}},
    };
    useZone("UTC0");
    for (auto const& [run, expected] : cases) {
        throughTheRunner().clear();
        commands_.ran.clear();
        run();
        EXPECT_EQ(throughTheRunner(), expected);
        EXPECT_FALSE(commands_.ran.empty());
    }
}

} // namespace
