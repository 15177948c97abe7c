#ifndef MIHOST_SANDBOX_SELF_H
#define MIHOST_SANDBOX_SELF_H

#include "mihost/sandbox/Descriptor.h"
#include "mihost/sandbox/SystemCall.h"

#include <sys/syscall.h>
#include <unistd.h>

namespace mihost
{

/** A descriptor of the calling process, whose namespaces setns finds without a /proc. */
inline Descriptor openSelf()
{
    return Descriptor(static_cast<int>(
        check(syscall(SYS_pidfd_open, getpid(), 0), "cannot open the process itself")));
}

} // namespace mihost

#endif
