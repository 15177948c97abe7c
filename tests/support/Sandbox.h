#ifndef TESTS_SUPPORT_SANDBOX_H
#define TESTS_SUPPORT_SANDBOX_H

/**
 * Runs each of the program's tests in a copy of this machine; to list them it needs no copy.
 *
 * If no copy can be made, every test is skipped with the reason, or, with MI_SANDBOX_REQUIRED=1 in
 * the environment, the program fails.
 */
int runTestsInSandbox(int argc, char* argv[]);

/** @return whether tests without a copy must fail rather than be skipped */
bool sandboxIsRequired();

#endif
