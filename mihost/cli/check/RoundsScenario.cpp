#include "mihost/cli/check/Accounts.h"
#include "mihost/cli/check/Resources.h"
#include "mihost/cli/check/Scenarios.h"
#include "mihost/cli/check/Subject.h"
#include "mihost/cli/plugin/CommandTap.h"

#include <fmt/format.h>

namespace mihost::checks
{

namespace
{

// The first rounds allocate what the host and libc keep: buffers, a pipe, caches of name services.
constexpr unsigned int warmUpRounds = 2;

// The record of id ranges is never freed, and the loader keeps some bytes for a closed library.
constexpr std::size_t heapForARound = 4096; // bytes

struct Growth {
    Resources before;
    Resources after;
};

Growth& growth()
{
    static Growth measured;
    return measured;
}

void liveOnce(Subject& subject)
{
    subject.initialize();
    refresh(subject);
    subject.unload();
    subject.close();
    subject.events().forget();
    subject.forgetLog();
    commandTap::takeStandardError();
}

Verdict rounds(Subject& subject)
{
    for (unsigned int round = 0; round < warmUpRounds; ++round)
        liveOnce(subject);
    growth().before = resourcesInUse();
    for (unsigned int round = 0; round < subject.rounds(); ++round)
        liveOnce(subject);
    growth().after = resourcesInUse();
    return {};
}

template <std::size_t Resources::*count> Verdict nothingLeft(Subject& subject)
{
    std::size_t const before = growth().before.*count;
    std::size_t const after = growth().after.*count;
    if (after <= before)
        return {};
    return {{fmt::format("{} more after {} rounds", after - before, subject.rounds())}};
}

Verdict children(Subject&)
{
    if (growth().after.children)
        return {{"a child process is running, or ended and was not waited for"}};
    return {};
}

Verdict heap(Subject& subject)
{
    std::size_t const before = growth().before.heap;
    std::size_t const after = growth().after.heap;
    if (before == 0)
        return skippedFor("the allocator of this build does not report memory in use");
    std::size_t const bound = subject.rounds() * heapForARound;
    if (after <= before + bound)
        return {};
    return {{fmt::format("{} bytes more after {} rounds ({} are allowed)", after - before,
                         subject.rounds(), bound)}};
}

} // namespace

Scenario roundsScenario()
{
    return {"rounds",
            {
                {"life", "load, initialize, refresh, unload and close, repeatedly", rounds},
                {"descriptors", "no descriptor is left open", nothingLeft<&Resources::descriptors>},
                {"children", "no child is left", children},
                {"threads", "no thread is left", nothingLeft<&Resources::threads>},
                {"memory", "no more than 4 KiB a round stay allocated", heap},
            }};
}

} // namespace mihost::checks
