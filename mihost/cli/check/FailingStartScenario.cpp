#include "mihost/cli/check/Scenarios.h"
#include "mihost/cli/check/Subject.h"
#include "mihost/cli/check/TreeRules.h"

#include <fmt/format.h>

namespace mihost::checks
{

namespace
{

constexpr unsigned char failureStatus = 42;
constexpr char failureText[] = "the check lets it fail";

Verdict answer(Subject& subject)
{
    static IC::Error const failure(failureStatus, IC::Number(0U), failureText);
    setInitializeAnswer(&failure);
    IC::Error const error = subject.initialize();
    setInitializeAnswer(nullptr);
    Findings findings;
    if (error.getStatus() != failureStatus)
        findings.push_back(
            fmt::format("status {} rather than {}", +error.getStatus(), +failureStatus));
    if (error.getText() != failureText)
        findings.push_back(fmt::format("text '{}' rather than '{}'", error.getText(), failureText));
    IC::Error const* const kept = subject.plugin().status();
    if (kept && kept->getStatus() != failureStatus)
        findings.push_back(fmt::format("the status of OpenMI is {} rather than {}",
                                       +kept->getStatus(), +failureStatus));
    return {findings};
}

Verdict tree(Subject& subject)
{
    return {wrongTypeOrder(subject.nodes())};
}

Verdict unloadAfterFailure(Subject& subject)
{
    subject.unload();
    return {};
}

} // namespace

Scenario failingStartScenario()
{
    return {"failing-start",
            {
                {"answer", "a failure of the host's initialize is passed on", answer},
                {"tree", "the tree is still built", tree},
                {"unload", "the interface can be unloaded after that", unloadAfterFailure},
            }};
}

} // namespace mihost::checks
