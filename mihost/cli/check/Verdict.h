#ifndef MIHOST_CLI_CHECK_VERDICT_H
#define MIHOST_CLI_CHECK_VERDICT_H

#include <optional>
#include <string>
#include <vector>

/** The checks of `mihost check`: what a host may expect of any plug-in with this contract. */
namespace mihost::checks
{

class Subject;

/** The findings, one line each; empty if there are none. */
using Findings = std::vector<std::string>;

/** The result of a check. */
struct Verdict {
    Findings findings;
    std::vector<std::string> notes = {};               // worth knowing, but not wrong
    std::optional<std::string> skipped = std::nullopt; // why the check could not be carried out
};

/** That a check could not be carried out. */
inline Verdict skippedFor(std::string const& reason)
{
    return {{}, {}, reason};
}

struct Check {
    char const* name;    // unique in its scenario; scripts rely on it
    char const* meaning; // what holds if the check passes
    Verdict (*run)(Subject& subject);
};

/** Consecutive checks of one plug-in, in their own process. */
struct Scenario {
    char const* name;
    std::vector<Check> checks;
};

/** Every scenario, in the order in which they run. */
std::vector<Scenario> const& scenarios();

struct Result {
    std::string name; // "scenario.check"
    std::string meaning;
    Verdict verdict;

    bool passed() const
    {
        return verdict.findings.empty() && !verdict.skipped;
    }
    bool failed() const
    {
        return !verdict.findings.empty();
    }
};

} // namespace mihost::checks

#endif
