#ifndef MIHOST_SANDBOX_LAYOVER_H
#define MIHOST_SANDBOX_LAYOVER_H

#include "mihost/sandbox/Descriptor.h"

#include <string>

namespace mihost
{

/** Opens a folder to lay over later, by when its path may lead elsewhere. */
Descriptor openFolder(std::string const& path);

/** Lays the open folder's files over /; see layOver. */
void layOver(Descriptor const& folder);

} // namespace mihost

#endif
