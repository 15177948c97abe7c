#include "sysdata/driverInfo_linux.h"
#include "tests/support/Recording.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace driver_record_test
{

using NQ::driverInfo;

struct Field {
    char const* getter;
    std::string (driverInfo::*get)() const;
    char const* setter;
    int (driverInfo::*set)(std::string);
};

constexpr Field fields[] = {
    {"getName", &driverInfo::getName, "setName", &driverInfo::setName},
    {"getVersion", &driverInfo::getVersion, "setVersion", &driverInfo::setVersion},
    {"getDescription", &driverInfo::getDescription, "setDescription", &driverInfo::setDescription},
    {"getBuildNumber", &driverInfo::getBuildNumber, "setBuildNumber", &driverInfo::setBuildNumber},
    {"getManufacturer", &driverInfo::getManufacturer, "setManufacturer",
     &driverInfo::setManufacturer},
};

TEST(DriverRecord, StartsWithAllFieldsEmpty)
{
    driverInfo const driver;
    for (Field const& field : fields)
        EXPECT_EQ((driver.*field.get)(), "") << field.getter;
}

TEST(DriverRecord, ReturnsOneFromEverySetter)
{
    driverInfo driver;
    for (Field const& field : fields)
        EXPECT_EQ((driver.*field.set)(field.setter), 1);
    for (Field const& field : fields)
        EXPECT_EQ((driver.*field.get)(), field.setter);
}

TEST(DriverRecord, IsCopiedByValue)
{
    driverInfo first;
    first.setName("ext4");
    driverInfo second = first;
    second.setName("xfs");
    EXPECT_EQ(first.getName(), "ext4");
    EXPECT_EQ(second.getName(), "xfs");
}

TEST(DriverRecord, LogsOnlyEntryAndExitOfGettersAndSetters)
{
    Recording recording;
    driverInfo driver;
    driverInfo const copy = driver;
    EXPECT_TRUE(recording.texts().empty());
    for (Field const& field : fields) {
        recording.clear();
        (driver.*field.set)("x");
        (copy.*field.get)();
        EXPECT_EQ(recording.texts(3000),
                  (std::vector<std::string>{std::string(field.setter) + ": entry",
                                            std::string(field.setter) + ": exit",
                                            std::string(field.getter) + ": entry",
                                            std::string(field.getter) + ": exit"}));
        for (std::string const& source : recording.sources())
            EXPECT_NE(source.find(" driverInfo_linux Veltrix.IC.MI.OsSwMI.DriverInfo"),
                      source.npos);
    }
}

} // namespace driver_record_test
