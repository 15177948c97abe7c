// Administration with the real tools: from the host's write to the account files, and to the nodes
// that the host receives.

#include "host/Properties.h"
#include "tests/support/Machine.h"
#include "tests/support/Plugin.h"
#include "tests/support/Recording.h"

#include <algorithm>
#include <cstdlib>
#include <filesystem>
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

    /** Writes a method-call text as a host does. @return the status */
    int call(std::string const& text)
    {
        received.clear();
        machine::forget();
        return os().setProperty(IC::property::createUser, {text, true}).getStatus();
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

    IC::MutableNode& user() const
    {
        return host_.plugin().node(IC::nodeType::user, account_.user);
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
    EXPECT_EQ(host_.call("UserDel," + userName()), 0);
    EXPECT_EQ(host_.ran(), Lines{"/usr/sbin/userdel " + account_.user + " 2>&1"});
    EXPECT_EQ(passwd(), Lines());
    EXPECT_EQ(shadow(), Lines());
    EXPECT_EQ(host_.plugin().find(IC::nodeType::user, account_.user), nullptr);
    EXPECT_FALSE(host_.hasReceived(IC::nodeType::user, account_.user));
    EXPECT_TRUE(host_.hasReceived(IC::nodeType::user, "root"));
    EXPECT_EQ(text(host_.os(), IC::property::createUser), "UserDel," + userName());
}

TEST_P(Methods, FailAndPublishNothingIfTheToolFails)
{
    struct Row {
        std::string call;
        std::string line;
    };
    for (Row const& row :
         {Row{"UserDel,UserName:CMPI_string:nosuch", "/usr/sbin/userdel nosuch 2>&1"},
          Row{"UserDel,UserName:CMPI_string:root", "/usr/sbin/userdel root 2>&1"},
          Row{"LocalGroupAddUser,LocalGroupName:CMPI_string:" + account_.user +
                  ",DomainAndMember:CMPI_string:nosuch",
              "/usr/bin/id \"nosuch\" 2>&1"},
          // No directory to move: usermod warns of that after it has changed the account.
          Row{"UserSetHomeDir," + userName() + ",HomeDir:CMPI_string:/home/j2",
              "/usr/sbin/usermod -d /home/j2 -m " + account_.user + " 2>&1"}}) {
        EXPECT_EQ(host_.call(row.call), 1) << row.call;
        EXPECT_EQ(host_.ran(), Lines{row.line});
        EXPECT_EQ(host_.received, Lines()) << row.call;
        EXPECT_EQ(text(host_.os(), IC::property::createUser), "") << row.call;
    }
    EXPECT_NE(machine::entry("/etc/passwd", "root"), Lines()); // its processes keep it
    EXPECT_EQ(passwd().at(5), "/home/j2");
}

TEST_P(Methods, UserSetAttribSetsTheAgeingAndRemovesTheExpiry)
{
    EXPECT_EQ(host_.call("UserSetAttrib," + userName() +
                         ",daysMustKeepPassword:CMPI_uint32:3,"
                         "daysMustChangePasswordAfter:CMPI_uint32:30,"
                         "daysWarnBeforePasswordExpire:CMPI_uint32:5,"
                         "daysExpireAfter:CMPI_uint32:6,"
                         "passwordExpirationDate:CMPI_dateTime:20301231000000.000000+000"),
              0);
    EXPECT_EQ(host_.ran(), Lines{"/usr/bin/chage " + account_.user +
                                 " -m 3 -M 30 -W 5 -I 6 -E 2030-12-31 2>&1"});
    Lines const fields = shadow();
    EXPECT_EQ(Lines(fields.begin() + 3, fields.end()), (Lines{"3", "30", "5", "6", "22279", ""}));
    IC::MutableNode const& node = user();
    EXPECT_EQ(text(node, IC::property::pwdMinDays), "3");
    EXPECT_EQ(text(node, IC::property::pwdMaxDays), "30");
    EXPECT_EQ(text(node, IC::property::pwdWarnDays), "5");

    EXPECT_EQ(host_.call("UserSetAttrib," + userName() + ",daysMustKeepPassword:CMPI_uint32:4"), 0);
    EXPECT_EQ(host_.ran(), Lines{"/usr/bin/chage " + account_.user + " -m 4 -E -1 2>&1"});
    EXPECT_EQ(shadow().at(3), "4");
    EXPECT_EQ(shadow().at(7), "");
}

TEST_P(Methods, SetNameShellAndHomeDirectory)
{
    struct Row {
        std::string method;
        std::string parameter;
        std::string options;
        std::size_t field; // of the account file
        unsigned int property;
        std::string value;
    };
    machine::write("/home/" + account_.user + "/letter", "kept");
    for (Row const& row : {Row{"UserSetFullName", "FullName", "-c John\\ \\ Smith", 4,
                               IC::property::fullName, "John  Smith"},
                           Row{"UserSetScriptPath", "ScriptPath", "-s /bin/false", 6,
                               IC::property::scriptPath, "/bin/false"},
                           Row{"UserSetHomeDir", "HomeDir", "-d /home/j2 -m", 5,
                               IC::property::homeDir, "/home/j2"}}) {
        EXPECT_EQ(host_.call(row.method + "," + userName() + "," + row.parameter +
                             ":CMPI_string:" + row.value),
                  0);
        EXPECT_EQ(host_.ran(),
                  Lines{"/usr/sbin/usermod " + row.options + " " + account_.user + " 2>&1"});
        EXPECT_EQ(passwd().at(row.field), row.value);
        EXPECT_EQ(text(user(), row.property), row.value);
    }
    EXPECT_EQ(machine::read("/home/j2/letter"), "kept");
    EXPECT_FALSE(std::filesystem::exists("/home/" + account_.user));
}

TEST_P(Methods, UserSetPasswordPassesThePasswordUnchanged)
{
    bool const readsStandardInput = succeeds("/usr/bin/passwd --help | grep -e --stdin");
    Recording const log;
    EXPECT_EQ(host_.call("UserSetPassword," + userName() + ",Password:CMPI_string:Zq7Wx9"), 0);
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
    EXPECT_EQ(host_.call("LocalGroupAdd,GroupName:CMPI_string:crew"), 0);
    EXPECT_EQ(host_.ran(), Lines{"/usr/sbin/groupadd crew 2>&1"});
    EXPECT_EQ(machine::entry("/etc/group", "crew").size(), 4U);
    EXPECT_TRUE(host_.hasReceived(IC::nodeType::group, "crew"));

    EXPECT_EQ(host_.call("LocalGroupDel,GroupName:CMPI_string:crew"), 0);
    EXPECT_EQ(host_.ran(), Lines{"/usr/sbin/groupdel crew 2>&1"});
    EXPECT_EQ(machine::entry("/etc/group", "crew"), Lines());
    EXPECT_EQ(host_.plugin().find(IC::nodeType::group, "crew"), nullptr);
}

TEST_P(Methods, ChangeOneMembershipAndKeepTheOthers)
{
    machine::run("/usr/sbin/groupadd crew");
    std::string const rest =
        ",LocalGroupName:CMPI_string:crew,DomainAndMember:CMPI_string:" + account_.user;
    std::string const id = "/usr/bin/id \"" + account_.user + "\" 2>&1";

    EXPECT_EQ(host_.call("LocalGroupAddUser" + rest), 0);
    EXPECT_EQ(host_.ran(), (Lines{id, "/usr/sbin/usermod -G " + account_.groups + ",\"crew\" \"" +
                                          account_.user + "\" 2>&1"}));
    EXPECT_EQ(machine::entry("/etc/group", "crew").at(3), account_.user);
    EXPECT_EQ(text(host_.plugin().node(IC::nodeType::group, "crew"), IC::property::members),
              account_.user);

    EXPECT_EQ(host_.call("LocalGroupDelUser" + rest), 0);
    EXPECT_EQ(host_.ran(), (Lines{id, "/usr/sbin/usermod -G " + account_.groups + " \"" +
                                          account_.user + "\" 2>&1"}));
    EXPECT_EQ(machine::entry("/etc/group", "crew").at(3), "");
    EXPECT_EQ(text(host_.plugin().node(IC::nodeType::group, "crew"), IC::property::members), "");
}

TEST_P(Methods, PassValuesAsShellText)
{
    // Only the last command's errors are merged in, so the failure goes unnoticed, too.
    EXPECT_EQ(host_.call("UserDel,UserName:CMPI_string:nosuch;echo>/tmp/anything"), 0);
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
    EXPECT_EQ(host.call(call_), 0);
    EXPECT_EQ(host.ran(), (Lines{useraddLine("/usr/sbin/useradd"), chageLine_}));
    expectAdded(host);
    Lines const users = {"46 root", "46 gerda", "46 jdoe"};
    ASSERT_GT(host.received.size(), users.size());
    EXPECT_EQ(Lines(host.received.begin(), host.received.begin() + 3), users);
    for (auto node = host.received.begin() + 3; node != host.received.end(); ++node)
        EXPECT_EQ(node->rfind("51 ", 0), 0U) << *node;
}

TEST_F(UserAdd, SucceedsDespiteAWarning)
{
    HostedMachine host("plain");
    machine::write("/home/jdoe/letter", "kept");
    Recording const log;
    EXPECT_EQ(host.call(call_), 0);
    expectAdded(host);
    Lines const remarks = log.remarks();
    EXPECT_TRUE(std::any_of(remarks.begin(), remarks.end(), [](std::string const& text) {
        return text.rfind("outputBuffer: useradd: warning", 0) == 0;
    }));
}

TEST_F(UserAdd, OfAnExistingAccountFailsAndKeepsIt)
{
    HostedMachine host("plain");
    EXPECT_EQ(host.call("UserAdd,UserName:CMPI_string:gerda"), 1);
    EXPECT_EQ(host.ran(), Lines{"/usr/sbin/useradd gerda 2>&1;echo rc=$? 2>&1"});
    EXPECT_EQ(machine::entry("/etc/passwd", "gerda").at(4), "Gerda Example,,,");
    EXPECT_EQ(host.received, Lines());
    EXPECT_EQ(text(host.os(), IC::property::createUser), "");
}

TEST_F(UserAdd, KeepsTheAccountIfChageRefusesTheExpiry)
{
    HostedMachine host("plain");
    EXPECT_EQ(host.call("UserAdd,UserName:CMPI_string:jdoe,daysExpireAfter:CMPI_uint32:soon"), 1);
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
    EXPECT_EQ(host.call(call_), 0);
    EXPECT_EQ(host.ran(), (Lines{useraddLine("/usr/sbin/useradd -n"), chageLine_}));
    expectAdded(host);
}

} // namespace methods_test
