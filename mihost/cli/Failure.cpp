#include "mihost/cli/Failure.h"

#include "mihost/runtime/Text.h"

#include <fmt/format.h>

namespace mihost
{

void tell(Failure const& failure)
{
    fmt::print(stderr, "mihost: {}\n", printable(failure.what()));
}

} // namespace mihost
