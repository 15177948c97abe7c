#include "frame/ComputerInfo.h"
#include "frame/OsSwMI.h"
#include "host/Properties.h"
#include "nodes/nodeValues.h"

namespace IC
{

void OsSwMI::createOsSwNodes()
{
    NQ::log::Scope const scope(OSSWMI::unit);
    osSwNode_ = adopt(std::make_unique<MutableNode>(miId_, 0, miIds_, nodeType::osSw, 0));
    nodeIds_->push_back(miId_);
    setUp("OsSw Management Interface");
}

void OsSwMI::createRootNode()
{
    NQ::log::Scope const scope(OSSWMI::unit);
    unsigned int const nodeId = takeNodeId();
    rootNode_ = adopt(std::make_unique<MutableNode>(nodeId, miId_, miIds_, nodeType::root, 0));
    nodeIds_->push_back(miId_); // Contract: the interface's own id is in the list twice
    setUp("ROOT Node");
}

void OsSwMI::createComputerNodes()
{
    NQ::log::Scope const scope(OSSWMI::unit);
    unsigned int const nodeId = takeNodeId();
    computerNode_ = adopt(std::make_unique<MutableNode>(nodeId, rootNode_->getNodeId(), miIds_,
                                                        nodeType::computer, 0));
    setUp("Computer");
    std::string name;
    if (NQ::ComputerInfo::getComputerName(name))
        computerNode_->setProperty(property::name, values::text(name));
}

} // namespace IC
