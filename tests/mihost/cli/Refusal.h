#ifndef TESTS_MIHOST_CLI_REFUSAL_H
#define TESTS_MIHOST_CLI_REFUSAL_H

#include "mihost/cli/system/Failure.h"

#include <gtest/gtest.h>
#include <string>

/** @return why mihost refuses the step as wrong usage; "accepted" if it does not */
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
