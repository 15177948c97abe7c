#ifndef MIHOST_CLI_CHANGE_METHODWRITE_H
#define MIHOST_CLI_CHANGE_METHODWRITE_H

#include "mihost/cli/change/Write.h"
#include "mihost/cli/input/MethodCall.h"

namespace mihost
{

/**
 * A method call as a write. A plain password is replaced by its hash where passwd takes none from
 * a pipe, and an account expiry that the method would erase is passed along unless the user said
 * yes to everything.
 *
 * @throws Failure (BadUsage) if one of these cannot be done
 */
Write methodWrite(Session const& session, IC::MutableNode& os, MethodCall call);

} // namespace mihost

#endif
