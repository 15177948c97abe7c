#ifndef TESTS_CONTRACT_MIHOST_CLI_NEEDSSANDBOX_H
#define TESTS_CONTRACT_MIHOST_CLI_NEEDSSANDBOX_H

#include "tests/support/Program.h"

#include <cstdlib>
#include <gtest/gtest.h>

/** Skips its tests if mihost cannot create a sandbox, unless MI_SANDBOX_REQUIRED is 1. */
class NeedsSandbox : public testing::Test
{
protected:
    void SetUp() override
    {
        Outcome const outcome = mihostRun({"--sandbox", "version"});
        char const* const required = std::getenv("MI_SANDBOX_REQUIRED");
        if (outcome.code != 0 && !(required && std::string(required) == "1"))
            GTEST_SKIP() << outcome.err;
        ASSERT_EQ(outcome.code, 0) << outcome.err;
    }
};

#endif
