#include "nodes/UserNode.h"

#include "frame/OsSwMI.h"
#include "host/make_string.h"
#include "nodes/ids.h"
#include "nodes/values.h"
#include "sysdata/userInfo_linux.h"
#include "util/MutexLock.h"
#include "util/MyProcess.h"

#include <fstream>

namespace IC
{

namespace
{

using NQ::userInfo;

/** For as long as it lives, user nodes take writes for the builder's own and only store them. */
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
    return NODES::number(static_cast<unsigned int>(value));
}

PropertyValue date(unsigned long seconds)
{
    return NODES::date(static_cast<long>(seconds));
}

void setUserProperties(MutableNode& node, userInfo& user, std::size_t userCount)
{
    std::string const name = user.getUserName();
    std::string const id = user.getUserId();
    std::string const password = user.getUserPassword();
    PropertyValue const inactiveTime = date(user.getPwdInactDays());
    NODES::setProperties(
        node,
        {{NODES::requestedState, NODES::enumeration(1)},
         {NODES::fixedNumbers, NODES::fixedNumberList()},
         {NODES::name, NODES::text(name)},
         {NODES::nameLength, number(name.length())},
         {NODES::id, NODES::text(id)},
         {NODES::idLength, number(id.length())},
         {NODES::groupId, NODES::text(user.getGroupId())},
         {NODES::fullName, NODES::text(user.getUserFullName())},
         {NODES::homeDir, NODES::text(user.getUserHomeDir())},
         {NODES::scriptPath, NODES::text(user.getUserScriptPath())},
         {NODES::password, NODES::text(password)},
         {NODES::passwordLength, number(password.length())},
         {NODES::pwdMaxDays, number(user.getPwdMaxDays())},
         {NODES::pwdWarnDays, number(user.getPwdWarnDays())},
         {NODES::pwdMinDays, number(user.getPwdMinDays())},
         {NODES::pwdExpDays, number(user.getPwdExpDays())},
         {NODES::inactiveTime, inactiveTime},
         {NODES::passwordHistoryDepth,
          number(static_cast<unsigned long>(user.getPasswordHistoryDepth()))},
         {NODES::reservedText, {"", true}},
         {NODES::passwordExpiration, inactiveTime}, // kept: a write gives it its meaning
         {NODES::lastPwdChange, date(user.getLstPwdChg())},
         {NODES::maxLoginFailures, number(static_cast<unsigned long>(user.getMaxLoginFailures()))},
         {NODES::deleteUser, NODES::truth(user.IsDelete())},
         {NODES::elementCount, number(userCount)}});
}

/** Through wide text and back, which is how the host's texts are read. */
std::string textOf(PropertyValue const& value)
{
    return NQ::make_string(NQ::make_wstring(value));
}

std::string textOf(MutableNode const& node, unsigned int id)
{
    PropertyValue value = NODES::emptyValue();
    node.getProperty(id, value);
    return textOf(value);
}

/** Gives an account a new encrypted password by way of a file that chpasswd reads. */
void setPassword(std::string const& user, std::string const& password, char const* function)
{
    std::ofstream file("usrandpwd");
    file << user << ':' << password << std::endl;
    constexpr char const* command = "chpasswd -e < usrandpwd ; rm -f usrandpwd";
    NQ::MyProcess process;
    if (!process.mypopen(command, "r"))
        NQ::LOG::write(OSSWMI::unit, NQ::LOG::error,
                       NQ::LOG::message("Cannot open process: ", command), function);
}

/** Does to the system what a write asks for; nothing, for most properties. */
void act(MutableNode const& node, unsigned int id, PropertyValue const& value, char const* function)
{
    switch (id) {
    case NODES::password:
        setPassword(textOf(node, NODES::name), textOf(value), function);
        break;
    case NODES::inactiveTime:
        userInfo().setInactivityTimeout(textOf(value), textOf(node, NODES::name));
        break;
    case NODES::passwordExpiration:
        userInfo().setPasswordExpiration(textOf(value), textOf(node, NODES::name));
        break;
    case NODES::deleteUser:
        if (static_cast<unsigned int>(value) == 1)
            userInfo().setDelete(textOf(node, NODES::id)); // Contract: by id, not by name
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
    NQ::LOG::write(OSSWMI::unit, NQ::LOG::progress, "UserNode::UserNode: entry");
}

UserNode::~UserNode()
{
    NQ::LOG::writeLast(OSSWMI::unit, "UserNode::~UserNode", ": entry");
}

Error UserNode::getProperty(unsigned int id, PropertyValue& value) const
{
    // Contract: the messages name the class twice, which log filters of hosts expect.
    NQ::LOG::Scope const scope(OSSWMI::unit, {"UserNode::UserNode"});
    if (id != NODES::elementCount)
        return MutableNode::getProperty(id, value);
    std::vector<userInfo> users;
    NQ::getUserInfo(users);
    value = number(users.size());
    return {0, Number(0U), ""};
}

Error UserNode::setProperty(unsigned int const& id, PropertyValue const& value)
{
    NQ::LOG::Scope const scope(OSSWMI::unit, {"UserNode::setProperty"});
    if (!OSSWMI::MI_call)
        act(*this, id, value, __func__);
    return MutableNode::setProperty(id, value);
}

void OsSwMI::createUserNodes(bool refresh)
{
    NQ::LOG::Scope const scope(OSSWMI::unit);
    NQ::MutexLock const lock(OSSWMI::myuserlock);
    dropNodes(userNodes_, refresh, "Delete a user entry: ", __func__);
    std::vector<userInfo> users;
    NQ::getUserInfo(users);
    userNodes_.reserve(users.size());
    unsigned int position = 0;
    for (userInfo& user : users) {
        unsigned int const nodeId = takeNodeId(!refresh);
        auto node = std::make_unique<UserNode>(nodeId, osNode_->getNodeId(), miIds_,
                                               NODES::userType, ++position);
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
