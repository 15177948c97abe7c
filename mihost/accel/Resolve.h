#ifndef MIHOST_ACCEL_RESOLVE_H
#define MIHOST_ACCEL_RESOLVE_H

#include "mihost/accel/Answer.h"
#include "mihost/accel/Command.h"

namespace miaccel
{

/** Why the shell might run something else than the known command; null where it is sure not to. */
Reason unsure(Kind kind);

} // namespace miaccel

#endif
