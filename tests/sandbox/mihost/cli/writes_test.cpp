// Writes of the program change the machine, and those that it refuses do not.

#include "mihost/sandbox/Sandbox.h"
#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"

#include <algorithm>
#include <filesystem>

namespace writes_test
{

constexpr char hash[] = "$6$saltsalt$hashhashhash";

TEST(MihostCall, RunsTheMethodAndReportsAsJson)
{
    machine::lay("plain");
    machine::recordShell();
    Outcome const outcome =
        mihostRun({"--json", "call", "UserAdd", "UserName=jdoe", "Comment=John Smith"});
    EXPECT_EQ(outcome.code, 0);
    EXPECT_EQ(outcome.err, "");
    Json const answer = Json::parse(outcome.out);
    EXPECT_EQ(answer["status"], 0);
    EXPECT_EQ(answer["changed"], true);
    EXPECT_EQ(answer["warnings"], Json::array());
    EXPECT_EQ(answer["changes"][0]["file"], "/etc/passwd");
    EXPECT_EQ(machine::entry("/etc/passwd", "jdoe").at(4), "John Smith");
    Lines const ran = machine::ran();
    EXPECT_EQ(std::count(ran.begin(), ran.end(),
                         "/usr/sbin/useradd jdoe -c John\\ Smith 2>&1;echo rc=$? 2>&1"),
              1);
}

TEST(MihostCall, ExitsWith1AndShowsTheOutputOfAFailedCommand)
{
    machine::lay("plain");
    Outcome const outcome = mihostRun({"--json", "call", "UserDel", "UserName=nobody-here"});
    EXPECT_EQ(outcome.code, 1);
    std::string const error = "the plug-in returned status 1; a command printed: userdel: user "
                              "'nobody-here' does not exist";
    EXPECT_EQ(outcome.out, "{\"status\":1,\"changed\":false,\"changes\":[],\"warnings\":[],"
                           "\"error\":\"" +
                               error + "\"}\n");
    EXPECT_EQ(outcome.err, "mihost: call UserDel: " + error + "\n");
}

TEST(MihostSecrets, AreHiddenUnlessRequested)
{
    machine::lay("small");
    machine::run("usermod -p '" + std::string(hash) + "' jdoe");
    std::string const script = "call UserAdd UserName=new Password=geheim42\n";
    for (Lines const& arguments :
         {Lines{"tree", "--all"}, Lines{"--json", "tree"}, Lines{"--json", "list", "users"},
          Lines{"get", "user:jdoe"}, Lines{"--json", "get", "user:jdoe", "117"},
          Lines{"list", "users", "--columns", "user-name,password"}}) {
        Outcome const hidden = mihostRun(arguments);
        EXPECT_FALSE(holds(hidden.out, hash)) << arguments[0];
        EXPECT_TRUE(holds(hidden.out, "hidden")) << arguments[0];
        Lines told = arguments;
        told.emplace_back("--show-secrets");
        EXPECT_TRUE(holds(mihostRun(told).out, hash)) << arguments[0];
    }
    EXPECT_EQ(mihostJson({"get", "user:jdoe", "117"})["properties"]["password"].dump(),
              R"({"id":117,"kind":"text","flag":true,"value":null,"hidden":true})");
    // The node keeps the text of the last call.
    Outcome const kept = mihostRun({"shell"}, script + "get os 74\n--show-secrets get os 74\n");
    Lines const lines = linesOf(kept.out);
    ASSERT_EQ(lines.size(), 2U) << kept.out << kept.err;
    EXPECT_EQ(lines[0], " 74 create-user  (hidden)");
    EXPECT_EQ(lines[1], lines[0]); // a plain password never shows
}

TEST(MihostSet, SetsAHashButNoPlainPasswordFromStandardInput)
{
    machine::lay("small");
    Outcome const outcome = mihostRun({"set", "user:jdoe", "password", "-"}, "geheim42\n");
    EXPECT_EQ(outcome.code, 2);
    EXPECT_FALSE(holds(outcome.err, "geheim42"));
    EXPECT_EQ(machine::entry("/etc/shadow", "jdoe").at(1), "!");
    EXPECT_EQ(mihostRun({"set", "user:jdoe", "password", "-"}, std::string(hash) + "\n"),
              printed(""));
    EXPECT_EQ(machine::entry("/etc/shadow", "jdoe").at(1), hash);
}

TEST(MihostSet, DeletesAnAccountOnlyWithYes)
{
    machine::lay("small");
    // The only kind of account that userdel finds by its UID.
    machine::write("/etc/passwd", machine::read("/etc/passwd") + "1500:x:1500:1500::/:/bin/sh\n");
    machine::fake("/usr/sbin/userdel", "echo \"$@\" >/tmp/deleted\n"
                                       "sed -i /^1500:/d /etc/passwd\n");
    EXPECT_EQ(mihostRun({"set", "user:1500", "delete", "true"}),
              failed(2, "set delete: not a terminal (add --yes to delete the account 1500 "
                        "and its home directory)"));
    EXPECT_FALSE(std::filesystem::exists("/tmp/deleted"));
    EXPECT_EQ(mihostRun({"set", "user:1500", "delete", "false"}).code, 0);
    EXPECT_FALSE(std::filesystem::exists("/tmp/deleted"));
    EXPECT_EQ(mihostRun({"--yes", "set", "user:1500", "delete", "true"}).code, 0);
    EXPECT_EQ(machine::read("/tmp/deleted"), "-r 1500\n");
}

TEST(MihostRefresh, RebuildsUserAndGroupNodes)
{
    machine::lay("plain");
    machine::writeIdRanges();
    machine::write("/etc/passwd", "root:x:0:0::/root:/bin/sh\njdoe:x:1000:1000::/:/bin/sh\n");
    machine::write("/etc/group", "root:x:0:\ncrew:x:1000:\n");
    Outcome const outcome = mihostRun({"--trace", "/tmp/trace", "refresh"});
    EXPECT_EQ(outcome.out, "2 users, 2 groups\n");
    std::vector<std::string> seen;
    for (std::string const& line : linesOf(machine::read("/tmp/trace"))) {
        Json const record = Json::parse(line);
        if (record["op"] == "node-added" || record["op"] == "node-deleted")
            seen.push_back(record["op"].get<std::string>() + " " +
                           record["kind"].get<std::string>());
    }
    EXPECT_EQ(seen, (Lines{"node-deleted user", "node-deleted user", "node-added user",
                           "node-added user", "node-deleted group", "node-deleted group",
                           "node-added group", "node-added group"}));
}

TEST(MihostActions, ActOnTheMachineWithYes)
{
    machine::lay("plain");
    machine::write("/var/log/messages", "Jan  2 03:04:05 line\n");
    EXPECT_EQ(mihostRun({"--yes", "clear-log"}), printed("0 log entries\n"));
    EXPECT_EQ(machine::read("/var/log/messages"), "");
    Json const answer = mihostJson({"--yes", "power", "restart"});
    EXPECT_EQ(answer["status"], 0);
    EXPECT_EQ(answer["changed"], true);
    EXPECT_EQ(mihostRun({"--yes", "power", "halt"}).code, 0);
    EXPECT_EQ(mihost::refusedPowerCommands(),
              (Lines{"/sbin/shutdown -r now", "/sbin/shutdown -h now"}));
}

} // namespace writes_test
