#ifndef MIHOST_ACCEL_DATE_H
#define MIHOST_ACCEL_DATE_H

#include "mihost/accel/Answer.h"

#include <ctime>

namespace miaccel
{

/** date */
Answer date();

/** What date prints at the given time, in the environment's locale and time zone. */
Answer dateAt(std::time_t now);

} // namespace miaccel

#endif
