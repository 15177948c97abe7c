#ifndef TESTS_INTERPOSE_REAL_H
#define TESTS_INTERPOSE_REAL_H

#include <cstring>

namespace interpose
{

/** The next definition of the function that contains the address. Aborts if there is none. */
void* nextDefinition(void const* address);

/** The function that the program replaces with its own of the same name: real(popen). */
template <class Function> Function* real(Function* own)
{
    return reinterpret_cast<Function*>(nextDefinition(reinterpret_cast<void const*>(own)));
}

/** The same for a member function that is not virtual; its object is the first argument. */
template <class Result, class Class, class... Arguments>
auto real(Result (Class::*own)(Arguments...))
{
    void const* address = nullptr;
    std::memcpy(&address, &own, sizeof address);
    return reinterpret_cast<Result (*)(Class*, Arguments...)>(nextDefinition(address));
}

/**
 * The function that the caller of this replaces; for virtual and overloaded functions.
 *
 * @tparam Function  its type; a member function takes its object as first argument
 */
template <class Function> [[gnu::noinline]] Function* real()
{
    return reinterpret_cast<Function*>(nextDefinition(__builtin_return_address(0)));
}

} // namespace interpose

#endif
