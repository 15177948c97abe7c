#ifndef MIHOST_SANDBOX_MOUNTTABLE_H
#define MIHOST_SANDBOX_MOUNTTABLE_H

#include <string>
#include <vector>

namespace mihost
{

/**
 * The mount points, other than / itself, whose content belongs into a copy of the machine: each
 * once, a parent before what is mounted below it. Those of the kernel's own file systems and those
 * below /proc, /sys, /dev and /run are left out.
 *
 * @param file  /proc/self/mountinfo, perhaps in another place
 * @throws std::runtime_error if it cannot be read
 */
std::vector<std::string> mountsToCopy(std::string const& file);

} // namespace mihost

#endif
