#include "mihost/accel/Packages.h"

#include <algorithm>
#include <array>
#include <fstream>
#include <md5.h>
#include <sstream>

namespace miaccel
{

namespace
{

constexpr char const* database = "/var/lib/dpkg/";

/** Empty where the file cannot be read. */
std::string contents(std::string const& path)
{
    std::ifstream file(path, std::ios::binary | std::ios::ate);
    std::streamoff const size = file ? std::streamoff(file.tellg()) : 0;
    std::string text(static_cast<std::size_t>(std::max(size, std::streamoff(0))), '\0');
    file.seekg(0);
    return file.read(text.data(), size) ? text : std::string();
}

/** The digests of a package's files. One that several architectures can have names its own. */
std::string digestList(std::string const& package, std::string const& architecture)
{
    std::string const start = database + ("info/" + package);
    std::string const list = contents(start + ".md5sums");
    return list.empty() ? contents(start + ':' + architecture + ".md5sums") : list;
}

std::string digestOf(std::string const& path)
{
    std::array<char, MD5_DIGEST_STRING_LENGTH> digest{};
    return MD5File(path.c_str(), digest.data()) ? digest.data() : "";
}

/** A field's value in a stanza; empty where it has none. */
std::string field(std::string const& stanza, std::string const& name)
{
    std::string const key = '\n' + name + ": ";
    std::string::size_type const at = stanza.find(key);
    if (at == std::string::npos)
        return {};
    std::string::size_type const value = at + key.size();
    return stanza.substr(value, stanza.find('\n', value) - value);
}

bool beginsWith(std::string const& text, std::string const& start)
{
    return text.compare(0, start.size(), start) == 0;
}

/** Whether it begins with one of the words, or there are none. */
bool beginsWithOne(std::string const& text, std::string const& words)
{
    std::istringstream starts(words);
    bool isAny = true;
    for (std::string start; starts >> start; isAny = false)
        if (beginsWith(text, start))
            return true;
    return isAny;
}

} // namespace

std::string fieldIn(std::string const& status, std::string const& package, std::string const& name)
{
    std::string const head = "Package: " + package + '\n';
    for (auto at = status.find(head); at != std::string::npos; at = status.find(head, at + 1)) {
        if (at != 0 && status[at - 1] != '\n')
            continue;
        std::string const stanza = status.substr(at, status.find("\n\n", at) - at);
        if (field(stanza, "Status") == "install ok installed")
            return field(stanza, name);
    }
    return {};
}

std::string digestIn(std::string const& list, std::string const& path)
{
    std::string const merged = "/usr/";
    std::string const lines = '\n' + list;
    std::string const names[] = {path.substr(1),
                                 beginsWith(path, merged) ? path.substr(merged.size()) : ""};
    constexpr std::size_t digits = 32;
    for (std::string const& name : names) {
        std::string::size_type const at = lines.find("  " + name + '\n');
        if (!name.empty() && at != std::string::npos && at > digits &&
            lines[at - digits - 1] == '\n')
            return lines.substr(at - digits, digits);
    }
    return {};
}

bool isFromPackage(std::string const& path, std::string const& package, std::string const& versions)
{
    std::string const status = contents(std::string(database) + "status");
    std::string const installed = fieldIn(status, package, "Version");
    if (installed.empty() || !beginsWithOne(installed, versions))
        return false;
    std::string const list = digestList(package, fieldIn(status, package, "Architecture"));
    std::string const listed = digestIn(list, path);
    return !listed.empty() && listed == digestOf(path);
}

} // namespace miaccel
