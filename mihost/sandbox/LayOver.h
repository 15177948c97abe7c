#ifndef MIHOST_SANDBOX_LAYOVER_H
#define MIHOST_SANDBOX_LAYOVER_H

#include "mihost/sandbox/Descriptor.h"

#include <string>

namespace mihost
{

/** Opens a directory for layOver, since its path may lead elsewhere by then. */
Descriptor openFolder(std::string const& path);

/** Replaces files below / by those of the open directory; see layOver in Sandbox.h. */
void layOver(Descriptor const& folder);

} // namespace mihost

#endif
