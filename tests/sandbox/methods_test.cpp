// Administration with the real tools: from the host's write to the account files, and to the nodes
// that the host receives.

#include "host/Properties.h"
#include "mihost/sandbox/Sandbox.h"
#include "tests/support/Lines.h"
#include "tests/support/Machine.h"
#include "tests/support/Plugin.h"
#include "tests/support/Recording.h"

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <ostream>

namespace methods_test
{

/** A machine with the plug-in on it, seen from the host. */
class HostedMachine
{
public:
    explicit HostedMachine(std::string const& name)
    {
        machine::lay(name);
        if (name == "plain") // which reports no groups otherwise
            machine::write("/etc/login.defs", machine::read("/etc/login.defs") + "GID_MAX 60000\n");
        plugin_.initialize();
        plugin_.interface().setLoadCallBack(noteNode, this, nullptr);
        machine::recordShell();
    }

    /** Writes a method-call text as a host does. */
    IC::Error call(std::string const& text)
    {
        return write(IC::property::createUser, IC::PropertyValue(text, true));
    }

    IC::Error write(unsigned int id, IC::PropertyValue const& value)
    {
        received.clear();
        machine::forget();
        return os().setProperty(id, value);
    }

    IC::MutableNode& os() const
    {
        return plugin_.node(IC::nodeType::operatingSystem);
    }

    /** The command lines since the last write, without those that only list the accounts. */
    static Lines ran()
    {
        Lines lines = machine::ran();
        lines.erase(
            std::remove_if(lines.begin(), lines.end(),
                           [](std::string const& line) { return line.rfind("chage -l ", 0) == 0; }),
            lines.end());
        return lines;
    }

    bool hasReceived(unsigned int type, std::string const& name) const
    {
        return std::find(received.begin(), received.end(), std::to_string(type) + " " + name) !=
               received.end();
    }

    Plugin const& plugin() const
    {
        return plugin_;
    }

    Lines received; // the nodes since the last write, such as "46 jdoe"

private:
    static IC::Error noteNode(IC::Node* const& node, void const* context)
    {
        auto const& added = dynamic_cast<IC::MutableNode const&>(*node);
        auto* const self = static_cast<HostedMachine*>(const_cast<void*>(context));
        self->received.push_back(std::to_string(added.getNodeType()) + " " +
                                 text(added, IC::property::name));
        return {0, IC::Number(0U), ""};
    }

    Plugin plugin_;
};

/** Whether a shell command succeeds; its output is dropped. */
bool succeeds(char const* command)
{
    return std::system((std::string(command) + " >/dev/null 2>&1").c_str()) == 0;
}

struct Account {
    char const* machine;
    std::string user;
    std::string groups; // as id lists them, in quotes, after the unquoted primary one
};

void PrintTo(Account const& account, std::ostream* out)
{
    *out << account.machine;
}

class Methods : public testing::TestWithParam<Account>
{
protected:
    std::string userName() const
    {
        return "UserName:CMPI_string:" + account_.user;
    }

    Lines passwd() const
    {
        return machine::entry("/etc/passwd", account_.user);
    }

    Lines shadow() const
    {
        return machine::entry("/etc/shadow", account_.user);
    }

