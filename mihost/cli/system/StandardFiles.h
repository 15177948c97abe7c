#ifndef MIHOST_CLI_SYSTEM_STANDARDFILES_H
#define MIHOST_CLI_SYSTEM_STANDARDFILES_H

namespace mihost
{

/**
 * Fills the places of missing standard files, so that no file opened later becomes one of them.
 * Reading or writing what is missing stays an error.
 *
 * @return false if a place could not be filled
 */
bool fillMissingStandardFiles();

} // namespace mihost

#endif
