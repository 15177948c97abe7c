// Long tables and trees at a terminal, shown by the user's pager.

#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"
#include "tests/support/TerminalRun.h"

#include <cstdlib>
#include <filesystem>

namespace pager_test
{

constexpr char ctrlC[] = "\x03";

class MihostPager : public testing::Test
{
protected:
    MihostPager()
    {
        setenv("LC_ALL", "C.UTF-8", 1);
        for (char const* name :
             {"PAGER", "LESS", "LESSSECURE", "SUDO_UID", "DOAS_USER", "PKEXEC_UID", "NO_COLOR"})
            unsetenv(name);
        setenv("MIHOST_PAGER", "cat >/tmp/paged", 1);
        machine::lay("plain");
        machine::fake("/usr/sbin/lsmod", "echo 'Module Size'\n");
        machine::write("/etc/group", "root:x:0:\n");
        writeAccounts(30);
    }

    static void writeAccounts(int count)
    {
        std::string accounts = "root:x:0:0::/:/bin/sh\n";
        for (int id = 1000; id < 1000 + count; ++id)
            accounts += "u" + std::to_string(id) + ":x:" + std::to_string(id) +
                        ":100:Account:/home:/bin/sh\n";
        machine::write("/etc/passwd", accounts);
    }

    static bool wasPaged()
    {
        return std::filesystem::exists("/tmp/paged");
    }

    /** Runs mihost at a terminal and expects success. @return what the terminal shows */
    static std::string shown(Lines const& arguments = {"list", "users"},
                             unsigned short columns = 80)
    {
        Outcome const outcome = atTerminal(arguments, columns);
        EXPECT_EQ(outcome.code, 0);
        return outcome.out;
    }
};

TEST_F(MihostPager, ShowsOutputThatDoesNotFitTheTerminal)
{
    EXPECT_FALSE(holds(shown(), "u1029"));
    EXPECT_TRUE(holds(machine::read("/tmp/paged"), "u1029"));
    shown({"tree"});
    EXPECT_TRUE(holds(machine::read("/tmp/paged"), "\x1b[32muser:u1029\x1b[0m"));
}

TEST_F(MihostPager, IsNotUsedIfOutputFitsOrIsNotForPeople)
{
    for (Lines const& arguments :
         {Lines{"list", "users", "--no-pager"}, Lines{"list", "users", "-o", "csv"},
          Lines{"--json", "tree"}, Lines{"list", "groups"}}) {
        shown(arguments);
        EXPECT_FALSE(wasPaged()) << arguments[0];
    }
    mihostRun({"list", "users"}); // standard output is not a terminal
    EXPECT_FALSE(wasPaged());
    for (char const* none : {"cat", ""}) {
        setenv("MIHOST_PAGER", none, 1);
        EXPECT_TRUE(holds(shown(), "u1029")) << none;
    }
}

TEST_F(MihostPager, CountsTheLinesThatTheTerminalWraps)
{
    writeAccounts(12); // lines wider than the terminal: two of its lines each
    shown({"list", "users", "--full"}, 80);
    EXPECT_FALSE(wasPaged());
    shown({"list", "users", "--full"}, 40);
    EXPECT_TRUE(wasPaged());
}

TEST_F(MihostPager, ComesFromPagerUnlessMihostPagerIsSet)
{
    setenv("PAGER", "cat >/tmp/other", 1);
    shown();
    EXPECT_TRUE(wasPaged());
    unsetenv("MIHOST_PAGER");
    TerminalRun other({"/bin/sh", "-c", "unset MIHOST_PAGER; exec \"$0\" list users", MIHOST_FILE},
                      80, "/usr/bin/env");
    other.end();
    EXPECT_TRUE(holds(machine::read("/tmp/other"), "u1029"));
}

TEST_F(MihostPager, ReceivesTheUsersLocaleAndOptionsForLess)
{
    setenv("MIHOST_PAGER", "echo \"$LC_ALL $LESS ${LESSSECURE-none}\" >/tmp/seen; cat >/dev/null",
           1);
    shown();
    EXPECT_EQ(machine::read("/tmp/seen"), "C.UTF-8 FRX none\n");
    setenv("LESS", "S", 1);
    for (char const* caller : {"SUDO_UID", "DOAS_USER", "PKEXEC_UID"}) {
        setenv(caller, "1000", 1);
        shown();
        unsetenv(caller);
        EXPECT_EQ(machine::read("/tmp/seen"), "C.UTF-8 S 1\n") << caller;
        machine::remove("/tmp/seen");
    }
}

TEST_F(MihostPager, MayEndBeforeItReadsEverything)
{
    writeAccounts(2000); // more than fits into a pipe
    setenv("MIHOST_PAGER", "head -n 1", 1);
    std::string const text = shown();
    EXPECT_TRUE(holds(text, "user-name"));
    EXPECT_FALSE(holds(text, "u1000"));
}

TEST_F(MihostPager, CanBeLessAndRestoresTheTerminal)
{
    setenv("MIHOST_PAGER", "less", 1);
    writeAccounts(300);
    TerminalRun run({"list", "users"});
    run.waitFor("u1010");
    run.type("G");
    run.waitFor("u1299");
    run.type("q");
    EXPECT_EQ(run.end(), 0);
    EXPECT_TRUE(run.showsInput());
}

TEST_F(MihostPager, IsTheOnlyOneToReceiveCtrlC)
{
    setenv("MIHOST_PAGER",
           "trap '' INT; cat >/dev/null; echo ready; read word </dev/tty; echo got $word", 1);
    TerminalRun run({"list", "users"});
    run.waitFor("ready");
    run.type(ctrlC);
    run.waitFor("^C");
    run.type("it\n");
    run.waitFor("got it");
    EXPECT_EQ(run.end(), 0);
}

TEST_F(MihostPager, RestoresTheTerminalWhenItIsKilled)
{
    setenv("MIHOST_PAGER", "stty -echo -icanon </dev/tty; kill -9 $$", 1);
    TerminalRun run({"list", "users"});
    EXPECT_EQ(run.end(), 0);
    EXPECT_TRUE(run.showsInput());
}

TEST_F(MihostPager, IsReportedIfItCannotBeRunAndNothingIsLost)
{
    setenv("MIHOST_PAGER", "no-such-pager", 1);
    std::string const text = shown();
    EXPECT_TRUE(holds(text, "mihost: showing the output in 'no-such-pager': cannot run it"));
    EXPECT_TRUE(holds(text, "u1029"));
}

TEST_F(MihostPager, KeepsTheExitCodeOfTheCommand)
{
    setenv("MIHOST_PAGER", "cat >/dev/null; exit 5", 1);
    shown();
    EXPECT_EQ(atTerminal({"list", "users", "--sort", "none"}).code, 4);
}

} // namespace pager_test
