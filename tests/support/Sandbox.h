#ifndef TESTS_SUPPORT_SANDBOX_H
#define TESTS_SUPPORT_SANDBOX_H

/**
 * Runs each of the program's tests in a copy of this machine, and lists them without one.
 *
 * Where no copy can be had every test is skipped with the reason, or, with MI_SANDBOX_REQUIRED=1
 * in the environment, the program fails.
 */
int runTestsInSandbox(int argc, char* argv[]);

/** Whether tests that cannot have a copy fail rather than being skipped. */
bool sandboxIsRequired();

#endif
