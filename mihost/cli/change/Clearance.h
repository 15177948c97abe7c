#ifndef MIHOST_CLI_CHANGE_CLEARANCE_H
#define MIHOST_CLI_CHANGE_CLEARANCE_H

#include "mihost/cli/change/ChangeLock.h"
#include "mihost/cli/plugin/Session.h"

#include <functional>
#include <string>

namespace mihost
{

/** Throws Failure if, on the machine as it is now, a change would do something else. */
using MachineCheck = std::function<void()>;

/**
 * Clears one change: checks it, asks for the user's consent if it is dangerous, and keeps other
 * mihosts from changing the machine while the result exists.
 *
 * The check runs under the lock; for a dangerous change also before the prompt.
 *
 * @param command  as typed, such as "power halt"
 * @param danger   the question, such as "halt the machine"; empty for nothing
 * @throws Failure
 */
ChangeLock clearChange(
    Session const& session, std::string const& command, std::string const& danger,
    MachineCheck const& check = [] {});

} // namespace mihost

#endif
