#ifndef MIHOST_SANDBOX_PIPE_H
#define MIHOST_SANDBOX_PIPE_H

#include "mihost/sandbox/Descriptor.h"
#include "mihost/sandbox/SystemCall.h"

#include <fcntl.h>

namespace mihost
{

/** Both ends of a pipe, which commands do not inherit. */
struct Pipe {
    /** @throws std::system_error */
    Pipe()
    {
        int ends[2];
        check(pipe2(ends, O_CLOEXEC), "cannot create a pipe");
        readEnd = Descriptor(ends[0]);
        writeEnd = Descriptor(ends[1]);
    }

    Descriptor readEnd;
    Descriptor writeEnd;
};

} // namespace mihost

#endif
