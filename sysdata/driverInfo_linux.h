#ifndef SYSDATA_DRIVERINFO_LINUX_H
#define SYSDATA_DRIVERINFO_LINUX_H

#include <string>
#include <vector>

namespace NQ
{

/** Logger category of this source unit. */
extern std::string loggerDriverInfo;

/** One loaded kernel module. A value record; its setters always return 1. */
class driverInfo
{
public:
    driverInfo();

    std::string getName() const;
    std::string getVersion() const;
    std::string getDescription() const;
    std::string getBuildNumber() const;
    std::string getManufacturer() const;

    int setName(std::string name);
    int setVersion(std::string version);
    int setDescription(std::string description);
    int setBuildNumber(std::string buildNumber);
    int setManufacturer(std::string manufacturer);

private:
    std::string name_;
    std::string version_;
    std::string description_;
    std::string buildNumber_;
    std::string manufacturer_;
};

/**
 * Lists the loaded kernel modules in the order of lsmod, each as modinfo describes it.
 *
 * Runs one modinfo for each module, one after the other, while lsmod is still being read. A module
 * that modinfo cannot be started for is left out; one that it does not know has no version and the
 * description "Driver".
 *
 * @param drivers  its contents are replaced; empty if lsmod cannot be started
 */
void getDriverInfo(std::vector<driverInfo>& drivers);

} // namespace NQ

#endif
