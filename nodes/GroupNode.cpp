#include "nodes/GroupNode.h"

#include "frame/OsSwMI.h"

namespace IC
{

GroupNode::GroupNode(unsigned int nodeId, unsigned int parentId, std::vector<unsigned int> miIds,
                     unsigned int nodeType, unsigned int index)
    : MutableNode(nodeId, parentId, miIds, nodeType, index)
{
    NQ::LOG::write(OSSWMI::unit, NQ::LOG::progress, "GroupNode::GroupNode: entry");
}

GroupNode::~GroupNode()
{
    NQ::LOG::writeLast(OSSWMI::unit, "GroupNode::~GroupNode", ": entry");
}

Error GroupNode::getProperty(unsigned int id, PropertyValue& value) const
{
    NQ::LOG::Scope const scope(OSSWMI::unit, {"GroupNode::getProperty"});
    return MutableNode::getProperty(id, value);
}

void OsSwMI::createGroupNodes(bool)
{
    NQ::LOG::Scope const scope(OSSWMI::unit);
}

} // namespace IC
