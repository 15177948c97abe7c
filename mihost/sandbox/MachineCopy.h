#ifndef MIHOST_SANDBOX_MACHINECOPY_H
#define MIHOST_SANDBOX_MACHINECOPY_H

namespace mihost
{

/**
 * Makes the copy of the machine and makes it the calling process's root, working directory
 * included where the copy has it.
 *
 * To be called by the first process of its own mount and process namespaces.
 *
 * @throws std::system_error
 */
void enterMachineCopy();

} // namespace mihost

#endif
