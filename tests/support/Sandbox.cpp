#include "tests/support/Sandbox.h"

#include "mihost/sandbox/Sandbox.h"
#include "tests/support/OneByOne.h"

#include <cstdlib>
#include <gtest/gtest.h>
#include <iostream>

namespace
{

class SkipAll : public testing::EmptyTestEventListener
{
public:
    explicit SkipAll(std::string reason) : reason_(std::move(reason)) {}

    void OnTestStart(testing::TestInfo const&) override
    {
        GTEST_SKIP() << reason_;
    }

private:
    std::string reason_;
};

} // namespace

bool sandboxIsRequired()
{
    char const* const required = std::getenv("MI_SANDBOX_REQUIRED");
    return required && std::string(required) == "1";
}

int runTestsInSandbox(int argc, char* argv[])
{
    // So that commands, their language and their terminal do not depend on the caller.
    setenv("PATH", "/usr/local/sbin:/usr/local/bin:/usr/sbin:/usr/bin:/sbin:/bin", 1);
    setenv("LC_ALL", "C", 1);
    setenv("TERM", "xterm", 1);
    testing::InitGoogleTest(&argc, argv);
    return runTestsOneByOne([] {
        if (auto const reason = mihost::enterSandbox()) {
            if (sandboxIsRequired()) {
                std::cerr << "no sandbox: " << *reason << '\n';
                return EXIT_FAILURE;
            }
            testing::UnitTest::GetInstance()->listeners().Append(
                new SkipAll("no sandbox: " + *reason));
        }
        return RUN_ALL_TESTS();
    });
}
