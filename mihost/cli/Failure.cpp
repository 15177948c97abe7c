#include "mihost/cli/Failure.h"

#include "mihost/cli/Say.h"
#include "mihost/runtime/Text.h"

#include <fmt/format.h>

namespace mihost
{

void tell(Failure const& failure)
{
    say(fmt::format("mihost: {}\n", printable(failure.what())));
}

} // namespace mihost
