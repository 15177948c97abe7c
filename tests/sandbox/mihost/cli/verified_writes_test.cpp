// The program verifies each change, and reports what differs from the request.

#include "TestPaths.h"
#include "mihost/sandbox/Sandbox.h"
#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"

#include <unistd.h>

namespace verified_writes_test
{

constexpr char hash[] = "$6$saltsalt$hashhashhash";
constexpr char silent[] = "exit 0\n";

/** A machine with jdoe, who is in the group crew and not in the group staff2. */
class VerifiedWrite : public testing::Test
{
protected:
    VerifiedWrite()
    {
        machine::lay("small");
        // Listed in its own group, too, since the plug-in's changes of members add that.
        machine::run("groupadd crew && groupadd staff2 && usermod -aG crew,jdoe jdoe");
        // The only kind of account that userdel finds by its UID.
        machine::write("/etc/passwd",
                       machine::read("/etc/passwd") + "1500:x:1500:100::/:/bin/sh\n");
    }

    /** Replaces the tools by programs that print nothing and do nothing. */
    static void makeToolsIdle()
    {
        for (char const* tool :
             {"useradd", "userdel", "usermod", "groupadd", "groupdel", "chpasswd"})
            machine::fake(std::string("/usr/sbin/") + tool, "exit 0\n");
        for (char const* tool : {"chage", "passwd"})
            machine::fake(std::string("/usr/bin/") + tool, "exit 0\n");
    }
};

struct Idle {
    Lines words;
    std::string problem;
};

TEST_F(VerifiedWrite, FailsIfTheToolsOfAMethodDidNothing)
{
    makeToolsIdle();
    for (Idle const& row : std::initializer_list<Idle>{
             {{"call", "UserAdd", "UserName=new"}, "account new is absent, not present"},
             {{"call", "UserDel", "UserName=jdoe"}, "account jdoe is present, not absent"},
             {{"call", "UserSetAttrib", "UserName=jdoe", "daysMustKeepPassword=3"},
              "minimum password age of jdoe is 0, not 3"},
             {{"call", "UserSetAttrib", "UserName=jdoe", "daysMustChangePasswordAfter=30"},
              "maximum password age of jdoe is 99999, not 30"},
             {{"call", "UserSetAttrib", "UserName=jdoe", "daysWarnBeforePasswordExpire=3"},
              "password warning of jdoe is 7, not 3"},
             {{"call", "UserSetAttrib", "UserName=jdoe", "daysExpireAfter=3"},
              "inactivity time of jdoe is none, not 3"},
             {{"call", "UserSetAttrib", "UserName=jdoe", "passwordExpirationDate=2030-01-02"},
              "account expiry of jdoe is never, not 2030-01-02"},
             {{"call", "UserSetFullName", "UserName=jdoe", "FullName=Joe Doe"},
              "full name of jdoe is J. Doe, not Joe Doe"},
             {{"call", "UserSetScriptPath", "UserName=jdoe", "ScriptPath=/bin/bash"},
              "login shell of jdoe is /bin/sh, not /bin/bash"},
             {{"call", "UserSetHomeDir", "UserName=jdoe", "HomeDir=/home/j2"},
              "home directory of jdoe is /home/jdoe, not /home/j2"},
             {{"call", "UserSetPassword", "UserName=jdoe", "Password=geheim42"},
              "password of jdoe is another one, not the given one"},
             {{"call", "UserSetScriptPath", "UserName=none", "ScriptPath=/bin/bash"},
              "login shell of none is unknown, not /bin/bash"},
             {{"call", "LocalGroupAdd", "GroupName=new"}, "group new is absent, not present"},
             {{"call", "LocalGroupDel", "GroupName=crew"}, "group crew is present, not absent"},
             {{"call", "LocalGroupAddUser", "LocalGroupName=staff2", "DomainAndMember=jdoe"},
              "membership of jdoe in staff2 is absent, not present"},
             {{"call", "LocalGroupDelUser", "LocalGroupName=crew", "DomainAndMember=jdoe"},
              "membership of jdoe in crew is present, not absent"}}) {
        Lines words = row.words;
        words.insert(words.begin(), "--json");
        Outcome const outcome = mihostRun(words);
        EXPECT_EQ(outcome.code, 1) << row.problem;
        EXPECT_EQ(outcome.err, "mihost: call " + words[2] + ": " + row.problem + "\n");
        Json const answer = Json::parse(outcome.out);
        EXPECT_EQ(answer["status"], 1) << row.problem;
        EXPECT_EQ(answer["changed"], false) << row.problem;
        EXPECT_EQ(answer["error"], row.problem);
    }
}

TEST_F(VerifiedWrite, FailsIfTheToolsOfAPropertyDidNothing)
{
    makeToolsIdle();
    for (Idle const& row : std::initializer_list<Idle>{
             {{"user:1500", "delete", "true"}, "set delete: account 1500 is present, not absent"},
             {{"user:jdoe", "password", hash},
              "set password: password hash of jdoe is another one, not the given one"},
             {{"os", "create-user", "UserDel,UserName:CMPI_string:jdoe"},
              "call UserDel: account jdoe is present, not absent"},
             {{"user:jdoe", "password-expiration", "2030-01-01"},
              "set password-expiration: password expiry of jdoe is never, not 2030-01-01"},
             {{"user:jdoe", "inactive-time", "2030-01-01"},
              "set inactive-time: inactivity of jdoe is never, not 2030-01-01"}}) {
        Lines words = {"--yes", "set"};
        words.insert(words.end(), row.words.begin(), row.words.end());
        Outcome const outcome = mihostRun(words);
        EXPECT_EQ(outcome.code, 1) << row.problem;
        EXPECT_EQ(linesOf(outcome.err).back(), "mihost: " + row.problem);
    }
}

TEST_F(VerifiedWrite, SucceedsIfEverythingIsAsRequested)
{
    for (Lines const& words : std::initializer_list<Lines>{
             {"call", "UserAdd", "UserName=new", "Comment=A B", "HomeDir=/home/new/",
              "ScriptPath=/bin/sh", "Password=geheim42", "daysMustKeepPassword=007",
              "daysMustChangePasswordAfter=30", "daysWarnBeforePasswordExpire=5",
              "daysExpireAfter=9", "passwordExpirationDate=2030-01-05"},
             {"call", "UserSetAttrib", "UserName=jdoe", "daysMustKeepPassword=3",
              "daysMustChangePasswordAfter=30", "daysWarnBeforePasswordExpire=5",
              "daysExpireAfter=9", "passwordExpirationDate=2030-01-05"},
             {"call", "UserSetFullName", "UserName=jdoe", "FullName=Joe Doe"},
             {"call", "UserSetScriptPath", "UserName=jdoe", "ScriptPath=/bin/bash"},
             {"call", "UserSetPassword", "UserName=jdoe", "Password=geheim42"},
             {"call", "LocalGroupAddUser", "LocalGroupName=staff2", "DomainAndMember=jdoe"},
             {"call", "LocalGroupDelUser", "LocalGroupName=crew", "DomainAndMember=jdoe"},
             {"call", "LocalGroupAdd", "GroupName=fresh"},
             {"call", "LocalGroupDel", "GroupName=fresh"},
             {"set", "user:jdoe", "password", hash},
             {"set", "user:jdoe", "password-expiration", "2031-01-31"},
             {"set", "user:jdoe", "inactive-time", "2031-02-28"},
             {"call", "UserDel", "UserName=new"}}) {
        Lines json = words;
        json.insert(json.begin(), "--json");
        Outcome const outcome = mihostRun(json);
        EXPECT_EQ(outcome.code, 0) << words[1] << ' ' << words[2] << ": " << outcome.err;
        EXPECT_EQ(Json::parse(outcome.out)["changed"], true) << words[1] << ' ' << words[2];
    }
}

TEST_F(VerifiedWrite, ReportsThatEverythingWasAsRequestedAlready)
{
    machine::run("usermod -p '" + std::string(hash) + "' jdoe");
    machine::run("chage -d \"$(date -u +%F)\" jdoe"); // as chpasswd writes it
    machine::write("/var/log/messages", "");
    struct Row {
        Lines words;
        char const* fact;
    };
    for (Row const& row : std::initializer_list<Row>{
             {{"call", "UserSetScriptPath", "UserName=jdoe", "ScriptPath=/bin/sh"},
              "login shell of jdoe is already /bin/sh"},
             {{"call", "UserSetAttrib", "UserName=jdoe", "daysMustKeepPassword=0",
               "daysWarnBeforePasswordExpire=7"},
              "minimum password age of jdoe is already 0, password warning of jdoe is already 7"},
             {{"call", "LocalGroupAddUser", "LocalGroupName=crew", "DomainAndMember=jdoe"},
              "membership of jdoe in crew is already present"},
             {{"call", "LocalGroupDelUser", "LocalGroupName=staff2", "DomainAndMember=jdoe"},
              "membership of jdoe in staff2 is already absent"},
             {{"set", "user:jdoe", "password", hash},
              "password hash of jdoe is already the given one"},
             {{"clear-log"}, "system log is already empty"}}) {
        Lines words = row.words;
        words.insert(words.begin(), "--yes");
        Outcome const outcome = mihostRun(words);
        EXPECT_EQ(outcome.code, 0) << row.fact;
        EXPECT_EQ(outcome.err, "mihost: nothing changed: " + std::string(row.fact) + "\n");
        Json const answer = mihostJson(words);
        EXPECT_EQ(answer["changed"], false) << row.fact;
        EXPECT_EQ(answer["status"], 0) << row.fact;
    }
}

TEST_F(VerifiedWrite, FailsToEndAMembershipOfThePrimaryGroup)
{
    machine::run("gpasswd -d jdoe crew >/dev/null && usermod -g crew jdoe");
    EXPECT_EQ(
        mihostRun({"call", "LocalGroupDelUser", "LocalGroupName=crew", "DomainAndMember=jdoe"}),
        failed(1, "call LocalGroupDelUser: membership of jdoe in crew is present, not absent"));
}

TEST_F(VerifiedWrite, FailsWithTheErrorMessageOfATool)
{
    machine::fake("/usr/bin/chage",
                  "echo 'chage: cannot open file' >&2\necho second >&2\nexit 1\n");
    Outcome const outcome =
        mihostRun({"--json", "set", "user:jdoe", "password-expiration", "2030-01-01"});
    EXPECT_EQ(outcome.code, 1);
    Json const answer = Json::parse(outcome.out);
    EXPECT_EQ(answer["error"],
              "password expiry of jdoe is never, not 2030-01-01; a command printed: "
              "chage: cannot open file");
    EXPECT_EQ(answer["warnings"].back(), "a command printed: second");
}

TEST_F(VerifiedWrite, FailsIfAToolFailsAlthoughTheChangeIsThere)
{
    machine::fake("/usr/sbin/userdel",
                  "sed -i /^1500:/d /etc/passwd\necho 'userdel: no home' >&2\nexit 12\n");
    Outcome const outcome = mihostRun({"--yes", "--json", "set", "user:1500", "delete", "true"});
    EXPECT_EQ(outcome.code, 1);
    Json const answer = Json::parse(outcome.out);
    EXPECT_EQ(answer["changed"], true);
    EXPECT_TRUE(holds(answer["error"], "exit status 12; a command printed: userdel: no home"));
}

TEST_F(VerifiedWrite, ReportsTheOutputOfASuccessfulTool)
{
    machine::fake("/usr/sbin/userdel", "sed -i /^1500:/d /etc/passwd\necho 'no mail' >&2\n");
    Outcome const outcome = mihostRun({"--yes", "--json", "set", "user:1500", "delete", "true"});
    EXPECT_EQ(outcome.code, 0);
    EXPECT_EQ(Json::parse(outcome.out)["warnings"], Json::array({"a command printed: no mail"}));
    EXPECT_EQ(outcome.err, "mihost: a command printed: no mail\n");
    machine::fake("/usr/sbin/useradd", "echo 'new:x:1600:100::/:/bin/sh' >>/etc/passwd\n"
                                       "echo 'new:!:20000:0:99999:7:::' >>/etc/shadow\n"
                                       "echo 'useradd: warning: home exists'\n");
    EXPECT_EQ(mihostRun({"call", "UserAdd", "UserName=new"}),
              failed(0, "a command printed: useradd: warning: home exists"));
}

TEST_F(VerifiedWrite, FailsIfTheLogCannotBeEmptied)
{
    machine::write("/var/log/messages", "Jan  2 03:04:05 line\n");
    ASSERT_EQ(chown("/var/log/messages", 65534, 65534), 0);
    Outcome const outcome =
        runToEnd({"/usr/bin/setpriv", "--inh-caps=-dac_override", "--bounding-set=-dac_override",
                  MIHOST_FILE, "--yes", "--json", "clear-log"});
    EXPECT_EQ(outcome.code, 1);
    EXPECT_EQ(outcome.err, "mihost: clear-log: system log is 21 bytes long, not empty\n");
    EXPECT_EQ(Json::parse(outcome.out)["changed"], false);
}

TEST_F(VerifiedWrite, FailsWithoutPrivilege)
{
    machine::write("/var/log/messages", "Jan  2 03:04:05 line\n");
    for (Lines const& words : {Lines{"clear-log"}, Lines{"power", "halt"},
                               Lines{"set", "user:jdoe", "password-expiration", "2030-01-01"}}) {
        Lines arguments = words;
        arguments.insert(arguments.begin(), "--yes");
        EXPECT_EQ(machine::mihostRunAsUser(arguments).code, 1) << words[0];
    }
    EXPECT_EQ(mihost::refusedPowerCommands(), Lines());
}

TEST_F(VerifiedWrite, FailsIfTheMachineRefusesToHalt)
{
    machine::fake("/sbin/shutdown", "echo 'must be root' >&2\nexit 1\n");
    Outcome const refused = mihostRun({"--yes", "--json", "power", "halt"});
    EXPECT_EQ(refused.code, 1);
    EXPECT_EQ(Json::parse(refused.out)["changed"], false);
    EXPECT_EQ(refused.err, "mihost: power halt: a command failed: '/sbin/shutdown -h now', exit "
                           "status 1; a command printed: must be root\n");
    machine::remove("/sbin/shutdown");
    Outcome const missing = mihostRun({"--yes", "power", "restart"});
    EXPECT_EQ(missing.code, 1);
    EXPECT_TRUE(holds(missing.err, "exit status 127; a command printed: "));
}

TEST_F(VerifiedWrite, FailsIfARefreshMissesAnAccount)
{
    // The plug-in reads no account after a line that is too long.
    machine::write("/etc/passwd", machine::read("/etc/passwd") +
                                      "long:x:1400:1400:" + std::string(5000, 'x') +
                                      ":/:/bin/sh\nlast:x:1500:1500::/:/bin/sh\n");
    EXPECT_EQ(mihostRun({"refresh"}),
              failed(1, "refresh: list of users is missing 'long', not complete"));
}

} // namespace verified_writes_test
