#include "frame/OsSwMI.h"

namespace IC
{

void OsSwMI::createLogNodes()
{
    NQ::LOG::Scope const scope(OSSWMI::unit);
}

} // namespace IC
