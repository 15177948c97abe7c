#ifndef MIHOST_CLI_CHANGE_PASSWORDHASH_H
#define MIHOST_CLI_CHANGE_PASSWORDHASH_H

#include <string>

namespace mihost
{

/**
 * @return whether passwd on this machine reads a password from a pipe. The plug-in sets passwords
 *         that way; if passwd does not, the plain text remains in the shadow file. Runs
 *         "passwd --help" once per process.
 */
bool passwdReadsStdin();

/**
 * A hash of the password, by the method that /etc/login.defs names and with a new salt.
 *
 * @throws Failure (BadUsage) if there is none that the shadow file can hold
 */
std::string hashOf(std::string const& password);

/** Whether the password is the one of this hash. */
bool fits(std::string const& password, std::string const& hash);

/** @return the hash with backslashes, so that a shell reads it unchanged outside quotes */
std::string escapedForShell(std::string const& hash);

} // namespace mihost

#endif
