#include "host/VXLogger.h"
#include "mihost/cli/check/Accounts.h"
#include "mihost/cli/check/Scenarios.h"
#include "mihost/cli/check/Subject.h"

#include <fmt/format.h>

namespace mihost::checks
{

namespace
{

constexpr char announcement[] = "addNewNode error = ";

bool isRefusalMessage(LoggedCall const& call)
{
    return call.level == VXLog::level::error && call.operation == LogMessage::Operation::Log &&
           call.text.rfind(announcement, 0) == 0;
}

Verdict build(Subject& subject)
{
    subject.initialize();
    std::size_t const expected = accountsOf(subject.nodes()).size();
    subject.events().forget();
    subject.events().refuse();
    IC::Error const error = refresh(subject);
    Findings findings;
    if (error.getStatus() != 0)
        findings.push_back(
            fmt::format("the refresh returned: {}", static_cast<std::string>(error)));
    std::size_t const tried = subject.events().published().size();
    if (tried != expected)
        findings.push_back(fmt::format("{} nodes were published rather than {}", tried, expected));
    std::size_t const built = accountsOf(subject.nodes()).size();
    if (built != expected)
        findings.push_back(fmt::format("{} nodes were built rather than {}", built, expected));
    return {findings};
}

Verdict messages(Subject& subject)
{
    std::size_t count = 0;
    for (LoggedCall const& call : subject.log())
        if (isRefusalMessage(call))
            ++count;
    std::size_t const refused = subject.events().published().size();
    if (count != refused)
        return {{fmt::format("{} messages at level {} begin with '{}', for {} refused nodes", count,
                             VXLog::level::error, announcement, refused)}};
    return {};
}

} // namespace

Scenario refusalScenario()
{
    return {"refusal",
            {
                {"build", "a refresh continues if the host refuses its nodes", build},
                {"messages", "each refusal is logged once, as an error", messages},
            }};
}

} // namespace mihost::checks
