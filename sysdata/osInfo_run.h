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
    int status;         // 0 where the command was run and stayed silent
    std::string output; // up to the first NUL
};

/** Runs a list through executeCommand. */
Ran run(OsInfo& info, Arguments arguments);

/**
 * As run, and logs the output for the function whose scope it is.
 *
 * @param params  those of the call, whose passwords are hidden
 */
Ran runLogged(OsInfo& info, Arguments const& arguments, std::vector<ParamInfo> const& params,
              log::Scope const& scope);

} // namespace os

} // namespace NQ

#endif
