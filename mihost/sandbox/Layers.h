#ifndef MIHOST_SANDBOX_LAYERS_H
#define MIHOST_SANDBOX_LAYERS_H

#include "mihost/sandbox/Descriptor.h"

#include <string>
#include <vector>

namespace mihost
{

/** One file system of the machine in its copy. Neither view can be written through. */
struct Layer {
    std::string path;   // its mount point, without a slash at the end; empty for the root
    Descriptor machine; // the machine's own files, without mounts below
    Descriptor written; // the changes in the copy, in the kernel's overlay format
};

/** Opens a directory so that nothing can be written through it, even by way of /proc. */
Descriptor openReadOnly(std::string const& path);

/** The layers of the copy that this process runs in. */
std::vector<Layer>& layers();

} // namespace mihost

#endif
