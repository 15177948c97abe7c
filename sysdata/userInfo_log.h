#ifndef SYSDATA_USERINFO_LOG_H
#define SYSDATA_USERINFO_LOG_H

#include "util/log.h"

namespace NQ
{

namespace USER_INFO
{

/** Where the messages of users' records, listings and operations come from. */
extern log::Unit const unit MI_INTERNAL;

} // namespace USER_INFO

} // namespace NQ

#endif
