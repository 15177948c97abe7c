#include "frame/ComputerInfo.h"
#include "frame/OsSwMI.h"
#include "nodes/ids.h"
#include "nodes/values.h"

namespace IC
{

void OsSwMI::createOsSwNodes()
{
    NQ::LOG::Scope const scope(OSSWMI::unit);
    nodeIds_->push_back(miId_);
    osSwNode_ = new MutableNode(miId_, 0, miIds_, NODES::osSwType, 0);
    adopt(osSwNode_, "OsSw Management Interface");
}

void OsSwMI::createRootNode()
{
    NQ::LOG::Scope const scope(OSSWMI::unit);
    unsigned int const nodeId = takeNodeId();
    rootNode_ = new MutableNode(nodeId, miId_, miIds_, NODES::rootType, 0);
    nodeIds_->push_back(miId_); // kept: the interface's own id stands in the list twice
    adopt(rootNode_, "ROOT Node");
}

void OsSwMI::createComputerNodes()
{
    NQ::LOG::Scope const scope(OSSWMI::unit);
    unsigned int const nodeId = takeNodeId();
    computerNode_ = new MutableNode(nodeId, rootNode_->getNodeId(), miIds_, NODES::computerType, 0);
    adopt(computerNode_, "Computer");
    std::string name;
    if (NQ::ComputerInfo::getComputerName(name))
        computerNode_->setProperty(NODES::name, NODES::text(name));
}

} // namespace IC
