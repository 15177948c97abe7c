#ifndef MIHOST_SANDBOX_PRIVILEGES_H
#define MIHOST_SANDBOX_PRIVILEGES_H

namespace mihost
{

/** Drops for good the privileges that reach from the copy to the machine itself. */
void dropMachinePrivileges();

/**
 * Closes the kernel's log and its audit records to the process and its children. To them the kernel
 * looks like one without auditing: account tools that cannot write a record otherwise fail.
 *
 * To be called while CAP_SYS_ADMIN is there.
 */
void refuseKernelsRecords();

} // namespace mihost

#endif
