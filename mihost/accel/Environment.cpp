#include "mihost/accel/Environment.h"

#include "mihost/accel/FileStamp.h"

#include <algorithm>
#include <cerrno>
#include <dlfcn.h>
#include <optional>
#include <string>
#include <string_view>
#include <unistd.h>

namespace miaccel
{

namespace
{

/** What a variable's name begins with; those with an equals sign are whole names. */
constexpr std::string_view disturbing[] = {
    "ENV=",            // start-up files of shells
    "BASH_ENV=",       //
    "BASH_FUNC_",      // functions handed to a shell
    "BASHOPTS=",       // shell options
    "SHELLOPTS=",      //
    "POSIXLY_CORRECT", // how tools read and write
    "LD_",             // what the dynamic loader puts into every program
    "GLIBC_TUNABLES=", //
    "MALLOC_",         //
    "GCONV_PATH=",     // where libc's data comes from
    "LOCPATH=",        //
    "NLSPATH=",        //
    "TZDIR=",          //
    "KMOD_LOG=",       // what libkmod says on standard error
};

bool beginsWith(std::string_view text, std::string_view start)
{
    return text.substr(0, start.size()) == start;
}

/** LD_PRELOAD with this library alone, which is how some hosts bring it. */
bool preloadsOnlyThis(std::string_view variable)
{
    constexpr std::string_view name = "LD_PRELOAD=";
    if (!beginsWith(variable, name))
        return false;
    Dl_info own{};
    if (dladdr(reinterpret_cast<void*>(&disturbance), &own) == 0)
        return false;
    std::string const named(variable.substr(name.size()));
    std::optional<FileStamp> const preloaded = FileStamp::of(named.c_str());
    std::optional<FileStamp> const self = FileStamp::of(own.dli_fname);
    return preloaded && self && preloaded->isSameFile(*self);
}

bool isPreloadedForAll()
{
    std::optional<FileStamp> const list = FileStamp::of("/etc/ld.so.preload");
    return list ? list->size() > 0 : errno != ENOENT;
}

} // namespace

bool isDisturbing(char const* variable)
{
    std::string_view const text = variable;
    // How bash used to hand on functions.
    if (text.find("=() {") != std::string_view::npos)
        return true;
    bool const named = std::any_of(std::begin(disturbing), std::end(disturbing),
                                   [&](std::string_view start) { return beginsWith(text, start); });
    return named && !preloadsOnlyThis(text);
}

Reason disturbance()
{
    // A shell with two identities gives one of them up, and may read less then.
    if (getuid() != geteuid() || getgid() != getegid())
        return "the real and the effective user or group differ";
    for (char** variable = environ; variable && *variable; ++variable)
        if (isDisturbing(*variable))
            return "the environment changes what commands do";
    if (isPreloadedForAll())
        return "/etc/ld.so.preload changes what commands do";
    return nullptr;
}

} // namespace miaccel
