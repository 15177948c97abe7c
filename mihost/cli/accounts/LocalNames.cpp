#include "mihost/cli/accounts/LocalNames.h"

#include "mihost/cli/system/TextFile.h"
#include "nodes/ids.h"

#include <cstdlib>
#include <sstream>

namespace mihost
{

namespace
{

/** A number of /etc/login.defs as the plug-in finds it; 0 where it has none. */
unsigned long policy(std::string const& key)
{
    unsigned long value = 0;
    for (std::string const& line : linesOf(contentOf("/etc/login.defs")))
        if (line.compare(0, key.size(), key) == 0 && line.size() > key.size())
            value = std::strtoul(line.c_str() + key.size() + 1, nullptr, 10);
    return value;
}

/** The first field of each record whose third is an id of the range, or 0. */
std::vector<std::string> accounts(char const* path, char const* minimum, char const* maximum)
{
    unsigned long const low = policy(minimum);
    unsigned long const high = policy(maximum);
    std::vector<std::string> names;
    for (std::string const& line : linesOf(contentOf(path))) {
        std::istringstream fields(line);
        std::string name;
        std::string password;
        std::string id;
        std::getline(std::getline(std::getline(fields, name, ':'), password, ':'), id, ':');
        bool const isNumber =
            !id.empty() && id.find_first_not_of("0123456789") == std::string::npos;
        unsigned long const number = std::strtoul(id.c_str(), nullptr, 10);
        if (isNumber && (number == 0 || (low <= number && number <= high)))
            names.push_back(name);
    }
    return names;
}

std::vector<std::string> modules()
{
    std::vector<std::string> names;
    for (std::string const& line : linesOf(contentOf("/proc/modules")))
        names.push_back(line.substr(0, line.find(' ')));
    return names;
}

} // namespace

std::vector<std::string> localNames(NodeKind const& kind)
{
    switch (kind.type) {
    case NODES::userType:
        return accounts("/etc/passwd", "UID_MIN", "UID_MAX");
    case NODES::groupType:
        return accounts("/etc/group", "GID_MIN", "GID_MAX");
    case NODES::driverType:
        return modules();
    default:
        return {};
    }
}

} // namespace mihost
