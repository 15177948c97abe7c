#include "mihost/sandbox/MountTable.h"

#include <algorithm>
#include <set>
#include <sstream>

namespace mihost
{

namespace
{

bool isOctal(char character)
{
    return character >= '0' && character <= '7';
}

/** Blanks, tabs, newlines and backslashes stand as \ooo in the table. */
std::string unescaped(std::string const& text)
{
    std::string plain;
    for (std::size_t at = 0; at < text.size(); ++at) {
        std::string const digits = text.substr(at + 1, 3);
        if (text[at] == '\\' && digits.size() == 3 &&
            std::all_of(digits.begin(), digits.end(), isOctal)) {
            plain.push_back(static_cast<char>(std::stoi(digits, nullptr, 8)));
            at += digits.size();
        } else {
            plain.push_back(text[at]);
        }
    }
    return plain;
}

bool isAtOrBelow(std::string const& path, std::string const& folder)
{
    return path.rfind(folder, 0) == 0 &&
           (path.size() == folder.size() || path[folder.size()] == '/');
}

bool hasItsOwnInTheCopy(std::string const& path)
{
    for (char const* folder : {"/proc", "/sys", "/dev", "/run"})
        if (isAtOrBelow(path, folder))
            return true;
    return path == "/";
}

bool isKernelsOwn(std::string const& type)
{
    // Looking into an autofs would mount things on the real machine.
    static std::set<std::string> const types = {
        "autofs", "binfmt_misc", "bpf",        "cgroup",    "cgroup2", "configfs", "debugfs",
        "devpts", "efivarfs",    "fusectl",    "hugetlbfs", "mqueue",  "proc",     "rpc_pipefs",
        "pstore", "nsfs",        "securityfs", "sysfs",     "tracefs"};
    return types.count(type) != 0;
}

} // namespace

std::vector<std::string> mountsToCopy(std::string const& mountInfo)
{
    std::set<std::string> paths;
    std::istringstream lines(mountInfo);
    for (std::string line; std::getline(lines, line);) {
        // id, parent, device, root, mount point, options, any number of tags, "-", type
        std::istringstream fields(line);
        std::string skipped, path, type;
        fields >> skipped >> skipped >> skipped >> skipped >> path;
        while (fields >> skipped && skipped != "-") {
        }
        if (!(fields >> type))
            continue;
        path = unescaped(path);
        if (!hasItsOwnInTheCopy(path) && !isKernelsOwn(type))
            paths.insert(path);
    }
    return {paths.begin(), paths.end()};
}

} // namespace mihost
