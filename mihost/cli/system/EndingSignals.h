#ifndef MIHOST_CLI_SYSTEM_ENDINGSIGNALS_H
#define MIHOST_CLI_SYSTEM_ENDINGSIGNALS_H

#include <csignal>

namespace mihost
{

/** The signals that end the program unless it says otherwise. */
constexpr int endingSignals[] = {SIGINT, SIGTERM, SIGHUP, SIGQUIT};

/** All ending signals; to be blocked together. */
sigset_t endingSignalSet();

/** Sets a handler that no ending signal interrupts. */
void setHandler(int signal, void (*handler)(int), int flags);

} // namespace mihost

#endif
