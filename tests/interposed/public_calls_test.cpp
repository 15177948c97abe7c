// Contract: public functions call other public functions by name, so a host that replaces one
// sees these calls.

#include "sysdata/groupInfo_linux.h"
#include "sysdata/minMaxId.h"
#include "sysdata/osInfo_linux.h"
#include "sysdata/userInfo_linux.h"
#include "tests/interpose/Real.h"
#include "tests/interposed/StandIns.h"
#include "tests/support/FakeCommands.h"
#include "tests/support/FakeFiles.h"
#include "util/MyProcess.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace
{

using Calls = std::vector<std::string>;

Calls& seen()
{
    static Calls calls;
    return calls;
}

} // namespace

bool NQ::userInfo::executeLinCommand(char* command, char const* const* args, char* output)
{
    static auto* const real = interpose::real(&userInfo::executeLinCommand);
    std::string call = std::string("executeLinCommand ") + command;
    for (char const* const* arg = args; **arg != '\0'; ++arg)
        call += std::string(" ") + *arg;
    seen().push_back(call);
    return real(this, command, args, output);
}

void NQ::groupInfo::setGroupMembers(char** members)
{
    static auto* const real = interpose::real(&groupInfo::setGroupMembers);
    std::string call = "setGroupMembers " + std::to_string(groupId_);
    for (char** member = members; *member; ++member)
        call += std::string(" ") + *member;
    seen().push_back(call);
    real(this, members);
}

void NQ::Tokenize(std::string const& text, std::vector<std::string>& tokens,
                  std::string const& delimiters)
{
    static auto* const real = interpose::real(NQ::Tokenize);
    seen().push_back("Tokenize " + delimiters);
    real(text, tokens, delimiters);
}

unsigned int NQ::minMaxId::getMinGroupId()
{
    seen().emplace_back("getMinGroupId");
    return 500;
}

unsigned int NQ::minMaxId::getMaxGroupId()
{
    seen().emplace_back("getMaxGroupId");
    return 60000;
}

int NQ::OsInfo::executeCommand(char* program, char** arguments, char* output)
{
    static auto* const real = interpose::real(&OsInfo::executeCommand);
    seen().push_back(std::string("executeCommand ") + program);
    EXPECT_EQ(arguments[0], program); // the list begins with the program's own slot
    return real(this, program, arguments, output);
}

void NQ::OsInfo::executePasswordEncryption(char* password, char* user)
{
    static auto* const real = interpose::real(&OsInfo::executePasswordEncryption);
    seen().push_back(std::string("executePasswordEncryption ") + password + " " + user);
    real(this, password, user);
}

bool NQ::OsInfo::groupMemberChanges(std::string method, std::vector<ParamInfo> params)
{
    seen().push_back("groupMemberChanges " + method + " " + std::to_string(params.size()));
    return true;
}

void NQ::OsInfo::strreplace(char* s, char from, char to)
{
    static auto* const real = interpose::real(&OsInfo::strreplace);
    seen().push_back(std::string("strreplace ") + from + to);
    real(this, s, from, to);
}

bool NQ::OsInfo::getOSReleaseName(std::string path, std::string& out)
{
    seen().push_back("getOSReleaseName " + path);
    out = "of " + path;
    return path == "/etc/SuSE-release";
}

bool NQ::OsInfo::getKestoVersion(std::string path, std::string& out)
{
    seen().push_back("getKestoVersion " + path);
    out = "10.2";
    return true;
}

namespace
{

class PublicCalls : public testing::Test
{
protected:
    PublicCalls()
    {
        commands_.otherwise = "";
        seen().clear();
    }

    static Calls allBut(std::string const& prefix)
    {
        Calls calls;
        for (std::string const& call : seen())
            if (call.rfind(prefix, 0) != 0)
                calls.push_back(call);
        return calls;
    }

