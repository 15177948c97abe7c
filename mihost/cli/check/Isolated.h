#ifndef MIHOST_CLI_CHECK_ISOLATED_H
#define MIHOST_CLI_CHECK_ISOLATED_H

#include "mihost/cli/check/Verdict.h"

#include <chrono>
#include <string>

namespace mihost::checks
{

struct Settings {
    std::string file; // the plug-in's
    unsigned int rounds;
    std::chrono::seconds timeLimit; // for each scenario
};

/**
 * Runs one scenario in its own process, so that a crash, an abort, an exit or a hang of the
 * plug-in is a finding of the running check. Later checks are skipped.
 *
 * @return a result for each check of the scenario
 * @throws Failure (NoPlugin) if the plug-in cannot be loaded
 */
std::vector<Result> runIsolated(Scenario const& scenario, Settings const& settings);

} // namespace mihost::checks

#endif
