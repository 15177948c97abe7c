#include "mihost/accel/Trust.h"

#include "mihost/sandbox/Descriptor.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdlib>
#include <dlfcn.h>
#include <fcntl.h>
#include <memory>
#include <string>
#include <string_view>
#include <sys/stat.h>

namespace miaccel
{

namespace
{

struct Disturbing {
    std::string_view start; // of NAME=VALUE
    Reason reason;
};

/**
 * Variables that make a shell run another program than the tool, or that change what the tool does.
 * Not listed: POSIXLY_CORRECT, which changes nothing of what these tools print here; TZ and the
 * variables of locales, which date() takes into account; KMOD_LOG, which makes libkmod complain
 * in this process as well.
 */
constexpr Disturbing disturbing[] = {
    {"ENV=", "ENV is set: some shells read that file first"},
    {"BASH_ENV=", "BASH_ENV is set: bash reads that file first"},
    {"BASH_FUNC_", "a function is exported: bash prefers it to a tool"},
    {"BASHOPTS=", "BASHOPTS is set: extdebug makes bash read a file first"},
    {"SHELLOPTS=", "SHELLOPTS is set: noexec keeps bash from running anything"},
    {"LD_", "the loader's LD_ variables change every program"},
};

/** LD_PRELOAD with this library alone, which is how some hosts load it. */
bool preloadsOnlyThis(std::string const& variable)
{
    Dl_info own{};
    return dladdr(reinterpret_cast<void*>(&distrust), &own) != 0 &&
           variable == std::string("LD_PRELOAD=") + own.dli_fname;
}

Reason disturbance(std::string const& variable)
{
    for (Disturbing const& one : disturbing)
        if (variable.compare(0, one.start.size(), one.start) == 0 && !preloadsOnlyThis(variable))
            return one.reason;
    // How bash exported functions before 2014.
    bool const isFunction = variable.find("=() {") != std::string::npos;
    return isFunction ? "a function is exported: bash prefers it to a tool" : nullptr;
}

Reason disturbance()
{
    // A shell drops one of two identities, and may then be unable to read a file.
    if (getuid() != geteuid() || getgid() != getegid())
        return "the real and the effective user or group differ";
    for (char** variable = environ; variable && *variable; ++variable)
        if (Reason const reason = disturbance(*variable))
            return reason;
    return nullptr;
}

std::string directoryOf(std::string const& path)
{
    return path.substr(0, path.rfind('/') + 1);
}

/** Whether only root can write it. Access control lists appear as the group's permissions. */
bool isRootsAlone(std::string const& path)
{
    struct stat state {
    };
    return stat(path.c_str(), &state) == 0 && state.st_uid == 0 &&
           (state.st_mode & (S_IWGRP | S_IWOTH)) == 0;
}

/** Scripts are not. */
bool isBinary(std::string const& path)
{
    mihost::Descriptor const file(open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK));
    std::array<char, 4> magic{};
    return read(file.get(), magic.data(), magic.size()) == ssize_t{magic.size()} &&
           std::string_view(magic.data(), magic.size()) == "\177ELF";
}

struct Program {
    std::string name; // of the file that links lead to
    Reason doubt;     // null: a program that root alone can replace
};

Program programAt(std::string const& path)
{
    std::unique_ptr<char, decltype(&std::free)> const real(realpath(path.c_str(), nullptr),
                                                           &std::free);
    if (!real || access(real.get(), X_OK) != 0)
        return {"", "the shell or the tool cannot be run"};
    std::string const file = real.get();
    std::string const name = file.substr(directoryOf(file).size());
    if (!isRootsAlone(file) || !isRootsAlone(directoryOf(file)) || !isRootsAlone(directoryOf(path)))
        return {name, "users other than root can replace the shell or the tool"};
    return {name, isBinary(file) ? nullptr : "the shell or the tool is a script"};
}

/** The first file of this name along PATH; empty unless it is in a system directory. */
std::string found(std::string const& name)
{
    constexpr std::string_view system[] = {"/usr/bin", "/bin", "/usr/sbin", "/sbin"};
    char const* const variable = std::getenv("PATH");
    std::string const path = variable ? variable : "";
    for (std::size_t begin = 0, end = 0; begin <= path.size(); begin = end + 1) {
        end = std::min(path.find(':', begin), path.size());
        std::string const directory = path.substr(begin, end - begin);
        // An empty entry is the working directory; dash gives % in PATH a special meaning.
        if (directory.empty() || directory[0] != '/' || directory.find('%') != std::string::npos)
            return {};
        std::string candidate = directory;
        candidate.append("/").append(name);
        struct stat state {
        };
        if (lstat(candidate.c_str(), &state) == 0)
            return std::count(std::begin(system), std::end(system), directory) ? candidate : "";
        if (errno != ENOENT && errno != ENOTDIR)
            return {};
    }
    return {};
}

/** busybox may prefer its own tools to PATH's, and its lsmod differs. */
bool isKnownShell(std::string const& name, Tool tool)
{
    return name == "dash" || name == "bash" || (name == "busybox" && tool == Tool::Any);
}

} // namespace

Reason distrust(char const* name, Tool tool)
{
    if (Reason const reason = disturbance())
        return reason;
    Program const shell = programAt("/bin/sh");
    if (shell.doubt)
        return shell.doubt;
    if (!isKnownShell(shell.name, tool))
        return "/bin/sh is not dash, bash or, for some tools, busybox";
    std::string const path = found(name);
    if (path.empty())
        return "PATH does not find the tool in a system directory";
    Program const program = programAt(path);
    bool const isWrong = tool == Tool::Kmod && program.name != "kmod";
    return !program.doubt && isWrong ? "the tool is not a link to kmod" : program.doubt;
}

} // namespace miaccel