    FakeFiles const files_;
    FakeCommands commands_;
};

TEST_F(PublicCalls, TheLockQueryUsesTheRecordsRunner)
{
    char user[] = "jdoe";
    NQ::userInfo().findIsAcctDisabled(user);
    EXPECT_EQ(seen(), Calls{"executeLinCommand /usr/bin/passwd /usr/bin/passwd -S jdoe"});
}

TEST_F(PublicCalls, TheGroupListingSetsTheMembersOfEachGroup)
{
    files_.write("/etc/passwd", "anna:x:1000:500:::\n");
    files_.write("/etc/group", "team:x:500:ben,carl\ncrew:x:501:\n");
    std::vector<NQ::groupInfo> groups;
    NQ::getGroupInfo(groups);
    EXPECT_EQ(allBut("get"), (Calls{"setGroupMembers 500 ben carl", "setGroupMembers 501"}));
    ASSERT_EQ(groups.size(), 2U);
    EXPECT_EQ(groups[0].getGroupMembers(), (Calls{"anna", "ben", "carl"}));
}

TEST_F(PublicCalls, TheListingsReadBothBoundsForEveryEntry)
{
    files_.write("/etc/group", "root:x:0:\ntty:x:5:\nteam:x:500:\n");
    files_.write("/etc/passwd", "root:x:0:0:::\ndaemon:x:2:2:::\njdoe:x:1000:1000:::\n");
    standIns() = {};
    std::vector<NQ::groupInfo> groups;
    NQ::getGroupInfo(groups);
    EXPECT_EQ(allBut("set"), (Calls{"getMinGroupId", "getMaxGroupId", "getMinGroupId",
                                    "getMaxGroupId", "getMinGroupId", "getMaxGroupId"}));
    EXPECT_EQ(standIns().calls, Calls(6, "Instance"));

    standIns() = {};
    std::vector<NQ::userInfo> users;
    NQ::getUserInfo(users);
    Calls expected;
    for (int account = 0; account < 3; ++account)
        expected.insert(expected.end(), {"Instance", "getMinUserId", "Instance", "getMaxUserId"});
    EXPECT_EQ(standIns().calls, expected);
}

TEST_F(PublicCalls, TheParserSplitsAtBothLevelsWithTokenize)
{
    for (char const* text : {"UserDel,UserName:CMPI_string:jdoe,A:CMPI_string:b",
                             "UserDel,Password:CMPI_string:jdoe,A:CMPI_string:b"}) {
        seen().clear();
        std::string method;
        std::vector<NQ::ParamInfo> params;
        NQ::OsInfo().parseMethodAndParams(text, method, params);
        EXPECT_EQ(seen(), (Calls{"Tokenize ,", "Tokenize :", "Tokenize :"}));
        EXPECT_EQ(params.size(), 2U);
    }
}

TEST_F(PublicCalls, TheNameAndTheVersionUseTheReadersOfTheirFiles)
{
    static auto* const realName = interpose::real(&NQ::OsInfo::getOSName);
    static auto* const realVersion = interpose::real(&NQ::OsInfo::getOSVersion);
    NQ::OsInfo info;
    std::string name;
    std::string version;
    EXPECT_TRUE(realName(&info, name));
    EXPECT_TRUE(realVersion(&info, version));
    EXPECT_EQ(name, "of /etc/SuSE-release");
    EXPECT_EQ(version, "10.2");
    EXPECT_EQ(seen(),
              (Calls{"getOSReleaseName /etc/release", "getOSReleaseName /etc/vmware-release",
                     "getOSReleaseName /etc/redhat-release", "getOSReleaseName /etc/SuSE-release",
                     "getKestoVersion /etc/release"}));
}

TEST_F(PublicCalls, TheInstallDateReplacesHyphensAndThenColons)
{
    files_.write("/etc/redhat-release", "");
    commands_.otherwise = "Change: 2010-05-12 10:23:45\n";
    long date = 0;
    EXPECT_TRUE(realGetInstallDate(date));
    EXPECT_NE(date, 0);
    EXPECT_EQ(seen(), (Calls{"strreplace - ", "strreplace : "}));
}

TEST_F(PublicCalls, TheExecutorUsesRunnerAndPasswordSetter)
{
    bool shadowing = false;
    commands_.otherwise = "rc=0";
    NQ::OsInfo().executeMethod(
        "UserAdd", {{"UserName", "CMPI_string", "jdoe"}, {"Password", "CMPI_string", "pw"}},
        shadowing);
    EXPECT_EQ(seen(),
              (Calls{"executeCommand /usr/sbin/useradd", "executePasswordEncryption pw jdoe",
                     "executeCommand echo", "executeCommand /usr/bin/chage"}));
}

TEST_F(PublicCalls, TheExecutorPassesMembershipsOnUnchanged)
{
    bool shadowing = false;
    EXPECT_EQ(
        NQ::OsInfo().executeMethod("LocalGroupAddUser", {{"A", "CMPI_string", "b"}}, shadowing), 1);
    EXPECT_EQ(seen(), Calls{"groupMemberChanges LocalGroupAddUser 1"});
}

} // namespace
