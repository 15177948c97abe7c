#ifndef MIHOST_ACCEL_SED_H
#define MIHOST_ACCEL_SED_H

#include "mihost/accel/Answer.h"

#include <cstdint>

namespace miaccel
{

/** sed -n 'LINEp' PATH, for a line from 1 on. The line is held once, up to 16 MiB. */
Answer sed(std::string const& path, std::uint64_t line);

} // namespace miaccel

#endif
