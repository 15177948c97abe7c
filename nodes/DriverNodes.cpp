#include "frame/OsSwMI.h"

namespace IC
{

void OsSwMI::createDriverNodes()
{
    NQ::LOG::Scope const scope(OSSWMI::unit);
}

} // namespace IC
