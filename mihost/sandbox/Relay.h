#ifndef MIHOST_SANDBOX_RELAY_H
#define MIHOST_SANDBOX_RELAY_H

#include <signal.h>
#include <sys/types.h>

namespace mihost
{

/** Blocks the signals that relayTo passes on, and SIGCHLD, while it exists. */
class HeldSignals
{
public:
    HeldSignals();
    ~HeldSignals();
    HeldSignals(HeldSignals const&) = delete;
    HeldSignals& operator=(HeldSignals const&) = delete;

private:
    sigset_t before_;
};

/**
 * Passes signals on to the child and reaps every child that ends, until this one has ended. Call it
 * while a HeldSignals exists.
 *
 * @return its wait status
 */
int relayTo(pid_t child);

/** Ends the process with the exit code, or by the signal, of this wait status. */
[[noreturn]] void endLike(int waitStatus);

} // namespace mihost

#endif