    Account const& account_ = GetParam();
    HostedMachine host_{GetParam().machine};
};

INSTANTIATE_TEST_SUITE_P(On, Methods,
                         testing::Values(Account{"plain", "gerda", "gerda,\"gerda\""},
                                         Account{"redhat", "anna", "anna,\"anna\",\"top\""}),
                         [](auto const& test) { return std::string(test.param.machine); });

TEST_P(Methods, UserDelRemovesTheAccountAndItsNode)
{
    ASSERT_NE(host_.plugin().find(IC::nodeType::user, account_.user), nullptr);
    EXPECT_EQ(host_.call("UserDel," + userName()).getStatus(), 0);
    EXPECT_EQ(host_.ran(), Lines{"/usr/sbin/userdel " + account_.user + " 2>&1"});
    EXPECT_EQ(passwd(), Lines());
    EXPECT_EQ(shadow(), Lines());
    EXPECT_EQ(host_.plugin().find(IC::nodeType::user, account_.user), nullptr);
    EXPECT_FALSE(host_.hasReceived(IC::nodeType::user, account_.user));
    EXPECT_TRUE(host_.hasReceived(IC::nodeType::user, "root"));
    EXPECT_EQ(text(host_.os(), IC::property::createUser), "UserDel," + userName());
}

TEST_P(Methods, UserDelOfAMissingUserFailsAndPublishesNothing)
{
    EXPECT_EQ(host_.call("UserDel,UserName:CMPI_string:nosuch").getStatus(), 1);
    EXPECT_EQ(host_.ran(), Lines{"/usr/sbin/userdel nosuch 2>&1"});
    EXPECT_EQ(host_.received, Lines());
    EXPECT_EQ(text(host_.os(), IC::property::createUser), "");
}

TEST_P(Methods, UserSetAttribSetsTheAgeing)
{
    EXPECT_EQ(host_
                  .call("UserSetAttrib," + userName() +
                        ",daysMustKeepPassword:CMPI_uint32:3,"
                        "daysMustChangePasswordAfter:CMPI_uint32:30,"
                        "daysWarnBeforePasswordExpire:CMPI_uint32:5,"
                        "daysExpireAfter:CMPI_uint32:6,"
                        "passwordExpirationDate:CMPI_dateTime:20301231000000.000000+000")
                  .getStatus(),
              0);
    EXPECT_EQ(host_.ran(), Lines{"/usr/bin/chage " + account_.user +
                                 " -m 3 -M 30 -W 5 -I 6 -E 2030-12-31 2>&1"});
    Lines const fields = shadow();
    EXPECT_EQ(Lines(fields.begin() + 3, fields.end()), (Lines{"3", "30", "5", "6", "22279", ""}));
    IC::MutableNode const& node = host_.plugin().node(IC::nodeType::user, account_.user);
    EXPECT_EQ(text(node, IC::property::pwdMinDays), "3");
    EXPECT_EQ(text(node, IC::property::pwdMaxDays), "30");
    EXPECT_EQ(text(node, IC::property::pwdWarnDays), "5");
}

TEST_P(Methods, UserSetAttribRemovesAnExpiryThatIsNotGiven)
{
    ASSERT_EQ(std::system(("/usr/bin/chage -E 2030-12-31 " + account_.user).c_str()), 0);
    ASSERT_EQ(shadow().at(7), "22279");
    EXPECT_EQ(host_.call("UserSetAttrib," + userName() + ",daysMustKeepPassword:CMPI_uint32:3")
                  .getStatus(),
              0);
    EXPECT_EQ(host_.ran(), Lines{"/usr/bin/chage " + account_.user + " -m 3 -E -1 2>&1"});
    EXPECT_EQ(shadow().at(3), "3");
    EXPECT_EQ(shadow().at(7), "");
}

TEST_P(Methods, UserSetFullNameKeepsBlanksTogether)
{
    EXPECT_EQ(host_.call("UserSetFullName," + userName() + ",FullName:CMPI_string:John  Smith")
                  .getStatus(),
              0);
    EXPECT_EQ(host_.ran(),
              Lines{"/usr/sbin/usermod -c John\\ \\ Smith " + account_.user + " 2>&1"});
    EXPECT_EQ(passwd().at(4), "John  Smith");
    EXPECT_EQ(text(host_.plugin().node(IC::nodeType::user, account_.user), IC::property::fullName),
              "John  Smith");
}

TEST_P(Methods, UserSetScriptPathSetsTheLoginShell)
{
    EXPECT_EQ(host_.call("UserSetScriptPath," + userName() + ",ScriptPath:CMPI_string:/bin/false")
                  .getStatus(),
              0);
    EXPECT_EQ(host_.ran(), Lines{"/usr/sbin/usermod -s /bin/false " + account_.user + " 2>&1"});
    EXPECT_EQ(passwd().at(6), "/bin/false");
    EXPECT_EQ(
        text(host_.plugin().node(IC::nodeType::user, account_.user), IC::property::scriptPath),
        "/bin/false");
}

TEST_P(Methods, UserSetHomeDirMovesTheDirectory)
{
    machine::write("/home/" + account_.user + "/letter", "kept");
    EXPECT_EQ(
        host_.call("UserSetHomeDir," + userName() + ",HomeDir:CMPI_string:/home/j2").getStatus(),
        0);
    EXPECT_EQ(host_.ran(), Lines{"/usr/sbin/usermod -d /home/j2 -m " + account_.user + " 2>&1"});
    EXPECT_EQ(passwd().at(5), "/home/j2");
    EXPECT_EQ(machine::read("/home/j2/letter"), "kept");
    EXPECT_FALSE(std::filesystem::exists("/home/" + account_.user));
}

TEST_P(Methods, UserSetHomeDirFailsWithoutADirectoryToMove)
{
    ASSERT_FALSE(std::filesystem::exists("/home/" + account_.user));
    EXPECT_EQ(
        host_.call("UserSetHomeDir," + userName() + ",HomeDir:CMPI_string:/home/j2").getStatus(),
        1);
    // usermod warns about the folder after it has changed the account.
    EXPECT_EQ(passwd().at(5), "/home/j2");
    EXPECT_EQ(text(host_.os(), IC::property::createUser), "");
    EXPECT_EQ(host_.received, Lines());
}

TEST_P(Methods, UserDelOfRootIsLeftToUserdel)
{
    EXPECT_EQ(host_.call("UserDel,UserName:CMPI_string:root").getStatus(), 1);
    EXPECT_EQ(host_.ran(), Lines{"/usr/sbin/userdel root 2>&1"});
    EXPECT_NE(machine::entry("/etc/passwd", "root"), Lines()); // its processes keep it
}

TEST_P(Methods, UserSetPasswordPassesThePasswordUnchanged)
{
    bool const readsStandardInput = succeeds("/usr/bin/passwd --help | grep -e --stdin");
    Recording const log;
    EXPECT_EQ(
        host_.call("UserSetPassword," + userName() + ",Password:CMPI_string:Zq7Wx9").getStatus(),
        0);
    EXPECT_EQ(host_.ran(),
              (Lines{"/usr/sbin/usermod -p Zq7Wx9 " + account_.user + " 2>&1",
                     "echo Zq7Wx9 | /usr/bin/passwd " + account_.user + " --stdin 2>&1"}));
    // A passwd without --stdin only prints an error, which is ignored.
    if (readsStandardInput)
        EXPECT_NE(shadow().at(1), "Zq7Wx9");
    else
        EXPECT_EQ(shadow().at(1), "Zq7Wx9");
    for (LogRecord const& record : log.records())
        EXPECT_EQ(record.text.find("Zq7Wx9"), std::string::npos) << record.text;
}

TEST_P(Methods, LocalGroupAddAndDelMakeAndRemoveAGroupAndItsNode)
{
    EXPECT_EQ(host_.call("LocalGroupAdd,GroupName:CMPI_string:crew").getStatus(), 0);
    EXPECT_EQ(host_.ran(), Lines{"/usr/sbin/groupadd crew 2>&1"});
    EXPECT_EQ(machine::entry("/etc/group", "crew").size(), 4U);
    EXPECT_TRUE(host_.hasReceived(IC::nodeType::group, "crew"));

    EXPECT_EQ(host_.call("LocalGroupDel,GroupName:CMPI_string:crew").getStatus(), 0);
    EXPECT_EQ(host_.ran(), Lines{"/usr/sbin/groupdel crew 2>&1"});
    EXPECT_EQ(machine::entry("/etc/group", "crew"), Lines());
    EXPECT_EQ(host_.plugin().find(IC::nodeType::group, "crew"), nullptr);
}

TEST_P(Methods, ChangeOneMembershipAndKeepTheOthers)
{
    ASSERT_TRUE(succeeds("/usr/sbin/groupadd crew"));
    std::string const rest =
        ",LocalGroupName:CMPI_string:crew,DomainAndMember:CMPI_string:" + account_.user;
    std::string const id = "/usr/bin/id \"" + account_.user + "\" 2>&1";

    EXPECT_EQ(host_.call("LocalGroupAddUser" + rest).getStatus(), 0);
    EXPECT_EQ(host_.ran(), (Lines{id, "/usr/sbin/usermod -G " + account_.groups + ",\"crew\" \"" +
                                          account_.user + "\" 2>&1"}));
    EXPECT_EQ(machine::entry("/etc/group", "crew").at(3), account_.user);
    EXPECT_EQ(text(host_.plugin().node(IC::nodeType::group, "crew"), IC::property::members),
              account_.user);

    EXPECT_EQ(host_.call("LocalGroupDelUser" + rest).getStatus(), 0);
    EXPECT_EQ(host_.ran(), (Lines{id, "/usr/sbin/usermod -G " + account_.groups + " \"" +
                                          account_.user + "\" 2>&1"}));
    EXPECT_EQ(machine::entry("/etc/group", "crew").at(3), "");
    EXPECT_EQ(text(host_.plugin().node(IC::nodeType::group, "crew"), IC::property::members), "");
}

TEST_P(Methods, LocalGroupAddUserOfAMissingUserFails)
{
    EXPECT_EQ(host_
                  .call("LocalGroupAddUser,LocalGroupName:CMPI_string:" + account_.user +
                        ",DomainAndMember:CMPI_string:nosuch")
                  .getStatus(),
              1);
    EXPECT_EQ(host_.ran(), Lines{"/usr/bin/id \"nosuch\" 2>&1"});
}

TEST_P(Methods, GetShadowingRunsNothingAndSucceeds)
{
    EXPECT_EQ(host_.call("GetShadowing").getStatus(), 0);
    EXPECT_EQ(host_.ran(), Lines());
    EXPECT_TRUE(host_.hasReceived(IC::nodeType::user, "root"));
}

TEST_P(Methods, PassValuesAsShellText)
{
    // Only the last command's errors are merged in, so the failure goes unnoticed, too.
    EXPECT_EQ(host_.call("UserDel,UserName:CMPI_string:nosuch;echo>/tmp/anything").getStatus(), 0);
    EXPECT_TRUE(std::filesystem::exists("/tmp/anything"));
}

class UserAdd : public testing::Test
{
protected:
    static std::string const call_;
    static std::string const chageLine_;

