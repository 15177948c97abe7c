// Writes to the operating-system node, and the commands that they start.

#include "frame/OsSwMI.h"
#include "host/Methods.h"
#include "host/Properties.h"
#include "nodes/OsNode.h"
#include "nodes/nodeValues.h"
#include "sysdata/logInfo_linux.h"
#include "sysdata/osInfo_linux.h"

namespace IC
{

namespace
{

bool asksFor(PropertyValue const& value, unsigned int number)
{
    return static_cast<unsigned int>(value) == number;
}

void rebuildAccounts()
{
    pOsSwMI->createUserNodes(true);
    pOsSwMI->createGroupNodes(true);
}

/** Runs the method that the value calls, if any. @return false if it failed */
bool administer(NQ::OsInfo& info, PropertyValue const& value, NQ::log::Scope const& scope)
{
    scope.progress("PropertyType::CreateUser: entry");
    std::string const call = values::textOf(value);
    if (call.empty() || call == "dummy")
        return true;
    if (call.find(parameter::password) == std::string::npos)
        scope.progress("CreateUser: inMethodAndParams = ", call);
    if (!info.setCreateUser(call))
        return false;
    rebuildAccounts();
    return true;
}

} // namespace

Error OsNode::setProperty(unsigned int const& id, PropertyValue const& value)
{
    NQ::log::Scope const scope(OSSWMI::unit, {"OsNode::setProperty"});
    NQ::OsInfo info;
    NQ::logInfo log;
    switch (id) {
    case property::requestedState:
        if (asksFor(value, command::restart))
            info.statusReset();
        else if (asksFor(value, command::halt))
            info.statusOffline();
        break;
    case property::clearLog:
        if (asksFor(value, command::emptyLog) && log.clearLog())
            pOsSwMI->createLogEntryNodes(true);
        break;
    case property::refresh:
        if (asksFor(value, command::rebuild))
            rebuildAccounts();
        break;
    case property::createUser:
        if (!administer(info, value, scope)) {
            MutableNode::setProperty(id, PropertyValue("", true));
            return values::failure();
        }
        break;
    default:
        break;
    }
    return MutableNode::setProperty(id, value);
}

} // namespace IC
