#ifndef MIHOST_CLI_CHANGE_PASSWORDHASH_H
#define MIHOST_CLI_CHANGE_PASSWORDHASH_H

#include <string>

namespace mihost
{

/**
 * Whether passwd here takes a password from a pipe. The plug-in sets passwords that way and leaves
 * the plain text in the shadow file otherwise. Runs "passwd --help", once in a process.
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

/** The hash such that a shell reads it as it was, outside of quotes. */
std::string escapedForShell(std::string const& hash);

} // namespace mihost

#endif