    static std::string useraddLine(char const* program)
    {
        return std::string(program) +
               " jdoe -c John\\ Doe -d /home/jdoe -m -s /bin/false 2>&1;echo rc=$? 2>&1";
    }

    static void expectAdded(HostedMachine const& host)
    {
        Lines const fields = machine::entry("/etc/passwd", "jdoe");
        ASSERT_EQ(fields.size(), 7U);
        EXPECT_EQ(fields[4], "John Doe");
        EXPECT_EQ(fields[5], "/home/jdoe");
        EXPECT_EQ(fields[6], "/bin/false");
        EXPECT_TRUE(std::filesystem::is_directory("/home/jdoe"));
        Lines const ageing = machine::entry("/etc/shadow", "jdoe");
        EXPECT_EQ(ageing.at(3), "2");
        EXPECT_EQ(ageing.at(7), "");
        EXPECT_TRUE(host.hasReceived(IC::nodeType::user, "jdoe"));
        EXPECT_TRUE(host.hasReceived(IC::nodeType::group, "root"));
        EXPECT_EQ(text(host.plugin().node(IC::nodeType::user, "jdoe"), IC::property::pwdMinDays),
                  "2");
        EXPECT_EQ(text(host.os(), IC::property::createUser), call_);
    }
};

std::string const UserAdd::call_ =
    "UserAdd,UserName:CMPI_string:jdoe,Comment:CMPI_string:John Doe,"
    "HomeDir:CMPI_string:/home/jdoe,ScriptPath:CMPI_string:/bin/false,"
    "daysMustKeepPassword:CMPI_uint32:2";
std::string const UserAdd::chageLine_ = "/usr/bin/chage -m 2 -E -1 jdoe 2>&1";

TEST_F(UserAdd, MakesTheAccountAndPublishesItsNode)
{
    HostedMachine host("plain");
    EXPECT_EQ(host.call(call_).getStatus(), 0);
    EXPECT_EQ(host.ran(), (Lines{useraddLine("/usr/sbin/useradd"), chageLine_}));
    expectAdded(host);
}

TEST_F(UserAdd, PublishesUsersBeforeGroups)
{
    HostedMachine host("plain");
    EXPECT_EQ(host.call(call_).getStatus(), 0);
    std::string const group = std::to_string(IC::nodeType::group);
    auto const firstGroup =
        std::find_if(host.received.begin(), host.received.end(),
                     [&](std::string const& node) { return node.rfind(group, 0) == 0; });
    EXPECT_EQ(Lines(host.received.begin(), firstGroup), (Lines{"46 root", "46 gerda", "46 jdoe"}));
}

TEST_F(UserAdd, SucceedsDespiteAWarning)
{
    HostedMachine host("plain");
    machine::write("/home/jdoe/letter", "kept");
    Recording const log;
    EXPECT_EQ(host.call(call_).getStatus(), 0);
    expectAdded(host);
    Lines const remarks = log.remarks();
    EXPECT_TRUE(std::any_of(remarks.begin(), remarks.end(), [](std::string const& text) {
        return text.rfind("outputBuffer: useradd: warning", 0) == 0;
    }));
}

TEST_F(UserAdd, OfAnExistingAccountFailsAndKeepsIt)
{
    HostedMachine host("plain");
    EXPECT_EQ(host.call("UserAdd,UserName:CMPI_string:gerda").getStatus(), 1);
    EXPECT_EQ(host.ran(), Lines{"/usr/sbin/useradd gerda 2>&1;echo rc=$? 2>&1"});
    EXPECT_EQ(machine::entry("/etc/passwd", "gerda").at(4), "Gerda Example,,,");
    EXPECT_EQ(host.received, Lines());
    EXPECT_EQ(text(host.os(), IC::property::createUser), "");
}

TEST_F(UserAdd, KeepsTheAccountIfChageRefusesTheExpiry)
{
    HostedMachine host("plain");
    EXPECT_EQ(
        host.call("UserAdd,UserName:CMPI_string:jdoe,daysExpireAfter:CMPI_uint32:soon").getStatus(),
        1);
    EXPECT_EQ(host.ran(), (Lines{"/usr/sbin/useradd jdoe 2>&1;echo rc=$? 2>&1",
                                 "/usr/bin/chage -I soon -E -1 jdoe 2>&1"}));
    EXPECT_NE(machine::entry("/etc/passwd", "jdoe"), Lines());
    EXPECT_EQ(host.received, Lines());
}

TEST_F(UserAdd, MakesNoUserGroupOnARedhatMachine)
{
    HostedMachine host("redhat");
    std::filesystem::rename("/usr/sbin/useradd", "/usr/sbin/useradd.real");
    machine::fake("/usr/sbin/useradd",
                  "[ \"$1\" = -n ] && shift\nexec /usr/sbin/useradd.real \"$@\"\n");
    EXPECT_EQ(host.call(call_).getStatus(), 0);
    EXPECT_EQ(host.ran(), (Lines{useraddLine("/usr/sbin/useradd -n"), chageLine_}));
    expectAdded(host);
}

TEST_F(UserAdd, FailsOnARedhatMachineWithoutTheOption)
{
    HostedMachine host("redhat");
    bool const known = succeeds("/usr/sbin/useradd -n -D");
    EXPECT_EQ(host.call(call_).getStatus(), known ? 0 : 1);
    EXPECT_EQ(host.ran().at(0), useraddLine("/usr/sbin/useradd -n"));
    EXPECT_EQ(machine::entry("/etc/passwd", "jdoe").empty(), !known);
    EXPECT_EQ(host.received.empty(), !known);
}

class Commands : public testing::Test
{
protected:
    IC::Error write(unsigned int id, unsigned int number)
    {
        return host_.write(id, IC::PropertyValue(IC::Number(number), true));
    }

