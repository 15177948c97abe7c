#ifndef MIHOST_CLI_COMMANDS_UNKNOWNNAME_H
#define MIHOST_CLI_COMMANDS_UNKNOWNNAME_H

#include <string>

namespace mihost
{

/** @throws Failure (NotFound) that suggests a similar login name if there is one */
[[noreturn]] void failForUnknownAccount(std::string const& name);

/** The same for the name of a group. */
[[noreturn]] void failForUnknownGroup(std::string const& name);

} // namespace mihost

#endif
