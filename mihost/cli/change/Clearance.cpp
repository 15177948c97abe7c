#include "mihost/cli/change/Clearance.h"

namespace mihost
{

namespace
{

constexpr std::chrono::milliseconds silence{500};

} // namespace

ChangeLock clearChange(Session const& session, std::string const& command,
                       std::string const& danger, MachineCheck const& check)
{
    if (!danger.empty()) {
        check();
        session.confirm(command, danger);
    }
    ChangeLock lock(changeLockFile, {silence, std::chrono::seconds(session.options().lockTimeout)});
    check();
    return lock;
}

} // namespace mihost
