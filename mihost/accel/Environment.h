#ifndef MIHOST_ACCEL_ENVIRONMENT_H
#define MIHOST_ACCEL_ENVIRONMENT_H

#include "mihost/accel/Answer.h"

namespace miaccel
{

/**
 * Whether a variable of the environment, as NAME=VALUE, could make the shell or a tool behave
 * otherwise than usual. PATH, TZ and the locale are looked at by those who know what they change.
 */
bool isDisturbing(char const* variable);

/** Why nothing can be said of what a child process would do; null where all is well. */
Reason disturbance();

} // namespace miaccel

#endif
