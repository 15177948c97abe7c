#ifndef MIHOST_CLI_PLUGIN_TRACEFILE_H
#define MIHOST_CLI_PLUGIN_TRACEFILE_H

#include "mihost/cli/system/Failure.h"
#include "mihost/sandbox/Descriptor.h"

#include <string>

namespace mihost
{

/**
 * Opens an empty file that only its owner can read, or the pipe, terminal or device at the path.
 *
 * A trace contains lines of a log that may not be world-readable. A file that others may have open
 * is therefore replaced, and one that belongs to another user is refused. A path to standard output
 * or standard error appends at its position.
 *
 * @throws Failure if the file cannot be opened for writing
 */
Descriptor openTraceFile(std::string const& path);

/** @param problem  an errno value */
Failure cannotWriteTrace(std::string const& path, int problem);

} // namespace mihost

#endif
