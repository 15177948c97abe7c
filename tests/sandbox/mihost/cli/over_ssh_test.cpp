// `mihost --host`, by the real ssh and the real sshd, which is started for each connection.

#include "TestPaths.h"
#include "tests/sandbox/mihost/cli/Login.h"
#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"
#include "tests/support/TerminalRun.h"

#include <cstdlib>
#include <filesystem>

namespace over_ssh_test
{

namespace fs = std::filesystem;

/** The host "box" is this machine, reached without a network. */
class MihostRemote : public testing::Test
{
protected:
    MihostRemote()
    {
        machine::lay("plain");
        machine::writeIdRanges();
        machine::write("/etc/shadow", "root:*:19000:0:99999:7:::\njdoe:!:19000:0:99999:7:::\n",
                       0600);
        machine::write("/etc/group", "root:x:0:\njdoe:x:1000:\nsshd:x:105:\n");
        writeAccounts("/bin/sh");
        machine::fake("/usr/sbin/lsmod", "echo 'Module Size'\n");
        machine::write("/root/.ssh/config",
                       "Host box\n"
                       "  ProxyCommand /usr/sbin/sshd -i -f /etc/box.conf\n"
                       "  StrictHostKeyChecking no\n"
                       "  UserKnownHostsFile /dev/null\n"
                       "  LogLevel ERROR\n"
                       "  IdentityFile /root/.ssh/key\n",
                       0600);
        machine::write("/etc/box.conf", "HostKey /etc/box.key\n"
                                        "AuthorizedKeysFile /root/.ssh/key.pub\n"
                                        "StrictModes no\n"
                                        "UsePAM no\n"
                                        "PrintMotd no\n"
                                        "PrintLastLog no\n");
        for (char const* key : {"/etc/box.key", "/root/.ssh/key"})
            if (runToEnd({"/usr/bin/ssh-keygen", "-q", "-t", "ed25519", "-N", "", "-f", key})
                    .code != 0)
                throw std::runtime_error("no key can be made");
        machine::write("/root/.ssh/known_hosts", "box " + machine::read("/etc/box.key.pub"));
        fs::create_directories("/run/sshd");
        fs::remove("/usr/local/bin/mihost");
        fs::create_symlink(MIHOST_FILE, "/usr/local/bin/mihost");
    }

    static void writeAccounts(std::string const& shellOfRoot)
    {
        machine::write("/etc/passwd", "root:x:0:0:Super:/root:" + shellOfRoot +
                                          "\nsshd:x:105:65534::/run/sshd:/usr/sbin/nologin\n"
                                          "jdoe:x:1000:1000:J. Doe:/home/jdoe:/bin/sh\n");
    }

