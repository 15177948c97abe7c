#ifndef SYSDATA_OSINFO_LOG_H
#define SYSDATA_OSINFO_LOG_H

#include "util/log.h"

namespace NQ
{

namespace OSINFO MI_INTERNAL
{

/** The facts speak under the frame's source name. Kept: hosts filter on it. */
extern LOG::Unit const facts;

} // namespace MI_INTERNAL

} // namespace NQ

#endif
