// A plug-in that needs a function of the reference program, which other hosts do not have.

#include "host/OpenMI.h"
#include "mihost/runtime/Runtime.h"

extern "C" int OpenMI(IC::ManagementInterface** interface, IC::Error** error)
{
    static IC::ManagementInterface plain;
    static IC::Error status(mihost::nodeObserver() ? 1 : 0, IC::Number(0U), "");
    *interface = &plain;
    *error = &status;
    return 0;
}
