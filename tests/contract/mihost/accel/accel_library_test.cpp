// The built library, brought to a program in either of the two ways.

#include "TestPaths.h"
#include "tests/support/Program.h"
#include "tests/support/ScratchFolder.h"

#include <cstdlib>
#include <gtest/gtest.h>

namespace accel_library_test
{

using Words = std::vector<std::string>;

Words line(Words words, Words const& more)
{
    words.insert(words.end(), more.begin(), more.end());
    return words;
}

class AccelLibrary : public testing::Test
{
protected:
    ScratchFolder folder_;
    std::string log_ = folder_.write("log", "first\nsecond\n");
    Words commands_{"wc -l " + log_, "sed -n '2p' " + log_, "echo hi; exit 3",
                    "wc -c " + log_, "wc -l /nonexistent",  "modinfo no_such_module"};
    Outcome plain_ = runToEnd(line({PROBE_FILE}, commands_));
    std::string counts_ = "wc 1 1\nsed 1 0\ndate 0 0\nlsmod 0 0\nmodinfo 0 1\nother 0 2\n";
};

TEST_F(AccelLibrary, AnswersWhenLinked)
{
    ASSERT_EQ(plain_.out, "2 " + log_ + "\nsecond\nhi\n13 " + log_ + "\n");
    Outcome const run = runToEnd(line({ACCEL_PROBE_FILE}, commands_));
    EXPECT_EQ(run.out, plain_.out);
    EXPECT_EQ(run.err, plain_.err + counts_);
}

#if !defined(__SANITIZE_ADDRESS__) && !defined(__SANITIZE_THREAD__) // they want to be first
TEST_F(AccelLibrary, AnswersWhenPreloaded)
{
    setenv("LD_PRELOAD", ACCEL_FILE, 1);
    Outcome const run = runToEnd(line({PROBE_FILE}, commands_));
    EXPECT_EQ(run.out, plain_.out);
    EXPECT_EQ(run.err, plain_.err + counts_);
}

TEST_F(AccelLibrary, StepsAsideWhenPreloadedBesideAnotherLibrary)
{
    setenv("LD_PRELOAD", ACCEL_FILE ":libc.so.6", 1);
    Outcome const run = runToEnd({PROBE_FILE, "date"});
    EXPECT_NE(run.err.find("date 0 1\n"), std::string::npos) << run.err;
}
#endif

TEST(AccelLibraryFile, DefinesNothingButItsFaceAndTheTwoCalls)
{
    FILE* const stream =
        popen("nm --dynamic --defined-only --format=just-symbols " ACCEL_FILE " | sort", "r");
    std::string names;
    for (int character = fgetc(stream); character != EOF; character = fgetc(stream))
        names += static_cast<char>(character);
    pclose(stream);
    EXPECT_EQ(names, "miaccel_counts\nmiaccel_enable\npclose\npopen\n");
}

} // namespace accel_library_test
