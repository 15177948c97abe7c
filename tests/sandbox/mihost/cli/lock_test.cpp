// One mihost at a time changes the machine.

#include "mihost/cli/change/ChangeLock.h"
#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"
#include "tests/support/TerminalRun.h"

#include <optional>
#include <sys/wait.h>
#include <unistd.h>

namespace lock_test
{

using mihost::ChangeLock;

constexpr ChangeLock::Patience atOnce{std::chrono::milliseconds(0), std::chrono::milliseconds(0)};
constexpr char hash[] = "$6$saltsalt$hashhashhash";

class MihostLock : public testing::Test
{
protected:
    MihostLock()
    {
        machine::lay("small");
    }

    /** Holds the lock like another mihost during a change. */
    static ChangeLock lock()
    {
        return {mihost::changeLockFile, atOnce};
    }
};

TEST_F(MihostLock, IsNeededByEveryChange)
{
    ChangeLock const other = lock();
    std::string const shadow = machine::read("/etc/shadow");
    std::string const log = machine::read("/var/log/messages");
    for (Lines arguments :
         {Lines{"call", "LocalGroupAdd", "GroupName=crew"}, Lines{"clear-log"},
          Lines{"power", "halt"}, Lines{"set", "user:jdoe", "password", hash},
          Lines{"set", "user:jdoe", "inactive-time", "2030-01-01"},
          Lines{"set", "os", "create-user", "LocalGroupAdd,GroupName:CMPI_string:crew"},
          Lines{"set", "os", "clear-log", "9"}, Lines{"set", "os", "requested-state", "12"}}) {
        arguments.insert(arguments.begin(), {"--yes", "--lock-timeout", "0"});
        EXPECT_EQ(mihostRun(arguments),
                  failed(1, "waiting for the change lock: another mihost still holds it "
                            "(try again, or raise --lock-timeout; 'fuser "
                            "/run/mihost.lock' shows the process)"));
    }
    EXPECT_EQ(machine::entry("/etc/group", "crew"), Lines());
    EXPECT_EQ(machine::read("/etc/shadow"), shadow);
    EXPECT_EQ(machine::read("/var/log/messages"), log);
}

TEST_F(MihostLock, IsNotNeededForReadsOrChangesInMemory)
{
    ChangeLock const other = lock();
    for (Lines arguments :
         {Lines{"get", "user:jdoe"}, Lines{"tree"}, Lines{"refresh"},
          Lines{"set", "user:jdoe", "full-name", "J. Doe"}, Lines{"set", "os", "refresh", "0"}}) {
        arguments.insert(arguments.begin(), {"--lock-timeout", "0"});
        EXPECT_EQ(mihostRun(arguments).code, 0) << arguments[2];
    }
}

TEST_F(MihostLock, IsWaitedForWithAMessage)
{
    std::optional<ChangeLock> other(lock());
    TerminalRun run({"call", "LocalGroupAdd", "GroupName=crew"});
    run.waitFor("mihost: waiting for another mihost to finish its change");
    EXPECT_EQ(machine::entry("/etc/group", "crew"), Lines());
    other.reset();
    EXPECT_EQ(run.end(), 0);
    EXPECT_EQ(machine::entry("/etc/group", "crew").at(0), "crew");
}

TEST_F(MihostLock, IsReleasedBetweenTheLinesOfAScript)
{
    Outcome const outcome =
        mihostRun({"--lock-timeout", "0", "shell"}, "call LocalGroupAdd GroupName=one\n"
                                                    "call LocalGroupAdd GroupName=two\n");
    EXPECT_EQ(outcome.code, 0) << outcome.err;
    ChangeLock const free = lock();
}

TEST_F(MihostLock, KeepsEveryMembershipThatIsAddedAtTheSameTime)
{
    Lines const groups = {"ga", "gb", "gc", "gd", "ge", "gf"};
    for (std::string const& group : groups)
        machine::run("groupadd " + group);
    std::vector<pid_t> children;
    for (std::string const& group : groups) {
        pid_t const child = fork();
        if (child == 0)
            _exit(mihostRun({"call", "LocalGroupAddUser", "LocalGroupName=" + group,
                             "DomainAndMember=jdoe"})
                      .code);
        children.push_back(child);
    }
    for (pid_t const child : children) {
        int status = 0;
        waitpid(child, &status, 0);
        EXPECT_EQ(status, 0);
    }
    for (std::string const& group : groups)
        EXPECT_EQ(machine::entry("/etc/group", group).at(3), "jdoe") << group;
}

TEST_F(MihostLock, ReportsThatItNeedsRoot)
{
    Outcome const read = machine::mihostRunAsUser({"get", "os", "os-name"});
    EXPECT_EQ(read.code, 0) << read.err;
    EXPECT_EQ(machine::mihostRunAsUser({"call", "LocalGroupAdd", "GroupName=crew"}),
              failed(1, "cannot lock /run/mihost.lock: Permission denied (changes need root)"));
}

} // namespace lock_test
