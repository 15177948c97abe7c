#ifndef MIHOST_CLI_OUTPUT_UNKNOWNVALUES_H
#define MIHOST_CLI_OUTPUT_UNKNOWNVALUES_H

#include <string>

namespace mihost
{

/** Records that an unknown value is shown. @param reason  empty if it is known */
void noteUnknown(std::string const& reason);

/** The warning for all unknown values shown since the last call; empty for none. */
std::string takeUnknownWarning();

} // namespace mihost

#endif
