#ifndef MIHOST_CLI_INPUT_USAGEERROR_H
#define MIHOST_CLI_INPUT_USAGEERROR_H

#include "mihost/cli/system/Failure.h"

#include <CLI/App.hpp>

namespace mihost
{

/**
 * What is wrong with a command line that cannot be parsed, with the command that it is about and
 * what to do.
 *
 * @param app      as parsing left it
 * @param inShell  help is another command there
 */
Failure usageFailure(CLI::App const& app, CLI::ParseError const& error, bool inShell);

} // namespace mihost

#endif
