// mihost with other programs: on either side of a pipe, and as a source of JSON.

#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"

namespace scripting_test
{

/** Runs a line in bash, where a pipe fails if anything in it does. */
Outcome bash(std::string const& line)
{
    return bashRun("set -o pipefail; " + line);
}

/** A machine whose texts have control characters, invalid UTF-8 and quotes. */
void makeMachineOfOddTexts(int users = 3, std::string const& names = "李明")
{
    machine::lay("plain");
    std::string shadow = "root:*:19000:0:99999:7:::\n";
    std::string accounts = "root:x:0:0:\x1b[31m\xff \"quoted\" \\ back\t\x01:/:/bin/sh\n";
    for (int id = 1000; id < 1000 + users; ++id) {
        accounts += "user" + std::to_string(id) + ":x:" + std::to_string(id) + ":100:" + names +
                    std::to_string(id) + ":/:/bin/sh\n";
        shadow += "user" + std::to_string(id) + ":!:19000:0:99999:7:::\n";
    }
    machine::write("/etc/passwd", accounts);
    machine::write("/etc/shadow", shadow, 0600);
    machine::writeIdRanges();
    machine::write("/var/log/messages", "Jan  2 03:04:05 \x80 \"\x7f\" \xc0\xaf\x1b]0;x\x07\n");
}

TEST(MihostInAPipe, EndsQuietlyWhenItsReaderEnds)
{
    makeMachineOfOddTexts(70, std::string(1000, 'x')); // longer than a pipe has room for
    for (char const* arguments : {"tree", "--json tree", "tree --all", "list users", "get os",
                                  "methods --markdown", "--help", "doctor || true", "metrics",
                                  "shell < <(yes tree)", "watch os os-name --interval 0"}) {
        Outcome const outcome = bash("{ $mihost " + std::string(arguments) + "; } | head -c 1");
        EXPECT_EQ(outcome.code, 0) << arguments;
        EXPECT_EQ(outcome.err, "") << arguments;
        EXPECT_EQ(outcome.out.size(), 1U) << arguments;
    }
}

TEST(MihostInAPipe, EndsQuietlyWhenTheReaderOfItsMessagesEnds)
{
    makeMachineOfOddTexts();
    for (char const* arguments : {"--trace - tree", "--timing tree", "--trace - shell <<<tree"})
        EXPECT_EQ(
            bash("{ $mihost " + std::string(arguments) + " 2>&1 >/dev/null; } | head -c 1").code, 0)
            << arguments;
    // The exit code of an error is kept if its message cannot be written.
    EXPECT_EQ(bash("$mihost get nothing 2> >(true); exit $?").code, 4);
}

TEST(MihostInAPipe, ReportsThatItsOutputCannotBeWritten)
{
    makeMachineOfOddTexts();
    for (char const* arguments : {"tree", "--json list users", "get os 108", "--help", "--version",
                                  "doctor", "methods", "metrics", "shell <<<'get os 108'"}) {
        Outcome const outcome = bash("$mihost " + std::string(arguments) + " >/dev/full");
        EXPECT_EQ(outcome.code, 2) << arguments;
        EXPECT_TRUE(holds(outcome.err, "cannot write the output: No space left on device\n"));
    }
}

TEST(MihostOnAFullDisk, ReportsThatTheTraceWasCutShort)
{
    makeMachineOfOddTexts();
    Outcome const outcome =
        bash("mkdir /tmp/small && mount -t tmpfs -o size=16k none /tmp/small && "
             "$mihost --trace /tmp/small/trace get os 108");
    EXPECT_EQ(outcome.code, 2);
    EXPECT_EQ(outcome.out, "108 os-name  Linux\n"); // the trace does not change the result
    EXPECT_EQ(outcome.err,
              "mihost: cannot write the trace '/tmp/small/trace': No space left on device\n");
    EXPECT_EQ(bash("test $(stat -c %s /tmp/small/trace) -gt 8000").code, 0);
}

TEST(MihostJson, IsValidForJqWhateverTheSystemsTextsHold)
{
    makeMachineOfOddTexts();
    struct Reading {
        char const* arguments;
        char const* filter;
        char const* result;
    };
    for (Reading const& reading : std::initializer_list<Reading>{
             {"tree --all", "map(select(.kind == \"user\")) | length", "4"},
             {"tree user:root", ".[0].properties.\"full-name\".value",
              R"("\u001b[31m\\xff \"quoted\" \\ back\t\u0001")"},
             {"list users", ".[3].properties.\"full-name\".value", R"("李明1002")"},
             {"list groups", "map(.kind) | unique", R"(["group"])"},
             {"list drivers", "type", R"("array")"},
             {"list log", ".[0].kind", R"("log-entry")"},
             {"get log:1", ".kind", R"("log-entry")"},
             {"get user:root password", ".properties.password | [.value, .hidden]", "[null,true]"},
             {"set user:root full-name plain 2>/dev/null", "[.status, .changed]", "[0,false]"},
             {"call GetShadowing", ".",
              R"({"status":0,"changed":false,"changes":[],"warnings":[]})"},
             {"refresh", ".status", "0"},
             {"--yes clear-log", ".status", "0"},
             {"--yes power restart 2>/dev/null", ".status", "0"},
             {"watch os os-name --count 1", ".properties.\"os-name\".value", R"("Linux")"},
             {"shell <<<'get os 108'", ".properties.\"os-name\".kind", R"("text")"},
             {"doctor", "map(has(\"need\")) | all", "true"},
             {"version", "has(\"mihost\")", "true"},
             {"properties os", ".[0].kind", R"("os")"},
             {"properties", "length", "9"},
             {"methods", "length", "12"},
             {"methods UserDel", ".[0].method", R"("UserDel")"}}) {
        EXPECT_EQ(bash("{ $mihost --json " + std::string(reading.arguments) +
                       "; echo $? >/tmp/code; } | jq -c '" + reading.filter + "'"),
                  printed(std::string(reading.result) + "\n"));
    }
    for (char const* arguments :
         {"tree", "list users", "--timing tree 2>&1 >/dev/null", "--trace - tree 2>&1 >/dev/null"})
        EXPECT_EQ(bash("$mihost --json " + std::string(arguments) + " | jq empty").err, "")
            << arguments;
}

} // namespace scripting_test
