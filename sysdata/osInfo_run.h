#ifndef SYSDATA_OSINFO_RUN_H
#define SYSDATA_OSINFO_RUN_H

#include "sysdata/osInfo_commands.h"
#include "sysdata/osInfo_linux.h"

#include <string>

namespace NQ
{

namespace OSINFO MI_INTERNAL
{

struct Ran {
    int status;         // 0 where the command was run and stayed silent
    std::string output; // up to the first NUL
};

// The function is the one whose messages these are. A list that does not fit is logged and fails.

/** Runs a list through executeCommand. */
Ran run(OsInfo& info, Arguments arguments, char const* function = __builtin_FUNCTION());

/**
 * As run, and logs the output.
 *
 * @param secret  whether the list holds a password
 */
Ran runLogged(OsInfo& info, Arguments const& arguments, bool secret = false,
              char const* function = __builtin_FUNCTION());

} // namespace MI_INTERNAL

} // namespace NQ

#endif
