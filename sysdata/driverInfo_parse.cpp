#include "sysdata/driverInfo_parse.h"

#include "sysdata/driverInfo_linux.h"
#include "util/MyProcess.h"

#include <cstdio>
#include <cstring>

namespace NQ::driverLines
{

namespace
{

struct Key {
    char const* name;
    int (driverInfo::*set)(std::string);
    unsigned int Seen::*count;
};

constexpr Key keys[] = {
    {"version:", &driverInfo::setVersion, &Seen::versions},
    {"description:", &driverInfo::setDescription, &Seen::descriptions},
};

} // namespace

bool findModule(char const* line, char (&module)[lineSize])
{
    return std::sscanf(line, "%511s \n", module) == 1;
}

bool isHeader(char const* module)
{
    return std::strncmp(module, "Module", 6) == 0;
}

bool takeFact(char* line, driverInfo& driver, Seen& seen)
{
    for (Key const& key : keys) {
        if (std::strncmp(line, key.name, std::strlen(key.name)) != 0)
            continue;
        char* const space = std::strchr(line, ' ');
        if (!space)
            return false;
        (driver.*key.set)(strget(space, ' '));
        ++(seen.*key.count);
        return true;
    }
    return true;
}

void complete(driverInfo& driver, Seen const& seen, char const* module)
{
    if (seen.versions == 0)
        driver.setVersion("");
    if (seen.descriptions == 0)
        driver.setDescription("Driver");
    driver.setName(module);
    driver.setBuildNumber("");
    driver.setManufacturer("");
}

} // namespace NQ::driverLines
