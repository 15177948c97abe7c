#include "mihost/cli/check/Scenarios.h"

namespace mihost::checks
{

std::vector<Scenario> const& scenarios()
{
    static std::vector<Scenario> const all = {
        loadScenario(),    startScenario(),   earlyUnloadScenario(), failingStartScenario(),
        refreshScenario(), refusalScenario(), methodScenario(),      roundsScenario(),
    };
    return all;
}

} // namespace mihost::checks
