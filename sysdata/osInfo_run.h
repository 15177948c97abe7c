#ifndef SYSDATA_OSINFO_RUN_H
#define SYSDATA_OSINFO_RUN_H

#include "sysdata/osInfo_commands.h"
#include "sysdata/osInfo_linux.h"
#include "util/log.h"

#include <string>

namespace NQ
{

namespace MI_INTERNAL os
{

struct Ran {
    int status;         // 0 if the command ran and printed nothing
    std::string output; // up to the first NUL
};

/** Runs a list through executeCommand. */
Ran run(OsInfo& info, Arguments arguments);

/**
 * Like run, and logs the output for the function of the scope.
 *
 * @param params  those of the call, whose passwords are hidden
 */
Ran runLogged(OsInfo& info, Arguments const& arguments, std::vector<ParamInfo> const& params,
              log::Scope const& scope);

} // namespace os

} // namespace NQ

#endif
