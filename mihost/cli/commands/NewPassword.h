#ifndef MIHOST_CLI_COMMANDS_NEWPASSWORD_H
#define MIHOST_CLI_COMMANDS_NEWPASSWORD_H

#include "mihost/cli/plugin/Session.h"

#include <string>

namespace mihost
{

/**
 * Reads a new password from a file or from standard input, at a terminal with two prompts.
 *
 * @param file  empty or "-" for standard input
 * @throws Failure (BadUsage) if there is none, or if the two differ
 */
std::string readNewPassword(Session const& session, std::string const& file);

/** The password in a file's text: its only line. @throws Failure (BadUsage) naming the file */
std::string passwordIn(std::string const& text, std::string const& file);

} // namespace mihost

#endif
