#ifndef TESTS_SUPPORT_COMPAREDLOG_H
#define TESTS_SUPPORT_COMPAREDLOG_H

#include "tests/support/BothWays.h"
#include "tests/support/ChangingLog.h"

#include <cstdint>
#include <gtest/gtest.h>
#include <vector>

inline std::string sedCommand(std::uint64_t line, std::string const& path)
{
    return "sed -n '" + std::to_string(line) + "p' " + path;
}

/**
 * Changes a log again and again and compares what wc and sed print with the accelerator's answers.
 * It may leave only sed to the real command, for lines with NUL bytes or without an end.
 *
 * @return the percentage of sed commands that were answered
 */
inline unsigned long percentOfSedsAnswered(unsigned int seed, int rounds)
{
    ChangingLog log(seed);
    unsigned long asked = 0;
    unsigned long ofThem = 0;
    for (int round = 0; round < rounds && !testing::Test::HasFailure(); ++round) {
        for (unsigned long changes = round == 0 ? 1 : log.choose(4); changes > 0; --changes)
            log.change();
        std::string const wc = "wc -l " + log.path();
        std::string together = bothways::answered(wc).value();
        std::string script = wc;
        std::uint64_t const last = std::stoull(together);
        for (std::uint64_t const line : {1 + log.choose(last + 2), last, last + 1}) {
            std::string const sed = sedCommand(std::max<std::uint64_t>(line, 1), log.path());
            ++asked;
            if (auto const text = bothways::answered(sed)) {
                ++ofThem;
                together += *text;
                script += "; " + sed;
            }
        }
        EXPECT_TRUE(together == bothways::real(script)) << round << ' ' << script;
    }
    return 100 * ofThem / asked;
}

#endif
