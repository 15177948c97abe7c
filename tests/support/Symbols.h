#ifndef TESTS_SUPPORT_SYMBOLS_H
#define TESTS_SUPPORT_SYMBOLS_H

#include <string>

/**
 * The address of one of a loaded library's own symbols, null if it has none of this name.
 *
 * @param library  from dlopen
 * @param name     as C++ writes it, such as "IC::OsSwMI::createUserNodes(bool)" or "OpenMI"
 */
void* findSymbol(void* library, std::string const& name);

#endif
