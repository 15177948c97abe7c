#ifndef MIHOST_CLI_SYSTEM_STDERR_H
#define MIHOST_CLI_SYSTEM_STDERR_H

#include <string>

namespace mihost
{

/** Writes to standard error. Where nobody reads it any more, there is nobody to tell so either. */
void writeStderr(std::string const& text);

} // namespace mihost

#endif
