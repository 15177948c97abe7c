#include "frame/OsSwMI.h"
#include "host/Properties.h"
#include "nodes/nodeValues.h"
#include "sysdata/driverInfo_linux.h"

namespace IC
{

void OsSwMI::createDriverNodes()
{
    NQ::log::Scope const scope(OSSWMI::unit);
    std::vector<NQ::driverInfo> drivers;
    NQ::getDriverInfo(drivers);
    unsigned int index = 0;
    for (NQ::driverInfo const& driver : drivers) {
        unsigned int const nodeId = takeNodeId();
        MutableNode* const node = adopt(std::make_unique<MutableNode>(
            nodeId, osNode_->getNodeId(), miIds_, nodeType::driver, ++index));
        setUp(driver.getDescription());
        values::setProperties(*node,
                              {{property::version, values::text(driver.getVersion())},
                               {property::name, values::text(driver.getName())},
                               {property::buildNumber, values::text(driver.getBuildNumber())},
                               {property::manufacturer, values::text(driver.getManufacturer())}});
    }
}

} // namespace IC
