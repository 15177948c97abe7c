// The shell without a terminal: scripts that drive one loaded plug-in.

#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"

namespace shell_test
{

class MihostScript : public testing::Test
{
protected:
    MihostScript()
    {
        machine::lay("plain");
        machine::fake("/usr/sbin/lsmod", "echo asked >>/tmp/asked\necho 'Module Size'\n");
    }
};

TEST_F(MihostScript, RunsItsLinesOnOneLoadedPlugin)
{
    EXPECT_EQ(mihostRun({"shell"}, "get os 108\n\n"
                                   "# a comment, then blanks and no line end\n"
                                   "   get   'os'  \"os-name\"   # and another"),
              printed("108 os-name  Linux\n108 os-name  Linux\n"));
    EXPECT_EQ(machine::read("/tmp/asked"), "asked\n");
}

TEST_F(MihostScript, ShowsInEachLineTheChangesOfEarlierOnes)
{
    Outcome const outcome = mihostRun({"shell"}, "call UserAdd UserName=jdoe 'Comment=J. Doe'\n"
                                                 "get user:jdoe full-name\n"
                                                 "call UserSetFullName UserName=jdoe FullName=J\n"
                                                 "get user:jdoe full-name\n");
    EXPECT_EQ(outcome.out, "312 full-name  J. Doe\n312 full-name  J\n") << outcome.err;
    EXPECT_EQ(outcome.code, 0);
}

TEST_F(MihostScript, EndsAtTheFirstLineThatFailsAndNamesIt)
{
    struct Script {
        char const* line;
        int code;
        char const* message;
    };
    for (Script const& script : std::initializer_list<Script>{
             {"get nothing", 4, "mihost: line 2: no node 'nothing' (use an id"},
             {"get os nothing", 4, "mihost: line 2: node 'os' has no property 'nothing'"},
             {"nonsense", 2, "mihost: line 2: "},
             {"get 'os", 2, "mihost: line 2: nothing follows the last '"},
             {"--sandbox get os", 2, "mihost: line 2: "},
             {"--plugin x.so get os", 2, "mihost: line 2: "},
             {"shell", 2, "mihost: line 2: "},
             {"call UserDel UserName=a;b", 2,
              "mihost: line 2: UserName contains the shell metacharacter ';'"},
             {"call UserDel UserName=nobody-here", 1, "mihost: line 2: call UserDel: the plug-in"},
             {"power halt", 2,
              "mihost: line 2: power halt: not a terminal (add --yes to halt the machine)"}}) {
        Outcome const outcome =
            mihostRun({"shell"}, "get os 108\n" + std::string(script.line) + "\nget os 108\n");
        EXPECT_EQ(outcome.code, script.code) << script.line;
        EXPECT_EQ(outcome.out, "108 os-name  Linux\n") << script.line;
        EXPECT_TRUE(startsWith(outcome.err, script.message));
        EXPECT_EQ(linesOf(outcome.err).size(), 1U) << outcome.err;
    }
}

TEST_F(MihostScript, ContinuesAfterFailuresOnRequest)
{
    Outcome const outcome =
        mihostRun({"shell", "--keep-going"},
                  "get nothing\nget os 108\ncall UserDel UserName=a;b\nget os 108\n");
    EXPECT_EQ(outcome.code, 4); // the first one's
    EXPECT_EQ(outcome.out, "108 os-name  Linux\n108 os-name  Linux\n");
    Lines const told = linesOf(outcome.err);
    ASSERT_EQ(told.size(), 2U);
    EXPECT_TRUE(startsWith(told[0], "mihost: line 1: "));
    EXPECT_TRUE(startsWith(told[1], "mihost: line 3: "));
}

TEST_F(MihostScript, MayBeEmptyAndEndsOnExitAndQuit)
{
    for (char const* script : {"", "\n\n# nothing\n", "exit\nget nothing\n", "quit\nget nothing\n"})
        EXPECT_EQ(mihostRun({"shell"}, script), printed(""));
}

TEST_F(MihostScript, PrintsOneJsonLineForEachCommand)
{
    Outcome const outcome = mihostRun({"--json", "shell", "--keep-going"},
                                      "get os 108\nlist users\nget nothing\nnonsense\nrefresh\n"
                                      "call UserAdd UserName=jdoe\nhelp get\nversion\ntree\n"
                                      "call UserDel UserName=nobody-here\n");
    Lines const lines = linesOf(outcome.out);
    ASSERT_EQ(lines.size(), 10U) << outcome.out;
    EXPECT_EQ(Json::parse(lines[0])["kind"], "os");
    EXPECT_TRUE(Json::parse(lines[1]).is_array());
    EXPECT_EQ(Json::parse(lines[2])["exit"], 4);
    EXPECT_TRUE(startsWith(Json::parse(lines[2])["error"].get<std::string>(), "line 3: no node"));
    EXPECT_EQ(Json::parse(lines[3])["exit"], 2);
    EXPECT_EQ(Json::parse(lines[4])["status"], 0);
    EXPECT_EQ(Json::parse(lines[5])["changed"], true);
    EXPECT_TRUE(startsWith(Json::parse(lines[6])["text"].get<std::string>(), "read properties"));
    EXPECT_TRUE(Json::parse(lines[7]).contains("plugin"));
    EXPECT_TRUE(Json::parse(lines[8]).is_array());
    EXPECT_EQ(Json::parse(lines[9])["status"], 1);
}

TEST_F(MihostScript, AppliesOptionsToOneLineOnly)
{
    Outcome const outcome = mihostRun({"shell"}, "--json get os 108\nget os 108\n");
    Lines const lines = linesOf(outcome.out);
    ASSERT_EQ(lines.size(), 2U);
    EXPECT_EQ(Json::parse(lines[0])["kind"], "os");
    EXPECT_EQ(lines[1], "108 os-name  Linux");
}

TEST_F(MihostScript, IsNeverReadForAPassword)
{
    EXPECT_EQ(mihostRun({"shell"}, "call UserSetPassword UserName=root Password=-\nget os 108\n"),
              failed(2, "line 1: Password cannot be read from standard input, which is "
                        "the script (write it in the script)"));
}

TEST_F(MihostScript, DoesNotStartIfThePluginCannotBeLoaded)
{
    Outcome const outcome = mihostRun({"--plugin", "/none.so", "shell"}, "get os 108\n");
    EXPECT_EQ(outcome.code, 3);
    EXPECT_EQ(outcome.out, "");
}

} // namespace shell_test
