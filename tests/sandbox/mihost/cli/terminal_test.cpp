// The program at a terminal: output, input and interrupts.

#include "mihost/cli/output/DisplayWidth.h"
#include "mihost/sandbox/Sandbox.h"
#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"
#include "tests/support/TerminalRun.h"

#include <algorithm>
#include <clocale>
#include <crypt.h>
#include <csignal>
#include <cstdlib>
#include <filesystem>

namespace terminal_test
{

constexpr char prompt[] = "mihost> ";
constexpr char ctrlC[] = "\x03";
constexpr char ctrlD[] = "\x04";
constexpr char ctrlZ[] = "\x1a";
constexpr char up[] = "\x1b[A";

class MihostTerminal : public testing::Test
{
protected:
    MihostTerminal()
    {
        setenv("LC_ALL", "C.UTF-8", 1);
        std::setlocale(LC_CTYPE, "C.UTF-8");
        setenv("TMPDIR", "/tmp/private", 1);
        unsetenv("NO_COLOR");
        std::filesystem::create_directory("/tmp/private");
        machine::lay("small");
    }

    static bool nothingIsLeft()
    {
        return std::filesystem::is_empty("/tmp/private");
    }

    /** Replaces userdel by a program that waits until letToolGo is called. */
    static void makeToolWait()
    {
        machine::fake("/usr/sbin/userdel", "echo begun >/dev/tty; read go </tmp/go; "
                                           "echo done >/tmp/done\n");
        machine::run("mkfifo /tmp/go");
    }

    static void letToolGo()
    {
        machine::write("/tmp/answer", "go\n");
        machine::run("cat /tmp/answer >/tmp/go");
    }
};

/** mihost's own shell. */
class Shell : public TerminalRun
{
public:
    Shell() : TerminalRun({"shell"}) {}

    /** Types a line at the next prompt. @return what is printed up to the end of the text */
    std::string enter(std::string const& line, std::string const& text)
    {
        waitFor(prompt);
        type(line + "\n");
        return waitFor(text);
    }

