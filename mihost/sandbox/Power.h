#ifndef MIHOST_SANDBOX_POWER_H
#define MIHOST_SANDBOX_POWER_H

namespace mihost
{

/** Replaces the power commands by one that only prints and records its arguments. */
void replacePowerCommands();

} // namespace mihost

#endif