    HostedMachine host_{"plain"};
};

TEST_F(Commands, RestartTheMachine)
{
    EXPECT_EQ(write(IC::property::requestedState, 9).getStatus(), 0);
    EXPECT_EQ(host_.ran(), Lines{"/sbin/shutdown -r now"});
    EXPECT_EQ(mihost::refusedPowerCommands(), Lines{"/sbin/shutdown -r now"});
    EXPECT_EQ(text(host_.os(), IC::property::requestedState), "9");
}

TEST_F(Commands, HaltTheMachine)
{
    EXPECT_EQ(write(IC::property::requestedState, 12).getStatus(), 0);
    EXPECT_EQ(host_.ran(), Lines{"/sbin/shutdown -h now"});
    EXPECT_EQ(mihost::refusedPowerCommands(), Lines{"/sbin/shutdown -h now"});
    EXPECT_EQ(text(host_.os(), IC::property::requestedState), "12");
}

TEST_F(Commands, ClearTheLogAndRemoveItsEntries)
{
    ASSERT_FALSE(host_.plugin().nodes(IC::nodeType::logEntry).empty());
    EXPECT_EQ(write(IC::property::clearLog, 9).getStatus(), 0);
    EXPECT_EQ(machine::read("/var/log/messages"), "");
    EXPECT_TRUE(host_.plugin().nodes(IC::nodeType::logEntry).empty());
}

TEST_F(Commands, RefreshUsersAndGroupsAddedByOthers)
{
    ASSERT_TRUE(succeeds("/usr/sbin/useradd jdoe && /usr/sbin/groupadd crew"));
    EXPECT_EQ(host_.plugin().find(IC::nodeType::user, "jdoe"), nullptr);
    EXPECT_EQ(write(IC::property::refresh, 0).getStatus(), 0);
    EXPECT_TRUE(host_.hasReceived(IC::nodeType::user, "jdoe"));
    EXPECT_TRUE(host_.hasReceived(IC::nodeType::group, "crew"));
    EXPECT_EQ(text(host_.os(), IC::property::refresh), "0");
}

} // namespace methods_test
