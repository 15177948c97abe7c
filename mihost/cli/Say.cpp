#include "mihost/cli/Say.h"

#include <cstdio>

namespace mihost
{

void say(std::string const& text)
{
    std::fwrite(text.data(), 1, text.size(), stderr);
    std::fflush(stderr);
}

} // namespace mihost
