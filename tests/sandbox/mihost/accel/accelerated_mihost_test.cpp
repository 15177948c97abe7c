// mihost shows and logs the same with and without the accelerator.

#include "TestPaths.h"
#include "tests/support/KernelModules.h"
#include "tests/support/Machine.h"
#include "tests/support/Mihost.h"

#include <cstdlib>
#include <regex>

namespace accelerated_mihost_test
{

constexpr int moduleCount = 30;

/** A machine whose modules the real lsmod and modinfo know, with a log. */
class MihostAccel : public testing::Test
{
protected:
    MihostAccel()
    {
        machine::lay("plain");
        setenv("PATH", "/usr/sbin:/usr/bin", 1);
        std::vector<kernelModules::Loaded> loaded;
        for (int i = 0; i < moduleCount; ++i) {
            std::string const name = "module_" + std::to_string(i);
            Lines facts{"description=The one called " + name, "license=GPL",
                        "parm=debug:How much to say", "parmtype=debug:int"};
            if (i % 3 != 0)
                facts.push_back("version=1." + name);
            kernelModules::write("kernel/" + name + ".ko", kernelModules::file(facts));
            loaded.push_back({name, 4096L * i, i % 2, i > 0 ? Lines{"module_0"} : Lines{}});
        }
        loaded.push_back({"without_a_file", 1, 0, {}});
        kernelModules::index();
        kernelModules::load(loaded);
        std::string log;
        for (int i = 0; i < 120; ++i)
            log += "Jan  2 03:04:05 host daemon: line " + std::to_string(i) + '\n';
        machine::write("/var/log/messages", log + std::string(1000, 'x') + "\nshort\nno end");
    }
};

/** Without the time of the run, and that of the boot, which is computed from it. */
Lines traceLines(std::string const& file)
{
    static std::regex const moment(
        "(buffer|LastBootTime) = [A-Z][a-z]{2} [A-Z][a-z]{2} [ 0-9]{2} [0-9:]{8}");
    Lines lines = linesOf(machine::read(file));
    for (std::string& line : lines)
        line = std::regex_replace(line, moment, "$1 = TIME");
    return lines;
}

TEST_F(MihostAccel, ShowsAndTracesTheSameAsWithoutIt)
{
    Outcome const plain =
        mihostRun({"--trace", "/tmp/plain", "--json", "--timing", "--no-accel", "list", "drivers"});
    Outcome const fast = mihostRun({"--trace", "/tmp/fast", "--json", "list", "drivers"});
    EXPECT_EQ(plain.code, 0) << plain.err;
    EXPECT_EQ(fast.code, 0) << fast.err;
    EXPECT_EQ(fast.out, plain.out);
    EXPECT_FALSE(holds(plain.err, "answer"));
    EXPECT_EQ(Json::parse(fast.out).size(), moduleCount + 1U);
    Lines const expected = traceLines("/tmp/plain");
    EXPECT_GT(expected.size(), 5000U);
    Lines const found = traceLines("/tmp/fast");
    ASSERT_EQ(found.size(), expected.size());
    for (std::size_t line = 0; line < found.size(); ++line)
        ASSERT_EQ(found[line], expected[line]) << line;
}

TEST_F(MihostAccel, ShowsWithTimingHowEachCommandWasAnswered)
{
    Outcome const run = mihostRun({"--json", "--timing", "get", "os", "os-name"});
    Json answers;
    for (std::string const& line : linesOf(run.err))
        if (line.rfind("{\"timing\"", 0) == 0)
            answers = Json::parse(line).at("answers");
    std::map<std::string, std::pair<int, int>> counts;
    for (Json const& row : answers)
        counts[row.at("command")] = {row.at("answered"), row.at("run")};
    // Each of 50 entries has two properties that count the lines three times.
    EXPECT_EQ(counts["wc"], std::pair(1 + 50 * 2 * 3, 0));
    EXPECT_EQ(counts["sed"], std::pair(100, 0));
    EXPECT_EQ(counts["date"].first + counts["date"].second, 48);
    EXPECT_GE(counts["date"].first, 46); // run at first, and again if an hour began
    EXPECT_EQ(counts["lsmod"], std::pair(1, 0));
    EXPECT_EQ(counts["modinfo"], std::pair(moduleCount, 1));
}

TEST_F(MihostAccel, SaysWhyItRunsCommandsUnlessTurnedOff)
{
    std::vector<std::string> const command{"--timing", "list", "drivers", "--columns",
                                           "driver-name"};
    machine::fake("/usr/sbin/lsmod", "echo 'Module Size Used'\necho 'module_7 1 0'\n");
    Outcome run = mihostRun(command);
    EXPECT_TRUE(holds(run.out, "module_7"));
    EXPECT_FALSE(holds(run.out, "module_8"));
    char const* const reason = "lsmod                         0 answered      1 run: "
                               "the shell or the tool is a script\n";
    EXPECT_TRUE(holds(run.err, reason));
    machine::remove(ACCEL_FILE);
    run = mihostRun(command);
    EXPECT_EQ(run.code, 0);
    EXPECT_TRUE(holds(run.err, " run: libmiaccel.so.0: "));
    EXPECT_TRUE(holds(run.err, "\nall                           0 answered "));
    run = mihostRun({"--timing", "--no-accel", "get", "os", "os-name"});
    EXPECT_EQ(run.code, 0);
    EXPECT_FALSE(holds(run.err, "answered"));
}

} // namespace accelerated_mihost_test
