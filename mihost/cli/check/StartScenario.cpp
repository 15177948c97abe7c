#include "mihost/cli/check/LogRules.h"
#include "mihost/cli/check/PropertyRules.h"
#include "mihost/cli/check/Scenarios.h"
#include "mihost/cli/check/Subject.h"
#include "mihost/cli/check/TreeRules.h"

#include <fmt/format.h>

namespace mihost::checks
{

namespace
{

Verdict initialize(Subject& subject)
{
    IC::Error const error = subject.initialize();
    Findings findings;
    if (error.getStatus() != 0)
        findings.push_back(fmt::format("initialize returned: {}", static_cast<std::string>(error)));
    IC::Error const* const kept = subject.plugin().status();
    if (kept && kept->getStatus() != error.getStatus())
        findings.push_back(fmt::format("the status of OpenMI is {} rather than {}",
                                       +kept->getStatus(), +error.getStatus()));
    if (std::size_t const count = subject.events().published().size(); count != 0)
        findings.push_back(
            fmt::format("the load callback was called for {} start-up nodes", count));
    return {findings};
}

template <Findings (*rule)(Nodes const&)> Verdict onTree(Subject& subject)
{
    return {rule(subject.nodes())};
}

template <Findings (*rule)(Nodes const&, unsigned int)> Verdict onOwnTree(Subject& subject)
{
    return {rule(subject.nodes(), Subject::ownId)};
}

Verdict unload(Subject& subject)
{
    subject.unload();
    if (std::size_t const count = subject.nodes().size(); count != 0)
        return {{fmt::format("{} nodes are still listed after unload", count)}};
    return {};
}

Verdict close(Subject& subject)
{
    subject.close();
    return {};
}

} // namespace

Scenario startScenario()
{
    std::vector<Check> checks = {
        {"initialize", "initialize returns 0 and publishes nothing", initialize},
        {"node-types", "each kind of node is there, in the order of building",
         onTree<wrongTypeOrder>},
        {"node-ids", "ids count up from the interface's own", onOwnTree<wrongIds>},
        {"parents", "each node names its parent", onTree<wrongParents>},
        {"indexes", "single nodes have the index 0, others count from 1", onTree<wrongIndexes>},
        {"status", "each node has the status 1", onTree<wrongStatuses>},
        {"descriptions", "each node has its kind's description", onTree<wrongDescriptions>},
        {"interface-ids", "each node belongs to this interface alone", onOwnTree<wrongMiIds>},
        {"property-ids", "each kind of node has its properties and no others",
         onTree<wrongPropertyIds>},
        {"property-kinds", "each value is of its property's kind", onTree<wrongKinds>},
        {"property-flags", "each flag is true except that of the system's requested state",
         onTree<wrongFlags>},
        {"property-values", "fixed values, lengths and counts are right", onTree<wrongValues>},
        {"reads", "one node of each kind can be read", onTree<wrongReads>},
        {"unload", "no node is left after unload", unload},
    };
    for (Check const& check : logChecks())
        checks.push_back(check);
    checks.push_back({"close", "the library can be closed after unload", close});
    return {"start", checks};
}

Scenario earlyUnloadScenario()
{
    return {"early-unload",
            {
                {"unload", "unload without initialize does nothing", unload},
                {"close", "the library can be closed after that", close},
            }};
}

} // namespace mihost::checks
