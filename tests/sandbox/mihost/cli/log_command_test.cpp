// `mihost list log` with its own options.

#include "TestPaths.h"
#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"
#include "tests/support/TerminalRun.h"

#include <filesystem>
#include <fstream>

namespace log_command_test
{

namespace fs = std::filesystem;
constexpr char logFile[] = "/var/log/messages";

void append(std::string const& text)
{
    std::ofstream(logFile, std::ios::app) << text;
}

class MihostLog : public testing::Test
{
protected:
    MihostLog()
    {
        machine::lay("plain");
        machine::fake("/usr/sbin/lsmod", "echo 'Module Size'\n");
        machine::write(logFile, "Jun  1 01:00:00 box su: first\n"
                                "Jun  2 02:00:00 box sshd[7]: second\n"
                                "no-stamp-in-here: line\n"
                                "Jun  3 03:00:00 box sshd[8]: third\n");
    }

    /** For the plug-in, since a stamp has no year. */
    static void setYearTo2026()
    {
        machine::fake("/usr/bin/date", "echo 'Wed Jun 10 12:00:00 UTC 2026'\n");
    }

    /** The messages that are shown, newest first. */
    static Lines shown(Lines options)
    {
        options.insert(options.begin(), {"--no-accel", "list", "log", "--columns", "message"});
        Outcome const outcome = mihostRun(options);
        EXPECT_EQ(outcome.code, 0) << outcome.err;
        Lines lines = linesOf(outcome.out);
        if (!lines.empty())
            lines.erase(lines.begin()); // the heading
        return lines;
    }
};

TEST_F(MihostLog, ShowsMessagesWithoutTheAsterisksOfThePlugin)
{
    setYearTo2026();
    EXPECT_EQ(shown({}),
              (Lines{"box sshd[8]: third", ": line", "box sshd[7]: second", "box su: first"}));
    EXPECT_EQ(shown({"--full", "-n", "1"}), Lines{"*box sshd[8]: third*"});
    EXPECT_EQ(shown({"--no-hostname", "-n", "1"}), Lines{"sshd[8]: third"});
    Outcome const outcome = mihostRun({"--no-accel", "list", "log", "-n", "1"});
    EXPECT_TRUE(holds(outcome.out, "2026-06-03 03:00:00  box sshd[8]: third\n"));
}

TEST_F(MihostLog, ShowsOnlyTheNewestMatchingEntriesOfAPeriod)
{
    setYearTo2026();
    EXPECT_EQ(shown({"--since", "2026-06-02", "--until", "2026-06-02 02:00:00"}),
              Lines{"box sshd[7]: second"});
    EXPECT_EQ(shown({"-n", "2"}), (Lines{"box sshd[8]: third", ": line"}));
    EXPECT_EQ(shown({"--grep", "second|first", "-n", "1"}), Lines{"box sshd[7]: second"});
    EXPECT_EQ(shown({"--grep", "\\*"}), Lines()); // asterisks are not part of a message
    Json const nodes = mihostJson({"list", "log", "--grep", "third"});
    ASSERT_EQ(nodes.size(), 1U);
    EXPECT_EQ(nodes[0]["properties"]["message"]["value"], "*box sshd[8]: third*");
}

TEST_F(MihostLog, RefusesWrongValuesAndItsOptionsForOtherLists)
{
    struct Case {
        Lines arguments;
        std::string message;
    };
    for (Case const& each : {
             Case{{"users", "--since", "today"},
                  "list users: --since is an option of the log (use 'mihost list log')"},
             Case{{"drivers", "-n", "3"},
                  "list drivers: --lines is an option of the log (use 'mihost list log')"},
             Case{{"groups", "--follow"}, "list groups: --follow is an option of"},
             Case{{"log", "--since", "soon"}, "'soon' is not YYYY-MM-DD"},
             Case{{"log", "--grep", "a("}, "--grep: 'a(': "},
             Case{{"log", "-n", "many"}, "--lines: 'many' is not a whole number"},
             Case{{"log", "--follow", "-o", "csv"},
                  "list log: -o csv is not supported with --follow"},
             Case{{"log", "--follow", "--until", "now"}, "cannot be combined"},
         }) {
        Lines arguments = {"list"};
        arguments.insert(arguments.end(), each.arguments.begin(), each.arguments.end());
        Outcome const outcome = mihostRun(arguments);
        EXPECT_EQ(outcome.code, 2) << each.message;
        EXPECT_EQ(outcome.out, "");
        EXPECT_TRUE(holds(outcome.err, each.message));
    }
}

TEST_F(MihostLog, IsFollowedAcrossRotation)
{
    TerminalRun run({"list", "log", "--follow", "-n", "1"}, 200);
    run.waitFor("box sshd[8]: third\r\n");
    append("Jun  4 04:00:00 box su: fourth\n");
    run.waitFor("-06-04 04:00:00  box su: fourth\r\n");
    fs::rename(logFile, std::string(logFile) + ".1");
    append("Jun  5 05:00:00 box su: fifth\n");
    run.waitFor("-06-05 05:00:00  box su: fifth\r\n");
    fs::resize_file(logFile, 0);
    append("Jun  6 06:00:00 box su: 6\n");
    run.waitFor("box su: 6\r\n");
    run.type("\x03");
    EXPECT_EQ(run.end(), 0);
    EXPECT_FALSE(holds(run.output(), "second"));
}

TEST_F(MihostLog, IsFollowedInAPipeUntilItsReaderEnds)
{
    Outcome const outcome =
        runToEnd({"/bin/bash", "-c",
                  std::string(MIHOST_FILE) +
                      " --json list log --follow --grep sshd --no-hostname | head -n 2"});
    Lines const lines = linesOf(outcome.out);
    ASSERT_EQ(lines.size(), 2U) << outcome.err;
    EXPECT_EQ(Json::parse(lines[0])["message"], "sshd[7]: second");
    EXPECT_EQ(Json::parse(lines[1])["message"], "sshd[8]: third");
    EXPECT_TRUE(Json::parse(lines[1])["time"].is_number());
    EXPECT_EQ(outcome.err, "");
}

TEST_F(MihostLog, IsFollowedWithTheSameTextsAsThePlugins)
{
    std::string const stamp = "Jun  1 01:00:00 ";
    machine::write(logFile, "   " + stamp + "blanks before\n" + stamp + std::string(600, 'x') +
                                "\nshort\n\nFoo 99 1:2:3 odd stamp\n" + stamp +
                                "\x1b[31mcontrol\n");
    TerminalRun run({"list", "log", "--follow"}, 200);
    run.waitFor("control\r\n");
    run.type("\x03");
    run.end();
    for (std::string const& message : shown({}))
        EXPECT_TRUE(holds(run.output(), "  " + message + "\r\n")) << message;
}

TEST_F(MihostLog, IsFollowedFromMoreLinesThanTheTreeHas)
{
    std::string text;
    for (int number = 1; number <= 200; ++number)
        text += "Jun  4 04:00:00 box su: number " + std::to_string(number) + ".\n";
    append(text);
    TerminalRun run({"list", "log", "--follow", "-n", "150"}, 200);
    run.waitFor("number 200.\r\n");
    run.type("\x03");
    EXPECT_EQ(run.end(), 0);
    EXPECT_TRUE(holds(run.output(), "number 51."));
    EXPECT_FALSE(holds(run.output(), "number 50."));
}

TEST_F(MihostLog, CannotBeFollowedIfItIsMissing)
{
    machine::remove(logFile);
    EXPECT_EQ(mihostRun({"list", "log", "--follow"}),
              failed(1, "list log: /var/log/messages: No such file or directory (see "
                        "'mihost doctor')"));
}

} // namespace log_command_test
