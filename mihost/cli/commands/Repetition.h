#ifndef MIHOST_CLI_COMMANDS_REPETITION_H
#define MIHOST_CLI_COMMANDS_REPETITION_H

#include "mihost/cli/output/Output.h"
#include "mihost/cli/system/SignalWaiter.h"

namespace mihost
{

/**
 * Waits between two rounds of a command that goes on until Ctrl-C.
 *
 * @return whether it goes on
 * @throws OutputClosed, which a command that has nothing to print would never notice
 */
bool waitForNextRound(Output const& out, SignalWaiter& signals, double seconds);

} // namespace mihost

#endif
