#ifndef MIHOST_ACCEL_WC_H
#define MIHOST_ACCEL_WC_H

#include "mihost/accel/Answer.h"

namespace miaccel
{

/** wc -l PATH */
Answer wc(std::string const& path);

} // namespace miaccel

#endif
