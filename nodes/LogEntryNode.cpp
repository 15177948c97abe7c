#include "nodes/LogEntryNode.h"

#include "frame/OsSwMI.h"

namespace IC
{

LogEntryNode::LogEntryNode(unsigned int nodeId, unsigned int parentId,
                           std::vector<unsigned int> miIds, unsigned int nodeType,
                           unsigned int index)
    : MutableNode(nodeId, parentId, miIds, nodeType, index)
{
    NQ::LOG::write(OSSWMI::unit, NQ::LOG::progress, "LogEntryNode::LogEntryNode: entry");
}

LogEntryNode::~LogEntryNode()
{
    NQ::LOG::writeLast(OSSWMI::unit, "LogEntryNode::~LogEntryNode", ": entry");
}

Error LogEntryNode::getProperty(unsigned int id, PropertyValue& value) const
{
    NQ::LOG::Scope const scope(OSSWMI::unit, {"LogEntryNode::getProperty"});
    return MutableNode::getProperty(id, value);
}

Error LogEntryNode::setProperty(unsigned int const& id, PropertyValue const& value)
{
    NQ::LOG::Scope const scope(OSSWMI::unit, {"LogEntryNode::setProperty"});
    return MutableNode::setProperty(id, value);
}
void OsSwMI::createLogEntryNodes(bool)
{
    NQ::LOG::Scope const scope(OSSWMI::unit);
}

} // namespace IC
