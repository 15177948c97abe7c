#include "mihost/cli/system/Colours.h"

#include <cstdlib>
#include <string_view>
#include <unistd.h>

namespace mihost
{

namespace
{

std::string_view variable(char const* name)
{
    char const* const value = std::getenv(name);
    return value ? value : "";
}

} // namespace

bool takesControls(int descriptor)
{
    std::string_view const type = variable("TERM");
    return isatty(descriptor) == 1 && !type.empty() && type != "dumb";
}

bool takesColours(int descriptor, Colours colours)
{
    if (colours == Colours::Auto)
        return takesControls(descriptor) && variable("NO_COLOR").empty();
    return colours == Colours::Always;
}

} // namespace mihost
