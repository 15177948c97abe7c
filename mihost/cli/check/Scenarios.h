#ifndef MIHOST_CLI_CHECK_SCENARIOS_H
#define MIHOST_CLI_CHECK_SCENARIOS_H

#include "mihost/cli/check/Verdict.h"

/** Each scenario is defined in the file of its name. */
namespace mihost::checks
{

Scenario loadScenario();
Scenario startScenario();
Scenario earlyUnloadScenario();
Scenario failingStartScenario();
Scenario refreshScenario();
Scenario refusalScenario();
Scenario methodScenario();
Scenario roundsScenario();

} // namespace mihost::checks

#endif
