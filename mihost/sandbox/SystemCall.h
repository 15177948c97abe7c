#ifndef MIHOST_SANDBOX_SYSTEMCALL_H
#define MIHOST_SANDBOX_SYSTEMCALL_H

#include <cerrno>
#include <string>
#include <system_error>

namespace mihost
{

/** Throws errno as std::system_error, with the attempted action. */
[[noreturn]] inline void failed(std::string const& what)
{
    throw std::system_error(errno, std::generic_category(), what);
}

/** @return the result of a system call that yields -1 on failure */
template <class Result> Result check(Result result, std::string const& what)
{
    if (result == -1)
        failed(what);
    return result;
}

} // namespace mihost

#endif
