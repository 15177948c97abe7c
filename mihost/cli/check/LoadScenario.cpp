#include "host/OpenMI.h"
#include "mihost/cli/check/Scenarios.h"
#include "mihost/cli/check/Subject.h"
#include "mihost/cli/check/Symbols.h"

#include <dlfcn.h>
#include <fmt/format.h>
#include <fmt/ranges.h>

namespace mihost::checks
{

namespace
{

decltype(&OpenMI) entryPoint(std::string const& file)
{
    void* const library = dlopen(file.c_str(), RTLD_NOW | RTLD_NOLOAD);
    auto const open = reinterpret_cast<decltype(&OpenMI)>(dlsym(library, "OpenMI"));
    dlclose(library); // the subject holds it
    return open;
}

struct HandedOut {
    int answer;
    IC::ManagementInterface* interface;
    IC::Error* error;
};

HandedOut call(decltype(&OpenMI) open)
{
    HandedOut out{0, nullptr, nullptr};
    out.answer = open(&out.interface, &out.error);
    return out;
}

Verdict library(Subject& subject)
{
    subject.plugin();
    return {};
}

Verdict entryPointTwice(Subject& subject)
{
    Plugin& plugin = subject.plugin(); // the first call
    HandedOut const again = call(entryPoint(plugin.path()));
    Findings findings;
    if (again.answer != 0)
        findings.push_back(fmt::format("the second call returned {} rather than 0", again.answer));
    if (again.interface != &plugin.interface())
        findings.emplace_back("the second call returns another interface");
    if (again.error != plugin.status())
        findings.emplace_back("the second call returns another status");
    if (!plugin.status())
        findings.emplace_back("no status is returned");
    else if (unsigned int const status = plugin.status()->getStatus(); status != 0)
        findings.push_back(fmt::format("the status is {} rather than 0 before initialize", status));
    return {findings};
}

Verdict ownSymbols(Subject& subject)
{
    for (Symbol const& symbol : symbolsOf(subject.plugin().path()))
        if (symbol.defined && symbol.name == "OpenMI")
            return {};
    return {{"the file itself does not define OpenMI; another library that it needs does"}};
}

Verdict hostSymbols(Subject& subject)
{
    std::string const file = subject.plugin().path();
    return {wantedBeyondTheContract(symbolsOf(file), file)};
}

/** An independent build may lack them: nothing but tools that replace single functions notices. */
Verdict noteMissingNames(Subject& subject)
{
    Verdict verdict;
    auto const missing = missingPublicNames(symbolsOf(subject.plugin().path()));
    if (!missing.empty())
        verdict.notes.push_back(fmt::format("{} of {} public names are not defined: {}",
                                            missing.size(), publicNames().size(),
                                            fmt::join(missing, ", ")));
    return verdict;
}

Verdict silentLoad(Subject& subject)
{
    Findings findings;
    for (LoggedCall const& logged : subject.log())
        findings.push_back(fmt::format("logged before initialize: {}", logged.text));
    return {findings};
}

} // namespace

Scenario loadScenario()
{
    return {"load",
            {
                {"opening", "the library loads and provides its interface", library},
                {"entry-point", "OpenMI returns 0 and the same two addresses each time",
                 entryPointTwice},
                {"own-symbols", "the file itself defines OpenMI", ownSymbols},
                {"host-symbols", "host/ declares every symbol that it needs from its host",
                 hostSymbols},
                {"public-names", "names that tools may replace; missing ones are only noted",
                 noteMissingNames},
                {"silence", "nothing is logged before initialize", silentLoad},
            }};
}

} // namespace mihost::checks
