#ifndef MIHOST_SANDBOX_POWER_H
#define MIHOST_SANDBOX_POWER_H

namespace mihost
{

/** Puts a command that only says and notes what it was asked for in place of the power commands. */
void replacePowerCommands();

} // namespace mihost

#endif
