// The mode in which each file is opened.

#include "sysdata/groupInfo_linux.h"
#include "sysdata/logInfo_linux.h"
#include "sysdata/minMaxId.h"
#include "sysdata/osInfo_linux.h"
#include "sysdata/userInfo_linux.h"
#include "tests/interpose/Libc.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/FakeFiles.h"

#include <gtest/gtest.h>

#include <functional>
#include <set>
#include <string>
#include <vector>

namespace file_modes_test
{

using Opened = std::set<std::string>;

/** A machine with every file that is probed; records path and mode of each file that is opened. */
class FileModes : public testing::Test
{
protected:
    FileModes()
    {
        files_.write("/etc/passwd", "jdoe:x:0:0::/home/jdoe:/bin/sh\n");
        files_.write("/etc/shadow", "jdoe:*:14000::::::\n");
        files_.write("/etc/group", "root:x:0:\n");
        files_.write("/etc/pam.d/login", "deny=3\n");
        files_.write("/var/log/messages", "line\n");
        NQ::minMaxId::Instance(); // reads its file here
        commands_.otherwise = "";
        libc::hooks().fopen.watch([this](std::string const& path, std::string const& mode) {
            opened_.insert(path + "|" + mode);
        });
    }

    /** What is opened while the operations run. */
    Opened openedBy(std::function<void()> const& operations)
    {
        opened_.clear();
        operations();
        return opened_;
    }

    FakeFiles const files_;
    FakeCommands commands_;
    Opened opened_;
    NQ::OsInfo info_;
};

TEST_F(FileModes, OfTheListingsAreRoOrR)
{
    auto const list = [this] {
        std::vector<NQ::userInfo> users;
        NQ::getUserInfo(users);
        std::vector<NQ::groupInfo> groups;
        NQ::getGroupInfo(groups);
        unsigned int count = 0;
        info_.getUserCount(count);
    };
    EXPECT_EQ(openedBy(list), (Opened{"/etc/passwd|ro", "/etc/shadow|ro", "/etc/pam.d/login|r"}));
}

TEST_F(FileModes, OfReleaseFilesAreR)
{
    auto const search = [this] {
        long date = 0;
        std::string version;
        info_.getInstallDate(date);
        info_.getOSVersion(version);
    };
    Opened const searched = {"/etc/SuSE-release|r", "/etc/UnitedLinux-release|r",
                             "/etc/redhat-release|r", "/etc/release|r", "/etc/vmware-release|r"};
    char user[] = "jdoe";
    auto const queryLock = [&user] { NQ::userInfo().findIsAcctDisabled(user); };
    EXPECT_EQ(openedBy(search), searched);
    EXPECT_EQ(openedBy(queryLock), (Opened{"/etc/SuSE-release|r", "/etc/UnitedLinux-release|r"}));
    for (char const* path : {"/etc/SuSE-release", "/etc/UnitedLinux-release", "/etc/redhat-release",
                             "/etc/vmware-release"})
        files_.write(path, "");
    EXPECT_EQ(openedBy(search),
              (Opened{"/etc/release|r", "/etc/SuSE-release|r", "/etc/UnitedLinux-release|r"}));
}

TEST_F(FileModes, OfTheProbesOfMethodsAreR)
{
    auto const probe = [this] {
        bool shadowing = false;
        info_.executeMethod("UserAdd", {{"UserName", "CMPI_string", "jdoe"}}, shadowing);
        info_.executeMethod("GetShadowing", {}, shadowing);
    };
    EXPECT_EQ(openedBy(probe), (Opened{"/etc/redhat-release|r", "/etc/shadow|r"}));
    auto const remove = [this] { info_.setCreateUser("UserDel,UserName:CMPI_string:jdoe"); };
    EXPECT_EQ(openedBy(remove), Opened());
}

TEST_F(FileModes, OfTheClearedLogIsW)
{
    EXPECT_EQ(openedBy([] { NQ::logInfo().clearLog(); }), Opened{"/var/log/messages|w"});
}

} // namespace file_modes_test
