#include "mihost/accel/Resolve.h"

#include "mihost/accel/Environment.h"
#include "mihost/accel/Tool.h"

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <string>
#include <sys/stat.h>

namespace miaccel
{

namespace
{

constexpr char const* shell = "/bin/sh";

constexpr Tool shells[] = {
    {"/usr/bin/dash", "dash", ""},
    {"/usr/bin/bash", "bash", ""},
};

// Versions whose output is known byte for byte: those of Debian 12 and 13.
constexpr char coreutils[] = "9.1- 9.7-";
constexpr char kmod[] = "30+ 34.2-";

/** In the order of Kind. */
constexpr struct {
    char const* name;
    Tool tool;
} commands[] = {
    {"wc", {"/usr/bin/wc", "coreutils", coreutils}},     {"sed", {"/usr/bin/sed", "sed", "4.9-"}},
    {"date", {"/usr/bin/date", "coreutils", coreutils}}, {"lsmod", {"/usr/bin/kmod", "kmod", kmod}},
    {"modinfo", {"/usr/bin/kmod", "kmod", kmod}},
};

/** One folder of a search path: absolute, and with nothing in it that a shell could read specially.
 */
bool isOrdinaryFolder(std::string const& folder)
{
    return !folder.empty() && folder.front() == '/' && folder.find('%') == std::string::npos;
}

/** The first thing of that name along the path, whatever it is; empty where that is not plain. */
std::string search(std::string const& path, std::string const& name)
{
    std::string::size_type begin = 0;
    while (begin <= path.size()) {
        std::string::size_type const end = std::min(path.find(':', begin), path.size());
        std::string candidate = path.substr(begin, end - begin);
        if (!isOrdinaryFolder(candidate))
            return {};
        candidate.append("/").append(name);
        struct stat state {
        };
        if (lstat(candidate.c_str(), &state) == 0)
            return candidate;
        if (errno != ENOENT && errno != ENOTDIR)
            return {};
        begin = end + 1;
    }
    return {};
}

} // namespace

Reason unsure(Kind kind)
{
    if (Reason const reason = disturbance())
        return reason;
    if (std::none_of(std::begin(shells), std::end(shells),
                     [](Tool const& known) { return leadsTo(shell, known); }))
        return "/bin/sh is not a shell as its package installed it";
    char const* const path = std::getenv("PATH");
    auto const& command = commands[static_cast<std::size_t>(kind)];
    if (!path || !leadsTo(search(path, command.name).c_str(), command.tool))
        return "PATH does not lead to the command as its package installed it";
    return nullptr;
}

} // namespace miaccel
