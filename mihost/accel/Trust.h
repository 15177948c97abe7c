#ifndef MIHOST_ACCEL_TRUST_H
#define MIHOST_ACCEL_TRUST_H

#include "mihost/accel/Answers.h"

namespace miaccel
{

/** Which program a command must be: any of its name, or a link to the program kmod. */
enum class Tool { Any, Kmod };

/** @return why a shell might run something other than the usual tool of this name; null if not */
Reason distrust(char const* name, Tool tool);

} // namespace miaccel

#endif
