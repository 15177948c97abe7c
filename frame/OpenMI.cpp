#include "host/OpenMI.h"

#include "frame/OsSwMI.h"

namespace IC
{

OsSwMI* pOsSwMI = nullptr;

namespace OSSWMI
{

// Constructed in this order when the library is loaded, destroyed in the reverse one.
std::string loggerOsSwMI = "Veltrix.IC.MI.OsSwMI";
OsSwMI myosswmi;
Error myerr(0, Number(0U), "");
NQ::Mutex myuserlock;
bool MI_call;

NQ::log::Unit const unit{loggerOsSwMI, "OsSwMI"};

} // namespace OSSWMI

} // namespace IC

extern "C" int OpenMI(IC::ManagementInterface** managementInterface, IC::Error** error)
{
    *managementInterface = &IC::OSSWMI::myosswmi;
    *error = &IC::OSSWMI::myerr;
    return 0;
}
