#ifndef MIHOST_CLI_CHANGE_CHANGELOCK_H
#define MIHOST_CLI_CHANGE_CHANGELOCK_H

#include "mihost/sandbox/Descriptor.h"

#include <chrono>
#include <string>

namespace mihost
{

/** Only root can create and open this file, so nobody else can hold the lock. */
constexpr char changeLockFile[] = "/run/mihost.lock";

/** Lets one mihost at a time change the machine. Released at the latest when the process ends. */
class ChangeLock
{
public:
    struct Patience {
        std::chrono::milliseconds silent; // after this time, standard error reports the wait
        std::chrono::milliseconds limit;
    };

    /**
     * Waits until no other process holds the lock.
     *
     * @throws Failure (Failed) if the file cannot be opened or the limit is reached
     */
    ChangeLock(std::string const& file, Patience patience);

private:
    Descriptor file_;
};

} // namespace mihost

#endif
