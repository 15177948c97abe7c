#ifndef SYSDATA_OSINFO_LOG_H
#define SYSDATA_OSINFO_LOG_H

#include "util/log.h"

#include <string>

namespace NQ
{

namespace OSINFO MI_INTERNAL
{

/** The facts speak under the frame's source name. Kept: hosts filter on it. */
extern LOG::Unit const facts;

/** The administration methods speak under their own source name. */
extern LOG::Unit const methods;

/**
 * The text, or nothing where a password may stand in it: where it holds "Password" and is more
 * than one plain word, such as a method-call text with the wrong separators.
 */
std::string loggable(std::string const& text);

/**
 * What a command printed, for the log. Tools and shells may quote the line that they could not
 * read, so of a secret line's output only what cannot come from the line is kept.
 *
 * @param secret  whether the command line held a password
 */
std::string loggableOutput(std::string const& output, bool secret);

// Error messages.
std::string unknownType(std::string const& type);
std::string tooLong(std::string const& program);

} // namespace MI_INTERNAL

} // namespace NQ

#endif
