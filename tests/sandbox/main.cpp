#include "tests/support/Sandbox.h"

int main(int argc, char* argv[])
{
    return runTestsInSandbox(argc, argv);
}
