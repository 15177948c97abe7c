#ifndef MIHOST_SANDBOX_PRIVILEGES_H
#define MIHOST_SANDBOX_PRIVILEGES_H

namespace mihost
{

/** Drops permanently the privileges that affect the machine itself from within the copy. */
void dropMachinePrivileges();

/**
 * Denies the kernel's log and its audit records to the process and its children. The kernel looks
 * to them like one without auditing, since account tools fail if they cannot write a record.
 *
 * Call it while the process has CAP_SYS_ADMIN.
 */
void refuseKernelsRecords();

} // namespace mihost

#endif
