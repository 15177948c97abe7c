#ifndef MIHOST_SANDBOX_MACHINECOPY_H
#define MIHOST_SANDBOX_MACHINECOPY_H

namespace mihost
{

/**
 * Builds the copy of the machine and makes it the calling process's root. Keeps the working
 * directory if the copy has it.
 *
 * Call it from the first process of new mount and process namespaces.
 *
 * @throws std::system_error
 */
void enterMachineCopy();

} // namespace mihost

#endif
