#include "mihost/cli/system/Failure.h"

#include "mihost/cli/system/Stderr.h"
#include "mihost/runtime/Text.h"

#include <fmt/format.h>

namespace mihost
{

void tell(Failure const& failure)
{
    writeStderr(fmt::format("mihost: {}\n", printable(failure.what())));
}

} // namespace mihost