    /** Replaces the remote mihost by a program that prints each argument in brackets on a line. */
    static void printArgumentsThere()
    {
        fs::remove("/usr/local/bin/mihost");
        machine::fake("/usr/local/bin/mihost", "printf '<%s>\\n' \"$@\"\n");
    }
};

TEST_F(MihostRemote, PrintsWhatTheRemoteCommandPrints)
{
    for (Lines const& command : {Lines{"get", "os", "os-name"}, Lines{"list", "users"},
                                 Lines{"--json", "get", "user:jdoe"}}) {
        Lines words = {"--host", "box"};
        words.insert(words.end(), command.begin(), command.end());
        EXPECT_EQ(mihostRun(words), printed(mihostRun(command).out));
    }
}

TEST_F(MihostRemote, PassesErrorsAndTheExitStatusOn)
{
    Outcome const outcome = mihostRun({"-H", "root@box", "get", "user:jdeo"});
    EXPECT_EQ(outcome.code, 4);
    EXPECT_EQ(outcome.out, "");
    EXPECT_EQ(outcome.err, mihostRun({"get", "user:jdeo"}).err);
}

TEST_F(MihostRemote, PassesEveryArgumentOnUnchanged)
{
    printArgumentsThere();
    std::string bytes;
    for (int byte = 1; byte < 256; ++byte)
        bytes += static_cast<char>(byte);
    for (char const* shell : {"/bin/sh", "/bin/bash", "/usr/bin/fish", "/usr/bin/zsh"}) {
        writeAccounts(shell);
        Lines const values = {
            "",           "it's a \"$HOME\" `id` \\ \\\\ \\' ! !! * ~ # ; & | > x",
            "two\nlines", "~",
            "=ls",        bytes};
        Lines arguments = {"--host=box", "get", "os"};
        std::string expected = "<get>\n<os>\n";
        for (std::string const& value : values) {
            arguments.push_back(value);
            expected += "<" + value + ">\n";
        }
        EXPECT_EQ(mihostRun(arguments), printed(expected)) << shell;
    }
}

TEST_F(MihostRemote, KeepsASecretOnStandardInput)
{
    machine::record("/usr/bin/ssh");
    Outcome const outcome = mihostRun(
        {"--host", "box", "call", "UserSetPassword", "UserName=jdoe", "Password=-"}, "geheim42\n");
    EXPECT_EQ(outcome.code, 0) << outcome.err;
    EXPECT_TRUE(opens("jdoe", "geheim42"));
    auto const calls = machine::calls("/usr/bin/ssh");
    ASSERT_EQ(calls.size(), 1U);
    EXPECT_EQ(calls[0], (Lines{"-T", "--", "box",
                               "exec mihost call UserSetPassword 'UserName=jdoe' 'Password=-'"}));
}

TEST_F(MihostRemote, RunsAScriptFromStandardInput)
{
    Outcome const outcome = mihostRun({"--host", "box", "shell"}, "get os 108\nget nothing\n");
    EXPECT_EQ(outcome.code, 4);
    EXPECT_EQ(outcome.out, "108 os-name  Linux\n");
    EXPECT_TRUE(holds(outcome.err, "line 2: "));
}

TEST_F(MihostRemote, AsksAtTheTerminalWithoutAnEcho)
{
    TerminalRun run({"--host", "box", "call", "UserSetPassword", "UserName=jdoe", "Password=-"});
    run.waitFor("Password: ");
    run.type("geheim42\n");
    EXPECT_EQ(run.end(), 0) << run.output();
    EXPECT_TRUE(opens("jdoe", "geheim42"));
    EXPECT_FALSE(holds(run.output(), "geheim42"));
    EXPECT_FALSE(holds(run.output(), "Connection to"));
}

TEST_F(MihostRemote, LeavesTheTerminalsInputIfOutputIsAFile)
{
    std::string const command = std::string(MIHOST_FILE) +
                                " --host box call UserSetPassword UserName=jdoe Password=- | cat";
    TerminalRun run({"-c", command}, 200, "/bin/bash");
    run.waitFor("standard input is empty");
    run.end();
    EXPECT_EQ(machine::entry("/etc/shadow", "jdoe").at(1), "!");
}

TEST_F(MihostRemote, EndsOnCtrlC)
{
    TerminalRun run({"--host", "box", "watch", "os", "os-name", "--interval", "1000"});
    run.waitFor("os-name  Linux");
    run.type("\x03");
    EXPECT_EQ(run.end(), 0);
}

TEST_F(MihostRemote, ExitsWith255IfSshCannotConnect)
{
    Outcome const outcome = mihostRun({"--host", "nowhere.invalid", "get", "os"});
    EXPECT_EQ(outcome.code, 255);
    EXPECT_TRUE(holds(outcome.err, "nowhere.invalid"));
}

TEST_F(MihostRemote, ReportsAMissingRemoteMihost)
{
    fs::remove("/usr/local/bin/mihost");
    if (fs::exists("/usr/bin/mihost"))
        GTEST_SKIP() << "mihost is installed here";
    Outcome const outcome = mihostRun({"--host", "box", "get", "os"});
    EXPECT_EQ(outcome.code, 127);
    EXPECT_TRUE(holds(outcome.err, "mihost"));
}

TEST_F(MihostRemote, NeedsSsh)
{
    setenv("PATH", "/nowhere", 1);
    EXPECT_EQ(mihostRun({"--host", "box", "get", "os"}),
              failed(2, "--host: cannot run ssh: No such file or directory (install "
                        "openssh-client)"));
}

TEST_F(MihostRemote, ChecksTheCommandBeforeItConnects)
{
    machine::record("/usr/bin/ssh");
    for (Lines const& words :
         {Lines{"--host", "-oProxyCommand=touch /tmp/run", "get", "os"}, Lines{"--host=", "get"},
          Lines{"--host", "box", "nonsense"}, Lines{"--host", "box", "get"}})
        EXPECT_EQ(mihostRun(words).code, 2) << words[1];
    EXPECT_EQ(mihostRun({"shell"}, "--host box get os\n").code, 2);
    EXPECT_TRUE(machine::calls("/usr/bin/ssh").empty());
    EXPECT_FALSE(fs::exists("/tmp/run"));
}

} // namespace over_ssh_test
