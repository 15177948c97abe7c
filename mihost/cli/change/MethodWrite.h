#ifndef MIHOST_CLI_CHANGE_METHODWRITE_H
#define MIHOST_CLI_CHANGE_METHODWRITE_H

#include "mihost/cli/change/Write.h"
#include "mihost/cli/input/MethodCall.h"

namespace mihost
{

/** What happens to an account's expiry that UserSetAttrib would erase because none is given. */
enum class Expiry {
    Keep,      // it is passed along
    KeepAloud, // it is passed along with a warning
    Erase,     // it is erased, which is verified
    EraseAloud // it is erased, with a warning
};

/**
 * A method call as a write. A plain password is replaced by its hash if passwd does not read any
 * from a pipe.
 *
 * @throws Failure (BadUsage) if that cannot be done, or if the expiry cannot be passed along
 */
Write methodWrite(IC::MutableNode& os, MethodCall call, Expiry expiry);

/** A method call that the user wrote as such. Only --yes lets it erase an expiry. */
Write methodWrite(Session const& session, IC::MutableNode& os, MethodCall const& call);

} // namespace mihost

#endif
