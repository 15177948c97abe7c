#include "nodes/UserNode.h"

#include "frame/OsSwMI.h"

namespace IC
{

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
    // Kept: the messages name the class twice; hosts rely on it.
    NQ::LOG::Scope const scope(OSSWMI::unit, {"UserNode::UserNode"});
    return MutableNode::getProperty(id, value);
}

Error UserNode::setProperty(unsigned int const& id, PropertyValue const& value)
{
    NQ::LOG::Scope const scope(OSSWMI::unit, {"UserNode::setProperty"});
    return MutableNode::setProperty(id, value);
}
void OsSwMI::createUserNodes(bool)
{
    NQ::LOG::Scope const scope(OSSWMI::unit);
}

} // namespace IC
