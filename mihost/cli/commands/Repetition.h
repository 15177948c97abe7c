#ifndef MIHOST_CLI_COMMANDS_REPETITION_H
#define MIHOST_CLI_COMMANDS_REPETITION_H

#include "mihost/cli/output/Output.h"
#include "mihost/cli/system/SignalWaiter.h"

namespace mihost
{

/**
 * Waits between two rounds of a command that runs until Ctrl-C.
 *
 * @return whether to continue
 * @throws OutputClosed, which a command without output would not notice
 */
bool waitForNextRound(Output const& out, SignalWaiter& signals, double seconds);

} // namespace mihost

#endif
