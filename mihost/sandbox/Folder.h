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
 * @param path  the directory's name in an error message
 * @throws std::system_error
 */
std::vector<std::string> namesIn(Descriptor const& folder, std::string const& path);

} // namespace mihost

#endif
