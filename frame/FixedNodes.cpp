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
    osSwNode_ = adopt(std::make_unique<MutableNode>(miId_, 0, miIds_, NODES::osSwType, 0),
                      "OsSw Management Interface");
}

void OsSwMI::createRootNode()
{
    NQ::LOG::Scope const scope(OSSWMI::unit);
    unsigned int const nodeId = takeNodeId();
    nodeIds_->push_back(miId_); // kept: the interface's own id stands in the list twice
    rootNode_ = adopt(std::make_unique<MutableNode>(nodeId, miId_, miIds_, NODES::rootType, 0),
                      "ROOT Node");
}

void OsSwMI::createComputerNodes()
{
    NQ::LOG::Scope const scope(OSSWMI::unit);
    unsigned int const nodeId = takeNodeId();
    computerNode_ = adopt(std::make_unique<MutableNode>(nodeId, rootNode_->getNodeId(), miIds_,
                                                        NODES::computerType, 0),
                          "Computer");
    std::string name;
    if (NQ::ComputerInfo::getComputerName(name))
        computerNode_->setProperty(NODES::name, NODES::text(name));
}

} // namespace IC
