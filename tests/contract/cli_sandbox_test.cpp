// The --sandbox option: what it shows, and that the machine stays as it is.

#include "tests/support/Lines.h"
#include "tests/support/Program.h"
#include "tests/support/ScratchFolder.h"

#include <cstdlib>
#include <filesystem>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>
#include <unistd.h>

namespace
{

using Json = nlohmann::ordered_json;

/** Tests of the option itself need the privilege for it. */
class MihostSandbox : public testing::Test
{
protected:
    void SetUp() override
    {
        Outcome const outcome = mihostRun({"--sandbox", "version"});
        char const* const required = std::getenv("MI_SANDBOX_REQUIRED");
        if (outcome.code != 0 && !(required && std::string(required) == "1"))
            GTEST_SKIP() << outcome.err;
        ASSERT_EQ(outcome.code, 0) << outcome.err;
    }

    std::string const plain_ = MACHINES_DIR "/plain";
};

TEST_F(MihostSandbox, ShowsTheCommandsTheirOutputAndTheLinesThatChanged)
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
    EXPECT_EQ(answer["changes"][0]["file"], "/etc/passwd");
    EXPECT_EQ(answer["changes"][0]["removed"], Json::array());
    std::string const added = answer["changes"][0]["added"][0];
    EXPECT_EQ(added.substr(0, 12), "sandboxed:x:");
    EXPECT_EQ(contentOf("/etc/passwd"), before);
}

TEST_F(MihostSandbox, ShowsTheSameToPeople)
{
    Outcome const outcome =
        mihostRun({"--overlay", plain_, "call", "LocalGroupAdd", "GroupName=sandboxed"});
    EXPECT_EQ(outcome.out.rfind(
                  "ran  /usr/sbin/groupadd sandboxed 2>&1\n/etc/group\n  + sandboxed:x:", 0),
              0U)
        << outcome.out;
}

TEST_F(MihostSandbox, HidesPasswordsInCommandsAndFiles)
{
    for (std::string const option : {"--json", "--yes"}) {
        Outcome const outcome = mihostRun({option, "--overlay", plain_, "call", "UserAdd",
                                           "UserName=sandboxed", "Password=geheim42"});
        EXPECT_EQ(outcome.code, 0);
        EXPECT_NE(outcome.out.find("-p (hidden)"), std::string::npos) << outcome.out;
        EXPECT_EQ((outcome.out + outcome.err).find("geheim42"), std::string::npos);
    }
}

TEST_F(MihostSandbox, ShowsTheBeginningOfALongOutputAndHowMuchFollowed)
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
    EXPECT_NE(contentOf(trace).find("initialize: entry"), std::string::npos);
}

TEST_F(MihostSandbox, LaysTheOverlaysFilesOverTheMachine)
{
    Outcome const outcome =
        mihostRun({"--overlay", MACHINES_DIR "/keyvalue", "get", "os", "os-name"});
    EXPECT_EQ(outcome.out, "108 os-name  Example Appliance\n");
}

TEST_F(MihostSandbox, ExitsAsTheCommandInsideDoes)
{
    EXPECT_EQ(mihostRun({"--sandbox", "get", "none"}).code, 4);
    EXPECT_EQ(mihostRun({"--sandbox", "--plugin", "/nonexistent", "tree"}).code, 3);
}

TEST(MihostWithoutTheSandbox, IsNeverSilent)
{
    Outcome const outcome = mihostRun({"--overlay", "/nonexistent", "tree"});
    EXPECT_EQ(outcome.code, 2);
    EXPECT_EQ(outcome.out, "");
    EXPECT_EQ(outcome.err.rfind("mihost: no sandbox, so nothing was run: ", 0), 0U) << outcome.err;
}

} // namespace
