#include "frame/ComputerInfo.h"

#include "frame/OsSwMI.h"
#include "host/make_string.h"

#include <sys/utsname.h>

namespace NQ
{

bool ComputerInfo::getComputerName(std::string& name)
{
    log::Scope const scope(IC::OSSWMI::unit);
    utsname system{};
    if (uname(&system) != 0)
        return false;
    name = make_string(system.nodename);
    return true;
}

} // namespace NQ
