#ifndef HOST_OPENMI_H
#define HOST_OPENMI_H

#include "host/Error.h"
#include "host/ManagementInterface.h"

/*
 * What a host must provide beyond the declarations of these headers:
 *
 * - Every operation declared here as a symbol that the dynamic linker finds when it loads the
 *   plug-in: in a shared library that the host is linked to, or in a program that exports its
 *   symbols (-rdynamic).
 * - Type information (RTTI) for ManagementInterface and MutableNode. Do not build with -fno-rtti.
 * - The C++ ABI of the plug-in: the Itanium ABI with libstdc++'s C++11 strings. A host that defines
 *   _GLIBCXX_USE_CXX11_ABI as 0 has other symbols.
 * - The layouts. The plug-in creates Error, Number, EnumValue, PropertyValue, VXMessageBuffer and
 *   Mutex by value and calls nothing but their operations: size and alignment are fixed, the
 *   private members are not. It derives from ManagementInterface and MutableNode: their size and
 *   the order of their virtual operations are fixed, and in ManagementInterface the protected
 *   members.
 * - A node list that the plug-in can append to while it builds the tree: the protected nodes_.
 */

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
