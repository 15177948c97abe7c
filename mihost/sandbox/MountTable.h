#ifndef MIHOST_SANDBOX_MOUNTTABLE_H
#define MIHOST_SANDBOX_MOUNTTABLE_H

#include <string>
#include <vector>

namespace mihost
{

/**
 * The mount points, other than / itself, to copy: each once, a parent before the mounts below it.
 * The kernel's own file systems and mounts below /proc, /sys, /dev and /run are omitted.
 *
 * @param file  /proc/self/mountinfo or a file in its format
 * @throws std::runtime_error if it cannot be read
 */
std::vector<std::string> mountsToCopy(std::string const& file);

} // namespace mihost

#endif
