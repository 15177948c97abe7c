#ifndef HOST_OPENMI_H
#define HOST_OPENMI_H

#include "host/Error.h"
#include "host/ManagementInterface.h"

/**
 * The one entry point of a plug-in, exported under this plain name.
 *
 * Both objects belong to the plug-in and live until its library is closed. Calling it again yields
 * the same two addresses.
 *
 * @param managementInterface  receives the interface object
 * @param error                receives the status object, later the outcome of initialize
 * @return 0
 */
extern "C" int OpenMI(IC::ManagementInterface** managementInterface, IC::Error** error);

#endif
