#ifndef TESTS_SUPPORT_NEXT_H
#define TESTS_SUPPORT_NEXT_H

#include <dlfcn.h>

/**
 * What the program has behind its own definition of a name: the one that it stands in front of.
 *
 * @tparam Function  its type; a member function takes its object as first argument
 * @param name       as the linker knows it
 */
template <class Function> Function* next(char const* name)
{
    return reinterpret_cast<Function*>(dlsym(RTLD_NEXT, name));
}

#endif
