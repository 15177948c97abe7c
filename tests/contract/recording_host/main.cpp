// Some builds keep the plug-in loaded when it is closed, so each test runs in a process that has
// never loaded it.

#include "tests/support/OneByOne.h"

#include <gtest/gtest.h>

int main(int argc, char* argv[])
{
    testing::InitGoogleTest(&argc, argv);
    return runTestsOneByOne([] { return RUN_ALL_TESTS(); });
}
