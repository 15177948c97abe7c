#include "frame/OsSwMI.h"
#include "nodes/ids.h"
#include "nodes/values.h"
#include "sysdata/driverInfo_linux.h"

namespace IC
{

void OsSwMI::createDriverNodes()
{
    NQ::LOG::Scope const scope(OSSWMI::unit);
    std::vector<NQ::driverInfo> drivers;
    NQ::getDriverInfo(drivers);
    unsigned int index = 0;
    for (NQ::driverInfo const& driver : drivers) {
        unsigned int const nodeId = takeNodeId();
        MutableNode* const node = adopt(std::make_unique<MutableNode>(
            nodeId, osNode_->getNodeId(), miIds_, NODES::driverType, ++index));
        setUp(driver.getDescription());
        NODES::setProperties(*node, {{NODES::version, NODES::text(driver.getVersion())},
                                     {NODES::name, NODES::text(driver.getName())},
                                     {NODES::buildNumber, NODES::text(driver.getBuildNumber())},
                                     {NODES::manufacturer, NODES::text(driver.getManufacturer())}});
    }
}

} // namespace IC
