#include "nodes/UserNode.h"

#include "frame/OsSwMI.h"
#include "host/Properties.h"
#include "nodes/nodeValues.h"
#include "sysdata/userInfo_linux.h"
#include "util/MutexLock.h"
#include "util/MyProcess.h"

#include <fstream>

namespace IC
{

namespace
{

using NQ::userInfo;

/** While it lives, user nodes only store what is written, as the builder needs. */
class BuilderWrites
{
public:
    BuilderWrites()
    {
        OSSWMI::MI_call = true;
    }
    ~BuilderWrites()
    {
        OSSWMI::MI_call = false;
    }
    BuilderWrites(BuilderWrites const&) = delete;
    BuilderWrites& operator=(BuilderWrites const&) = delete;
};

PropertyValue number(unsigned long value)
{
    return values::number(static_cast<unsigned int>(value));
}

PropertyValue date(unsigned long seconds)
{
    return values::date(static_cast<long>(seconds));
}

void setUserProperties(MutableNode& node, userInfo& user, std::size_t userCount)
{
    std::string const name = user.getUserName();
    std::string const id = user.getUserId();
    std::string const password = user.getUserPassword();
    PropertyValue const inactiveTime = date(user.getPwdInactDays());
    values::setProperties(
        node,
        {{property::requestedState, values::enumeration(1)},
         {property::fixedNumbers, values::fixedNumberList()},
         {property::name, values::text(name)},
         {property::nameLength, number(name.length())},
         {property::id, values::text(id)},
         {property::idLength, number(id.length())},
         {property::groupId, values::text(user.getGroupId())},
         {property::fullName, values::text(user.getUserFullName())},
         {property::homeDir, values::text(user.getUserHomeDir())},
         {property::scriptPath, values::text(user.getUserScriptPath())},
         {property::password, values::text(password)},
         {property::passwordLength, number(password.length())},
         {property::pwdMaxDays, number(user.getPwdMaxDays())},
         {property::pwdWarnDays, number(user.getPwdWarnDays())},
         {property::pwdMinDays, number(user.getPwdMinDays())},
         {property::pwdExpDays, number(user.getPwdExpDays())},
         {property::inactiveTime, inactiveTime},
         {property::passwordHistoryDepth,
          number(static_cast<unsigned long>(user.getPasswordHistoryDepth()))},
         {property::reservedText, {"", true}},
         {property::passwordExpiration, inactiveTime}, // Contract: reads as the account's expiry
         {property::lastPwdChange, date(user.getLstPwdChg())},
         {property::maxLoginFailures,
          number(static_cast<unsigned long>(user.getMaxLoginFailures()))},
         {property::deleteUser, values::truth(user.IsDelete())},
         {property::elementCount, number(userCount)}});
}

std::string textOf(MutableNode const& node, unsigned int id)
{
    PropertyValue value = values::emptyValue();
    node.getProperty(id, value);
    return values::textOf(value);
}

/** Sets an account's encrypted password with chpasswd, which reads it from a file. */
void setPassword(std::string const& user, std::string const& password, NQ::log::Scope const& scope)
{
    std::ofstream file("usrandpwd");
    file << user << ':' << password << std::endl;
    constexpr char const* line = "chpasswd -e < usrandpwd ; rm -f usrandpwd";
    NQ::MyProcess process;
    if (!process.mypopen(line, "r"))
        scope.error("Cannot open process: ", line);
}

/** Carries out a write on the system; most properties have no effect there. */
void act(MutableNode const& node, unsigned int id, PropertyValue const& value,
         NQ::log::Scope const& scope)
{
    switch (id) {
    case property::password:
        setPassword(textOf(node, property::name), values::textOf(value), scope);
        break;
    case property::inactiveTime:
        userInfo().setInactivityTimeout(values::textOf(value), textOf(node, property::name));
        break;
    case property::passwordExpiration:
        userInfo().setPasswordExpiration(values::textOf(value), textOf(node, property::name));
        break;
    case property::deleteUser:
        if (static_cast<unsigned int>(value) == command::deleteAccount)
            userInfo().setDelete(textOf(node, property::id)); // Contract: by id, not by name
        break;
    default:
        break;
    }
}

} // namespace

UserNode::UserNode(unsigned int nodeId, unsigned int parentId, std::vector<unsigned int> miIds,
                   unsigned int nodeType, unsigned int index)
    : MutableNode(nodeId, parentId, miIds, nodeType, index)
{
    NQ::log::entry(OSSWMI::unit, "UserNode::UserNode");
}

UserNode::~UserNode()
{
    NQ::log::lastEntry(OSSWMI::unit, "UserNode::~UserNode");
}

Error UserNode::getProperty(unsigned int id, PropertyValue& value) const
{
    // Contract: logged under the constructor's name, which log filters of hosts expect.
    NQ::log::Scope const scope(OSSWMI::unit, {"UserNode::UserNode"});
    if (id != property::elementCount)
        return MutableNode::getProperty(id, value);
    std::vector<userInfo> users;
    NQ::getUserInfo(users);
    value = number(users.size());
    return {0, Number(0U), ""}; // Contract: elsewhere the code is empty
}

Error UserNode::setProperty(unsigned int const& id, PropertyValue const& value)
{
    NQ::log::Scope const scope(OSSWMI::unit, {"UserNode::setProperty"});
    if (!OSSWMI::MI_call)
        act(*this, id, value, scope);
    return MutableNode::setProperty(id, value);
}

void OsSwMI::createUserNodes(bool refresh)
{
    NQ::log::Scope const scope(OSSWMI::unit);
    NQ::MutexLock const lock(OSSWMI::myuserlock);
    if (refresh)
        deleteNodes(userNodes_, "Delete a user entry: ", scope);
    else
        userNodes_.clear(); // owned by the framework from now on
    std::vector<userInfo> users;
    NQ::getUserInfo(users);
    userNodes_.reserve(users.size());
    unsigned int position = 0;
    for (userInfo& user : users) {
        unsigned int const nodeId = refresh ? takeUnnotedNodeId() : takeNodeId();
        auto node = std::make_unique<UserNode>(nodeId, osNode_->getNodeId(), miIds_, nodeType::user,
                                               ++position);
        {
            BuilderWrites const ours;
            adopt(std::move(node), &userNodes_);
            setUp("User Account");
            setUserProperties(*currentNode_, user, users.size());
        }
        if (refresh)
            publishNode(currentNode_);
    }
}

} // namespace IC
