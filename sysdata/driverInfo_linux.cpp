#include "sysdata/driverInfo_linux.h"

#include "sysdata/driverInfo_parse.h"
#include "util/MyProcess.h"
#include "util/log.h"
#include "util/textTools.h"

#include <cstdio>
#include <utility>

namespace NQ
{

std::string loggerDriverInfo = "Veltrix.IC.MI.OsSwMI.DriverInfo";

namespace
{

using driverLines::lineSize;

log::Unit const unit{loggerDriverInfo, "driverInfo_linux"};

void readFacts(FILE* modinfo, char const* module, driverInfo& driver, log::Scope const& scope)
{
    driverLines::Seen seen;
    char line[lineSize];
    while (std::fgets(line, sizeof line, modinfo)) {
        scope.progress("buffer2 = ", line);
        if (!driverLines::takeFact(line, driver, seen))
            scope.error("Invalid format: buffer2 = ", line);
    }
    driverLines::complete(driver, seen, module);
}

void addDriver(char const* module, std::vector<driverInfo>& drivers, log::Scope const& scope)
{
    char command[lineSize];
    if (!text::print(command, sizeof command, "modinfo %s", module)) {
        scope.error("Command too long: modinfo ", module);
        return;
    }
    driverInfo driver;
    MyProcess process;
    FILE* const modinfo = process.mypopen(command, "r");
    if (!modinfo) {
        scope.progress("Cannot open process: modinfo");
        return;
    }
    readFacts(modinfo, module, driver, scope);
    drivers.push_back(driver);
}

} // namespace

driverInfo::driverInfo() = default;

std::string driverInfo::getName() const
{
    log::Scope const scope(unit);
    return name_;
}

std::string driverInfo::getVersion() const
{
    log::Scope const scope(unit);
    return version_;
}

std::string driverInfo::getDescription() const
{
    log::Scope const scope(unit);
    return description_;
}

std::string driverInfo::getBuildNumber() const
{
    log::Scope const scope(unit);
    return buildNumber_;
}

std::string driverInfo::getManufacturer() const
{
    log::Scope const scope(unit);
    return manufacturer_;
}

int driverInfo::setName(std::string name)
{
    log::Scope const scope(unit);
    name_ = std::move(name);
    return 1;
}

int driverInfo::setVersion(std::string version)
{
    log::Scope const scope(unit);
    version_ = std::move(version);
    return 1;
}

int driverInfo::setDescription(std::string description)
{
    log::Scope const scope(unit);
    description_ = std::move(description);
    return 1;
}

int driverInfo::setBuildNumber(std::string buildNumber)
{
    log::Scope const scope(unit);
    buildNumber_ = std::move(buildNumber);
    return 1;
}

int driverInfo::setManufacturer(std::string manufacturer)
{
    log::Scope const scope(unit);
    manufacturer_ = std::move(manufacturer);
    return 1;
}

void getDriverInfo(std::vector<driverInfo>& drivers)
{
    log::Scope const scope(unit);
    drivers.clear();
    MyProcess process;
    FILE* const lsmod = process.mypopen("lsmod", "r");
    if (!lsmod) {
        scope.progress("Cannot open process: lsmod");
        return;
    }
    char line[lineSize];
    while (std::fgets(line, sizeof line, lsmod)) {
        scope.progress("buffer = ", line);
        char module[lineSize];
        if (!driverLines::findModule(line, module))
            scope.error("Invalid format: buffer1 = ", line);
        else if (!driverLines::isHeader(module))
            addDriver(module, drivers, scope);
    }
}

} // namespace NQ
