#ifndef MIHOST_CLI_SYSTEM_FAILURE_H
#define MIHOST_CLI_SYSTEM_FAILURE_H

#include <stdexcept>
#include <string>

namespace mihost
{

enum ExitCode {
    Done = 0,
    PluginRefused = 1, // the plug-in answered with a non-zero status; the doctor misses something
    BadUsage =
        2, // wrong usage, refused input, or a sandbox, trace or output file that cannot be opened
    NoPlugin = 3, // the plug-in cannot be loaded, or has no folder to run in
    NotFound = 4  // no such node or property
};

/** Ends a command: the reason on one line, and the exit code of the program. */
class Failure : public std::runtime_error
{
public:
    Failure(ExitCode code, std::string const& message) : std::runtime_error(message), code_(code) {}

    ExitCode code() const
    {
        return code_;
    }

private:
    ExitCode code_;
};

/** Says on standard error, on one line, what went wrong. */
void tell(Failure const& failure);

} // namespace mihost

#endif
