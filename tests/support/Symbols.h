#ifndef TESTS_SUPPORT_SYMBOLS_H
#define TESTS_SUPPORT_SYMBOLS_H

#include <string>

/**
 * @return the address of one of a loaded library's own symbols, null if it has none of this name
 *
 * @param library  from dlopen
 * @param name     as in C++, such as "IC::OsSwMI::createUserNodes(bool)" or "OpenMI"
 */
void* findSymbol(void* library, std::string const& name);

#endif
