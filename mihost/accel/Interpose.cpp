// popen and pclose, which callers reach instead of those of the C library.

#include "mihost/accel/Accel.h"
#include "mihost/accel/Stream.h"

extern "C" {

MIACCEL_EXPORT FILE* popen(char const* command, char const* mode)
{
    FILE* const stream = miaccel::openAnswer(command, mode);
    return stream ? stream : miaccel::realPopen(command, mode);
}

MIACCEL_EXPORT int pclose(FILE* stream)
{
    // A command's own stream has a descriptor.
    return fileno(stream) < 0 ? std::fclose(stream) : miaccel::realPclose(stream);
}

} // extern "C"
