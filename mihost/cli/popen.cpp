// The plug-in calls popen and pclose by their ordinary names. The loader binds them to this
// program's, which interpose libc's.

#include "mihost/cli/plugin/CommandTap.h"

extern "C" FILE* popen(char const* line, char const* mode)
{
    return mihost::commandTap::open(line, mode);
}

extern "C" int pclose(FILE* stream)
{
    return mihost::commandTap::close(stream);
}
