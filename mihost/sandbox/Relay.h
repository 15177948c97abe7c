#ifndef MIHOST_SANDBOX_RELAY_H
#define MIHOST_SANDBOX_RELAY_H

#include <signal.h>
#include <sys/types.h>

namespace mihost
{

/** Keeps back the signals that relayTo passes on, and SIGCHLD, for as long as it lives. */
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
 * Passes signals on to the child and reaps every child that ends until this one has. To be called
 * while signals are held.
 *
 * @return its wait status
 */
int relayTo(pid_t child);

/** Ends the process as one with this wait status ended, by the exit code or by the signal. */
[[noreturn]] void endLike(int waitStatus);

} // namespace mihost

#endif
