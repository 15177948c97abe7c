// The built library, linked to a program or preloaded.

#include "TestPaths.h"
#include "tests/support/Mihost.h"
#include "tests/support/ScratchFolder.h"

#include <cstdlib>

namespace accel_library_test
{

class AccelLibrary : public testing::Test
{
protected:
    Outcome run(char const* probe) const
    {
        return runToEnd({probe, "wc -l " + log_, "sed -n '2p' " + log_, "echo hi; exit 3",
                         "wc -c " + log_, "wc -l /nonexistent", "modinfo no_such_module"});
    }

    void expectAnswers(Outcome const& outcome) const
    {
        EXPECT_EQ(outcome.out, "2 " + log_ + "\nsecond\nhi\n13 " + log_ + "\n");
        EXPECT_EQ(outcome.out, plain_.out);
        EXPECT_EQ(outcome.err, plain_.err + "wc 1 1\nsed 1 0\ndate 0 0\nlsmod 0 0\n"
                                            "modinfo 0 1\nother 0 2\n");
    }

    ScratchFolder const folder_;
    std::string const log_ = folder_.write("log", "first\nsecond\n");
    Outcome const plain_ = run(PROBE_FILE);
};

TEST_F(AccelLibrary, AnswersCommandsWhenLinked)
{
    expectAnswers(run(ACCEL_PROBE_FILE));
}

#if !defined(__SANITIZE_ADDRESS__) && !defined(__SANITIZE_THREAD__) // must be preloaded first
TEST_F(AccelLibrary, AnswersCommandsOnlyWhenPreloadedAlone)
{
    setenv("LD_PRELOAD", ACCEL_FILE, 1);
    expectAnswers(run(PROBE_FILE));
    setenv("LD_PRELOAD", ACCEL_FILE ":libc.so.6", 1);
    std::string const counts = run(PROBE_FILE).err;
    EXPECT_TRUE(holds(counts, "\nwc 0 2\nsed 0 1\n"));
}
#endif

TEST(AccelLibraryFile, ExportsOnlyItsInterfaceAndTheTwoCalls)
{
    EXPECT_EQ(runToEnd({"/usr/bin/nm", "--dynamic", "--defined-only", "--format=just-symbols",
                        ACCEL_FILE})
                  .out,
              "miaccel_counts\nmiaccel_enable\npclose\npopen\n");
}

} // namespace accel_library_test
