#ifndef SYSDATA_OSINFO_LOG_H
#define SYSDATA_OSINFO_LOG_H

#include "sysdata/ParamInfo.h"
#include "util/log.h"

#include <string>
#include <vector>

namespace NQ
{

namespace MI_INTERNAL os
{

/** Contract: facts are logged under the frame's source name, which hosts filter on. */
extern log::Unit const facts;

/** Administration methods are logged under their own source name. */
extern log::Unit const methods;

/**
 * What a tool printed, for the log. Tools and shells may quote the line that they could not read,
 * so the value of each parameter named "Password", as given or with its blanks escaped, becomes
 * "(hidden)".
 */
std::string withoutPasswords(std::string const& output, std::vector<ParamInfo> const& params);

// What error messages begin with; the type or the program follows.
constexpr char unknownType[] = "Unknown parameter type: ";
constexpr char tooLong[] = "Command line too long: ";

} // namespace os

} // namespace NQ

#endif
