#ifndef MIHOST_SANDBOX_FOLDER_H
#define MIHOST_SANDBOX_FOLDER_H

#include "mihost/sandbox/Descriptor.h"

#include <string>
#include <vector>

namespace mihost
{

/**
 * The names in an open folder, in no order.
 *
 * @param path  what the directory is called in an error
 * @throws std::system_error
 */
std::vector<std::string> namesIn(Descriptor const& folder, std::string const& path);

} // namespace mihost

#endif
