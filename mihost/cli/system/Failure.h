#ifndef MIHOST_CLI_SYSTEM_FAILURE_H
#define MIHOST_CLI_SYSTEM_FAILURE_H

#include <stdexcept>
#include <string>

namespace mihost
{

enum ExitCode {
    Done = 0,
    Failed = 1,   // the read, the change or a check
    BadUsage = 2, // also refused input, and a sandbox, trace or output file that cannot be opened
    NoPlugin = 3, // it cannot be loaded, or has no directory to run in
    NotFound = 4  // no such node, property, account or group
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
