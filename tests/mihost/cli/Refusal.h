#ifndef TESTS_MIHOST_CLI_REFUSAL_H
#define TESTS_MIHOST_CLI_REFUSAL_H

#include "mihost/cli/system/Failure.h"

#include <gtest/gtest.h>
#include <string>

/** Why mihost refuses to do the step as wrong usage; "accepted" where it does it. */
template <class Step> std::string refusal(Step step)
{
    try {
        step();
    } catch (mihost::Failure const& failure) {
        EXPECT_EQ(failure.code(), mihost::BadUsage);
        return failure.what();
    }
    return "accepted";
}

#endif