    /** Types Ctrl-D at the next prompt: at another time it ends a line rather than the input. */
    int leave()
    {
        waitFor(prompt);
        type(ctrlD);
        return end();
    }
};

constexpr char osName[] = "108 os-name  Linux";

/** The lines of a terminal's stream, without sequences for cursor and colours. */
Lines plainLines(std::string const& text)
{
    Lines lines(1);
    for (std::size_t at = 0; at < text.size(); ++at) {
        if (text[at] == '\x1b') {
            at = text.find_first_of("mKJH", at);
        } else if (text[at] == '\n') {
            lines.emplace_back();
        } else if (text[at] != '\r') {
            lines.back() += text[at];
        }
    }
    return lines;
}

std::size_t widest(Lines const& lines)
{
    std::size_t width = 0;
    for (std::string const& line : lines)
        width = std::max(width, mihost::displayWidth(line));
    return width;
}

TEST_F(MihostTerminal, ShowsThePhaseOfTheStartAndHowFarItIs)
{
    machine::fake("/usr/sbin/lsmod", "echo ran >>/tmp/lsmod\necho 'Module Size'\n"
                                     "echo 'ext4 1'\necho 'xfs 1'\n");
    TerminalRun run({"get", "os", "108"});
    for (char const* step :
         {"starting: operating system", "starting: drivers", "drivers 1", "drivers 2",
          "starting: users", "users 2", "groups 2/2", "log entries 2/2"})
        run.waitFor(step);
    run.waitFor("\r\x1b[K"); // and clears it
    run.waitFor("108 os-name  Linux");
    EXPECT_EQ(run.end(), 0);
    EXPECT_EQ(machine::read("/tmp/lsmod"), "ran\n"); // by the plug-in alone
}

TEST_F(MihostTerminal, HasNoProgressIfDumbAndAsciiLinesInC)
{
    setenv("TERM", "dumb", 1);
    EXPECT_EQ(atTerminal({"get", "os", "108"}), printed("108 os-name  Linux\r\n"));
    setenv("LC_ALL", "C", 1);
    EXPECT_TRUE(holds(mihostRun({"tree"}).out, "\n`-root #2 "));
}

TEST_F(MihostTerminal, HasColoursUnlessTheyAreTurnedOff)
{
    auto const shown = [](Lines const& arguments) { return atTerminal(arguments).out; };
    std::string const coloured = "\x1b[32muser:jdoe\x1b[0m";
    EXPECT_TRUE(holds(shown({"tree"}), coloured));
    EXPECT_FALSE(holds(shown({"--color", "never", "tree"}), "\x1b[32m"));
    setenv("NO_COLOR", "1", 1);
    EXPECT_FALSE(holds(shown({"tree"}), "\x1b[32m"));
    EXPECT_TRUE(holds(shown({"tree"}), "user:jdoe #"));
    EXPECT_TRUE(holds(shown({"--color=always", "tree"}), coloured));
    unsetenv("NO_COLOR");
    EXPECT_TRUE(holds(mihostRun({"--color=always", "tree"}).out, coloured));
    EXPECT_FALSE(holds(mihostRun({"tree"}).out, "\x1b"));
}

TEST_F(MihostTerminal, WrapsTextAtItsWidthAndLosesNothing)
{
    machine::write("/etc/passwd",
                   "root:x:0:0::/:/bin/sh\njdoe:x:1000:1000:" + std::string(50, 'a') +
                       "李明李明李明李明李明李明李明李明" + ":/home/jdoe:/bin/sh\n");
    for (unsigned short const columns : std::initializer_list<unsigned short>{40, 80, 81, 82, 200})
        for (Lines const& arguments :
             {Lines{"tree"}, Lines{"list", "users"}, Lines{"list", "log"}}) {
            std::string const all = atTerminal(arguments, columns).out;
            std::string const shown = all.substr(all.rfind("\r\x1b[K"));
            Lines const lines = plainLines(shown);
            EXPECT_LE(widest(lines), columns) << arguments[0];
            std::string text;
            for (std::string const& line : lines)
                text += line.substr(std::min(line.size(), line.find_first_not_of("│ ")));
            bool const isWhole =
                holds(text, std::string(50, 'a') + "李明李明李明李明李明李明李明李明");
            EXPECT_EQ(isWhole, arguments.back() != "log") << columns << shown;
        }
    EXPECT_TRUE(holds(mihostRun({"list", "users"}).out, "李明李明李明李明李明李明李明李明"));
}

TEST_F(MihostTerminal, ShowsNoControlCharactersOfTheSystemsTexts)
{
    machine::write("/etc/passwd", "root:x:0:0:\x1b]0;title\x07\x1b[2J:/:/bin/sh\n");
    machine::write("/var/log/messages", "Jan  2 03:04:05 \x1b[31mred\x9b"
                                        "32m\n");
    for (Lines const& arguments : {Lines{"tree", "--all"}, Lines{"list", "users"},
                                   Lines{"list", "log"}, Lines{"get", "log:1"}}) {
        std::string const shown = atTerminal(arguments, 200).out;
        for (char const* control : {"\x1b]", "\x1b[2J", "\x1b[31m", "\x9b"})
            EXPECT_FALSE(holds(shown, control));
    }
}

TEST_F(MihostTerminal, AsksBeforeDangerousCommandsAndAcceptsNo)
{
    for (char const* answer : {"\n", "n\n", "no\n", "x\n"}) {
        TerminalRun run({"power", "halt"});
        run.waitFor("Really halt the machine? [y/N] ");
        run.type(answer);
        run.waitFor("mihost: power halt: not confirmed, so nothing was changed");
        EXPECT_EQ(run.end(), 2);
    }
    EXPECT_EQ(mihost::refusedPowerCommands(), Lines());
    TerminalRun run({"power", "halt"});
    run.waitFor("[y/N] ");
    run.type("y\n");
    EXPECT_EQ(run.end(), 0);
    EXPECT_EQ(mihost::refusedPowerCommands(), Lines{"/sbin/shutdown -h now"});
}

TEST_F(MihostTerminal, DoesNotEchoATypedPassword)
{
    machine::fake("/usr/bin/passwd", "exit 1\n");
    TerminalRun run({"call", "UserSetPassword", "UserName=jdoe", "Password=-"});
    run.waitFor("Password: ");
    EXPECT_FALSE(run.showsInput());
    run.type("geheim42\n");
    EXPECT_EQ(run.end(), 0);
    EXPECT_FALSE(holds(run.output(), "geheim42"));
    std::string const hash = machine::entry("/etc/shadow", "jdoe").at(1);
    EXPECT_EQ(hash, crypt("geheim42", hash.c_str()));
}

TEST_F(MihostTerminal, IsRestoredAfterCtrlCAtAPasswordPrompt)
{
    TerminalRun run({"call", "UserSetPassword", "UserName=jdoe", "Password=-"});
    run.waitFor("Password: ");
    run.type(ctrlC);
    EXPECT_EQ(run.end(), 128 + SIGINT);
    EXPECT_TRUE(run.showsInput());
    EXPECT_TRUE(nothingIsLeft());
}

TEST_F(MihostTerminal, IsRestoredAfterCtrlCDuringTheStart)
{
    machine::fake("/usr/sbin/modinfo", "echo asked >/dev/tty; exec sleep 1000\n");
    for (Lines const& arguments : {Lines{"tree"}, Lines{"--sandbox", "tree"}}) {
        TerminalRun run(arguments);
        run.dropNothingWithCtrlC();
        run.waitFor("drivers 1");
        run.waitFor("asked");
        run.type(ctrlC);
        EXPECT_EQ(run.end(), 128 + SIGINT);
        EXPECT_GT(run.output().rfind("\r\x1b[K"), run.output().rfind("starting: "));
        EXPECT_TRUE(run.showsInput());
        EXPECT_TRUE(nothingIsLeft());
        run.waitForDescendants();
    }
}

TEST_F(MihostTerminal, FinishesAChangeThatHasBegunBeforeCtrlCEndsIt)
{
    makeToolWait();
    TerminalRun run({"call", "UserDel", "UserName=jdoe"});
    run.waitFor("begun");
    run.type(ctrlC);
    run.waitFor("^C"); // shown once the signal is sent
    letToolGo();
    EXPECT_EQ(run.end(), 128 + SIGINT);
    EXPECT_EQ(machine::read("/tmp/done"), "done\n");
    EXPECT_TRUE(nothingIsLeft());
}

TEST_F(MihostTerminal, StopsAWatchOnCtrlC)
{
    TerminalRun run({"watch", "os", "os-name", "--interval", "1000"});
    run.waitFor("108 os-name  Linux");
    run.type(ctrlC);
    EXPECT_EQ(run.end(), 0);
    EXPECT_TRUE(nothingIsLeft());
}

TEST_F(MihostTerminal, EndsTheShellOnCtrlDDuringACommand)
{
    makeToolWait();
    Shell shell;
    shell.enter("call UserDel UserName=jdoe", "begun");
    shell.type(std::string("get os 108\n") + ctrlD);
    letToolGo();
    shell.waitFor(osName);
    EXPECT_EQ(shell.end(), 0);
    EXPECT_TRUE(shell.showsInput());
}

TEST_F(MihostTerminal, RemembersTheLinesOfShellsButNoPassword)
{
    setenv("HOME", "/tmp/home", 1);
    unsetenv("XDG_STATE_HOME");
    std::filesystem::create_directory("/tmp/home");
    std::string const history = "/tmp/home/.local/state/mihost/history";
    Shell first;
    first.enter("get os 108", osName);
    first.enter("call UserSetPassword UserName=nobody-here Password=geheim42",
                "mihost: call UserSetPassword");
    first.waitFor(prompt);
    first.type(up);
    EXPECT_FALSE(holds(first.waitFor("get os 108"), "geheim42"));
    first.type(ctrlC);
    EXPECT_EQ(first.leave(), 0);
    EXPECT_EQ(machine::read(history), "get os 108\n");

    Shell second;
    second.enter(up, osName);
    EXPECT_EQ(second.leave(), 0);
    EXPECT_EQ(machine::read(history), "get os 108\nget os 108\n");
    EXPECT_EQ(std::filesystem::status(history).permissions(),
              std::filesystem::perms::owner_read | std::filesystem::perms::owner_write);
}

TEST_F(MihostTerminal, DropsAShellsLineOnCtrlC)
{
    Shell shell;
    shell.waitFor(prompt);
    shell.type("power ha");
    shell.waitFor("a"); // of "ha"
    shell.type(ctrlC);
    shell.enter("get os 108", osName);
    shell.enter("get nothing", "mihost: no node 'nothing'");
    EXPECT_EQ(shell.leave(), 0);
    EXPECT_TRUE(shell.showsInput());
    EXPECT_TRUE(nothingIsLeft());
}

TEST_F(MihostTerminal, ReturnsToTheShellWhenCtrlCStopsAWatch)
{
    Shell shell;
    shell.enter("watch os os-name --interval 1000", osName);
    shell.type(ctrlC);
    shell.waitFor("^C\r\n");
    EXPECT_EQ(shell.leave(), 0);
}

TEST_F(MihostTerminal, RedrawsTheLineAfterTheShellWasStopped)
{
    Shell shell;
    shell.waitFor(prompt);
    shell.type("get os");
    shell.waitFor("get os");
    shell.type(ctrlZ);
    shell.waitForStop();
    EXPECT_TRUE(shell.showsInput());
    kill(shell.child(), SIGCONT);
    shell.waitFor("mihost> get os");
    EXPECT_FALSE(shell.showsInput()); // the editor shows it
    shell.type(" 108\n");
    shell.waitFor(osName);
    EXPECT_EQ(shell.leave(), 0);
}

TEST_F(MihostTerminal, CompletesCommandsNodesPropertiesAndMethods)
{
    machine::fake("/usr/sbin/userdel", "echo \"$@\" >/tmp/deleted\n");
    Shell shell;
    shell.enter("ge\tuser:j\tfull\t", "312 full-name  J. Doe");
    shell.enter("call UserDe\tUserN\tjd\t", "mihost: call UserDel");
    EXPECT_EQ(machine::read("/tmp/deleted"), "jdoe\n");
    shell.waitFor(prompt);
    shell.type("get user:\t"); // more than one: they are listed
    shell.waitFor("user:root  user:jdoe");
    shell.waitFor("get user:"); // and the line is shown again
    shell.type(ctrlC);
    EXPECT_EQ(shell.leave(), 0);
}

TEST_F(MihostTerminal, FollowsChangesOfItsSizeInTheShell)
{
    machine::write("/var/log/messages", "Jan  2 03:04:05 " + std::string(150, 'x') + "end\n");
    std::string const whole = std::string(150, 'x') + "end\r";
    Shell shell;
    shell.waitFor(prompt);
    shell.type("list log\n");
    EXPECT_FALSE(holds(shell.waitFor(prompt), whole));
    shell.resize(200);
    shell.type("list log\n");
    shell.waitFor(whole);
    EXPECT_EQ(shell.leave(), 0);
}

TEST_F(MihostTerminal, NamesTheSandboxInTheShellsPrompt)
{
    TerminalRun run({"--sandbox", "shell"});
    run.waitFor("mihost (sandbox)> ");
    run.type(ctrlD);
    EXPECT_EQ(run.end(), 0);
}

} // namespace terminal_test
