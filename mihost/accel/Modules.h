#ifndef MIHOST_ACCEL_MODULES_H
#define MIHOST_ACCEL_MODULES_H

#include "mihost/accel/Answer.h"

namespace miaccel
{

/** Why libkmod in this process might answer otherwise than the commands do; null for no reason. */
Reason strangeLibrary();

/** lsmod */
Answer lsmod();

/** modinfo NAME */
Answer modinfo(std::string const& name);

} // namespace miaccel

#endif
