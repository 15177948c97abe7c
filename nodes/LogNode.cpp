#include "frame/OsSwMI.h"
#include "host/Properties.h"
#include "nodes/nodeValues.h"

namespace IC
{

void OsSwMI::createLogNodes()
{
    NQ::log::Scope const scope(OSSWMI::unit);
    unsigned int const nodeId = takeNodeId();
    logNode_ = adopt(
        std::make_unique<MutableNode>(nodeId, osNode_->getNodeId(), miIds_, nodeType::log, 0));
    setUp("OS Log");
    values::setProperties(*logNode_, {{property::requestedState, values::enumeration(1)},
                                      {property::fixedNumbers, values::fixedNumberList()},
                                      {property::logNumber, values::number(0)},
                                      {property::name, values::text("OS Log")},
                                      {property::logState, values::enumeration(2)},
                                      {property::dataType, values::text("*string LogData*")}});
}

} // namespace IC
