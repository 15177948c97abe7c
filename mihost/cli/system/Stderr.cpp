#include "mihost/cli/system/Stderr.h"

#include <cstdio>

namespace mihost
{

void writeStderr(std::string const& text)
{
    std::fwrite(text.data(), 1, text.size(), stderr);
    std::fflush(stderr);
}

} // namespace mihost
