#include "mihost/cli/system/EndingSignals.h"

namespace mihost
{

sigset_t endingSignalSet()
{
    sigset_t set;
    sigemptyset(&set);
    for (int const signal : endingSignals)
        sigaddset(&set, signal);
    return set;
}

void setHandler(int signal, void (*handler)(int), int flags)
{
    struct sigaction action {
    };
    action.sa_handler = handler;
    action.sa_flags = flags;
    action.sa_mask = endingSignalSet();
    sigaction(signal, &action, nullptr);
}

} // namespace mihost
