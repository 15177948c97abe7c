#ifndef MIHOST_CLI_SYSTEM_STANDARDFILES_H
#define MIHOST_CLI_SYSTEM_STANDARDFILES_H

namespace mihost
{

/**
 * Opens missing standard descriptors, so that no file opened later becomes one of them. Reading or
 * writing a missing one is still an error.
 *
 * @return false if a place could not be filled
 */
bool fillMissingStandardFiles();

} // namespace mihost

#endif
