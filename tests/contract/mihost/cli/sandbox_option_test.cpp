// The --sandbox option: what it shows, and that the machine is unchanged.

#include "TestPaths.h"
#include "tests/contract/mihost/cli/NeedsSandbox.h"
#include "tests/support/Mihost.h"
#include "tests/support/ScratchFolder.h"

#include <filesystem>
#include <sys/stat.h>
#include <unistd.h>

namespace sandbox_option_test
{

/** Null if the file is not among the changes. */
Json changeOf(std::string const& file, Json const& answer)
{
    for (Json const& change : answer["changes"])
        if (change["file"] == file)
            return change;
    return Json();
}

/** Tests of the option itself need the privilege for it. */
class MihostSandbox : public NeedsSandbox
{
protected:
    std::string const plain_ = MACHINES_DIR "/plain";
};

TEST_F(MihostSandbox, ShowsCommandsOutputAndChangedLines)
{
    std::string const before = contentOf("/etc/passwd");
    Outcome const outcome =
        mihostRun({"--json", "--overlay", plain_, "call", "UserAdd", "UserName=sandboxed"});
    EXPECT_EQ(outcome.code, 0) << outcome.err;
    Json const answer = Json::parse(outcome.out);
    EXPECT_EQ(answer["status"], 0);
    ASSERT_EQ(answer["commands"].size(), 2U);
    EXPECT_EQ(answer["commands"][0]["command"], "/usr/sbin/useradd sandboxed 2>&1;echo rc=$? 2>&1");
    EXPECT_EQ(answer["commands"][0]["output"], "rc=0\n");
    Json const account = changeOf("/etc/passwd", answer);
    EXPECT_EQ(account["change"], "changed");
    EXPECT_EQ(account["removed"], Json::array());
    std::string const added = account["added"][0];
    EXPECT_EQ(added.substr(0, 12), "sandboxed:x:");
    EXPECT_EQ(contentOf("/etc/passwd"), before);
}

TEST_F(MihostSandbox, ShowsCreatedChangedAndRemovedFiles)
{
    ScratchFolder const machine;
    std::string const tool =
        machine.write("usr/sbin/groupadd", "#!/bin/sh\n"
                                           "mkdir -m 700 /home/new; echo x >/home/new/.profile\n"
                                           "chown -R 12:34 /home/new\n"
                                           "rm -r /srv/old; chmod 600 /etc/settings\n"
                                           "echo two >/etc/settings; : >/etc/.pwd.lock\n");
    std::filesystem::permissions(tool, std::filesystem::perms::owner_all);
    machine.write("srv/old/file", "");
    chmod(machine.write("etc/settings", "one\n").c_str(), 0644);
    Lines const call{"--overlay", machine.name(), "call", "LocalGroupAdd", "GroupName=g"};
    EXPECT_EQ(mihostRun(call).out, "ran  /usr/sbin/groupadd g 2>&1\n"
                                   "changed /etc/settings (mode 0644 -> 0600)\n"
                                   "created /home/new (directory, mode 0700, owner 12:34)\n"
                                   "created /home/new/.profile (mode 0600, owner 12:34)\n"
                                   "removed /srv/old (directory)\n"
                                   "removed /srv/old/file\n");
    Lines asJson = call;
    asJson.insert(asJson.begin(), {"--json", "--show-secrets"});
    Json const answer = Json::parse(mihostRun(asJson).out);
    EXPECT_EQ(changeOf("/etc/settings", answer).dump(),
              R"({"file":"/etc/settings","change":"changed","kind":"file","removed":["one"],)"
              R"("added":["two"],"mode":{"before":"0644","after":"0600"}})");
    EXPECT_EQ(changeOf("/home/new", answer)["owner"].dump(), R"({"before":null,"after":"12:34"})");
    EXPECT_EQ(changeOf("/srv/old/file", answer)["change"], "removed");
}

TEST_F(MihostSandbox, ShowsOnlyTheChangesOfEachWrite)
{
    Outcome const outcome =
        mihostRun({"--json", "--overlay", plain_, "shell"},
                  "call LocalGroupAdd GroupName=one\ncall LocalGroupAdd GroupName=two\n");
    Lines const answers = linesOf(outcome.out);
    ASSERT_EQ(answers.size(), 2U) << outcome.out << outcome.err;
    Json const added = changeOf("/etc/group", Json::parse(answers[1]))["added"];
    ASSERT_EQ(added.size(), 1U);
    EXPECT_EQ(added[0].get<std::string>().substr(0, 4), "two:");
}

TEST_F(MihostSandbox, HidesPasswordsInCommandsAndFiles)
{
    for (std::string const option : {"--json", "--yes"}) {
        Outcome const outcome = mihostRun({option, "--overlay", plain_, "call", "UserAdd",
                                           "UserName=sandboxed", "Password=geheim42"});
        EXPECT_EQ(outcome.code, 0);
        EXPECT_TRUE(holds(outcome.out, "-p (hidden)"));
        std::string const shown = outcome.out + outcome.err;
        for (char const* secret : {"geheim42", "$6$", "\\$6", "$y$", "\\$y"})
            EXPECT_FALSE(holds(shown, secret));
    }
}

TEST_F(MihostSandbox, ShowsTheBeginningOfALongOutput)
{
    ScratchFolder const machine;
    std::string const tool =
        machine.write("usr/sbin/groupadd", "#!/bin/sh\nyes out | head -c 8388608\n");
    std::filesystem::permissions(tool, std::filesystem::perms::owner_all);
    Outcome const outcome =
        mihostRun({"--json", "--overlay", machine.name(), "call", "LocalGroupAdd", "GroupName=g"});
    Json const answer = Json::parse(outcome.out);
    constexpr std::size_t kept = 1048576;
    std::string const output = answer["commands"][0]["output"];
    EXPECT_EQ(output.substr(kept - 4), "out\n... (7340032 more bytes)\n");
}

TEST_F(MihostSandbox, WritesTheTraceOutsideOfIt)
{
    ScratchFolder const folder;
    std::string const trace = folder.path("trace");
    EXPECT_EQ(mihostRun({"--sandbox", "--trace", trace, "tree"}).code, 0);
    EXPECT_TRUE(holds(contentOf(trace), "initialize: entry"));
}

TEST_F(MihostSandbox, LaysTheOverlaysFilesOverTheMachine)
{
    Outcome const outcome =
        mihostRun({"--overlay", MACHINES_DIR "/keyvalue", "get", "os", "os-name"});
    EXPECT_EQ(outcome.out, "108 os-name  Example Appliance\n");
}

TEST_F(MihostSandbox, HasTheExitCodeOfTheCommandInside)
{
    EXPECT_EQ(mihostRun({"--sandbox", "get", "none"}).code, 4);
    EXPECT_EQ(mihostRun({"--sandbox", "--plugin", "/nonexistent", "tree"}).code, 3);
}

TEST_F(MihostSandbox, NamesTheCapabilityThatRootLacks)
{
    EXPECT_EQ(
        runToEnd({"/usr/bin/setpriv", "--inh-caps=-sys_admin", "--bounding-set=-sys_admin",
                  MIHOST_FILE, "--sandbox", "version"}),
        failed(2, "creating the sandbox: cannot create a process namespace: Operation not "
                  "permitted (root lacks CAP_SYS_ADMIN: grant it to this container or service)"));
}

TEST(MihostWithoutTheSandbox, ReportsTheReason)
{
    Outcome const outcome = mihostRun({"--overlay", "/nonexistent", "tree"});
    EXPECT_EQ(outcome.code, 2);
    EXPECT_EQ(outcome.out, "");
    EXPECT_TRUE(startsWith(outcome.err, "mihost: creating the sandbox: "));
}

} // namespace sandbox_option_test
