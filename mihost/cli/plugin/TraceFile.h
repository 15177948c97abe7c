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
 * A trace holds lines of a log that not everybody may read. A file that somebody else may have open
 * already is therefore replaced, and one that belongs to another user is refused. A path that leads
 * to standard output or standard error goes on where that stands.
 *
 * @throws Failure if the file cannot be opened for writing
 */
Descriptor openTraceFile(std::string const& path);

/** @param problem  an errno value */
Failure cannotWriteTrace(std::string const& path, int problem);

} // namespace mihost

#endif
