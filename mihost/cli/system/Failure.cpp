#include "mihost/cli/system/Failure.h"

#include "mihost/cli/system/Stderr.h"

namespace mihost
{

void tell(Failure const& failure)
{
    writeError(failure.what());
}

} // namespace mihost
