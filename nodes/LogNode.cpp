#include "frame/OsSwMI.h"
#include "nodes/ids.h"
#include "nodes/values.h"

namespace IC
{

void OsSwMI::createLogNodes()
{
    NQ::LOG::Scope const scope(OSSWMI::unit);
    unsigned int const nodeId = takeNodeId();
    logNode_ = adopt(
        std::make_unique<MutableNode>(nodeId, osNode_->getNodeId(), miIds_, NODES::logType, 0));
    setUp("OS Log");
    NODES::setProperties(*logNode_, {{NODES::requestedState, NODES::enumeration(1)},
                                     {NODES::fixedNumbers, NODES::fixedNumberList()},
                                     {NODES::logNumber, NODES::number(0)},
                                     {NODES::name, NODES::text("OS Log")},
                                     {NODES::logState, NODES::enumeration(2)},
                                     {NODES::dataType, NODES::text("*string LogData*")}});
}

} // namespace IC
