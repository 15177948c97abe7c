#ifndef MIHOST_CLI_SYSTEM_STDERR_H
#define MIHOST_CLI_SYSTEM_STDERR_H

#include "mihost/cli/system/Colours.h"

#include <string>

namespace mihost
{

/** Writes to standard error; errors are ignored. */
void writeStderr(std::string const& text);

/** Sets how the whole program shows messages from now on. @param isQuiet  drops warnings */
void setMessageStyle(Colours colours, bool isQuiet);

/** Writes a warning on one line, after the program's name. */
void warn(std::string const& text);

/** Writes what went wrong on one line, after the program's name. */
void writeError(std::string const& text);

} // namespace mihost

#endif
