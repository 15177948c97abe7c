// The library's face to the C library's callers: popen and pclose in its place.

#include "mihost/accel/Accel.h"
#include "mihost/accel/Accelerator.h"
#include "mihost/accel/Stream.h"

#include <cerrno>
#include <cstdio>
#include <dlfcn.h>

namespace
{

template <class Function> Function* real(char const* name)
{
    return reinterpret_cast<Function*>(dlsym(RTLD_NEXT, name));
}

} // namespace

extern "C" {

MIACCEL_EXPORT FILE* popen(char const* command, char const* mode)
{
    static auto* const next = real<FILE*(char const*, char const*)>("popen");
    if (FILE* const stream = miaccel::openAnswer(command, mode))
        return stream;
    if (!next) {
        errno = ENOSYS;
        return nullptr;
    }
    return next(command, mode);
}

// fclose needs no place of its own here: the streams hand back what they hold when libc closes
// them.
MIACCEL_EXPORT int pclose(FILE* stream)
{
    static auto* const next = real<int(FILE*)>("pclose");
    if (miaccel::closeStream(stream))
        return 0;
    return next(stream);
}

} // extern "C"
