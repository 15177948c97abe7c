#ifndef MIHOST_CLI_SYSTEM_PRIVILEGE_H
#define MIHOST_CLI_SYSTEM_PRIVILEGE_H

#include <sys/capability.h>

namespace mihost
{

/** Whether this process may use the capability now. */
bool hasCapability(cap_value_t capability);

} // namespace mihost

#endif
