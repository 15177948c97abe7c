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
    bool Seen::*seen;
};

constexpr Key keys[] = {
    {"version:", &driverInfo::setVersion, &Seen::version},
    {"description:", &driverInfo::setDescription, &Seen::description},
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
        seen.*key.seen = true;
        return true;
    }
    return true;
}

void complete(driverInfo& driver, Seen const& seen, char const* module)
{
    if (!seen.version)
        driver.setVersion("");
    if (!seen.description)
        driver.setDescription("Driver");
    driver.setName(module);
    driver.setBuildNumber("");
    driver.setManufacturer("");
}

} // namespace NQ::driverLines
