#include "mihost/sandbox/Power.h"

#include "mihost/sandbox/Content.h"
#include "mihost/sandbox/Sandbox.h"
#include "mihost/sandbox/SystemCall.h"

#include <fcntl.h>
#include <fstream>
#include <sys/stat.h>
#include <unistd.h>

namespace mihost
{

namespace
{

char const* const notes = "/run/power-commands";

// Recorded before it is printed, since printing may fail.
char const* const standIn = "#!/bin/sh\n"
                            "printf '%s\\n' \"$0${*:+ $*}\" >>/run/power-commands\n"
                            "echo \"sandbox: the machine itself would run: $0${*:+ $*}\" >&2\n";

void replace(std::string const& path)
{
    // A link leads to a program that has other uses than to power off.
    if (unlink(path.c_str()) != 0 && errno != ENOENT)
        failed("cannot replace " + path);
    Descriptor const file(check(open(path.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0700),
                                "cannot create " + path));
    writeAll(file, standIn, std::char_traits<char>::length(standIn), path);
    check(fchmod(file.get(), 0755), "cannot set the mode of " + path);
}

} // namespace

void replacePowerCommands()
{
    for (char const* folder : {"/sbin/", "/usr/sbin/", "/bin/", "/usr/bin/"}) {
        for (char const* name : {"shutdown", "reboot", "halt", "poweroff"}) {
            std::string const path = std::string(folder) + name;
            struct stat status {
            };
            if (path == "/sbin/shutdown" || lstat(path.c_str(), &status) == 0)
                replace(path);
        }
    }
}

std::vector<std::string> refusedPowerCommands()
{
    std::vector<std::string> commands;
    std::ifstream file(notes);
    for (std::string line; std::getline(file, line);)
        commands.push_back(line);
    return commands;
}

} // namespace mihost
