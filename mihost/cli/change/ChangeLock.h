#ifndef MIHOST_CLI_CHANGE_CHANGELOCK_H
#define MIHOST_CLI_CHANGE_CHANGELOCK_H

#include "mihost/sandbox/Descriptor.h"

#include <chrono>
#include <string>

namespace mihost
{

/** Only root can make and open this file, so nobody else can hold the lock. */
constexpr char changeLockFile[] = "/run/mihost.lock";

/** Makes sure that one mihost at a time changes the machine. Ends with the process at the latest.
 */
class ChangeLock
{
public:
    struct Patience {
        std::chrono::milliseconds silent; // after that, standard error says what is waited for
        std::chrono::milliseconds limit;
    };

    /**
     * Waits until no other process holds the lock.
     *
     * @throws Failure (PluginRefused) if the file cannot be opened or the limit is reached
     */
    ChangeLock(std::string const& file, Patience patience);

private:
    Descriptor file_;
};

} // namespace mihost

#endif
