#ifndef MIHOST_CLI_SAY_H
#define MIHOST_CLI_SAY_H

#include <string>

namespace mihost
{

/** Writes to standard error. Where nobody reads it any more, there is nobody to tell so either. */
void say(std::string const& text);

} // namespace mihost

#endif
