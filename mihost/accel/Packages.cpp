#include "mihost/accel/Packages.h"

#include <array>
#include <fstream>
#include <glob.h>
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
    std::ifstream file(path, std::ios::binary);
    std::ostringstream text;
    text << file.rdbuf();
    return text.str();
}

/** The digests of all files of a package. One that several architectures can have names its own. */
std::string digestList(std::string const& package)
{
    std::string const pattern = database + ("info/" + package) + "{,:*}.md5sums";
    glob_t found{};
    std::string list;
    if (glob(pattern.c_str(), GLOB_BRACE, nullptr, &found) == 0)
        for (std::size_t i = 0; i < found.gl_pathc; ++i)
            list += contents(found.gl_pathv[i]);
    globfree(&found);
    return list;
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

} // namespace

std::string versionIn(std::string const& status, std::string const& package)
{
    std::string const head = "Package: " + package + '\n';
    for (auto at = status.find(head); at != std::string::npos; at = status.find(head, at + 1)) {
        if (at != 0 && status[at - 1] != '\n')
            continue;
        std::string const stanza = status.substr(at, status.find("\n\n", at) - at);
        if (field(stanza, "Status") == "install ok installed")
            return field(stanza, "Version");
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

bool isFromPackage(std::string const& path, std::string const& package, std::string const& version)
{
    std::string const installed = versionIn(contents(std::string(database) + "status"), package);
    if (installed.empty() || !beginsWith(installed, version))
        return false;
    std::string const listed = digestIn(digestList(package), path);
    return !listed.empty() && listed == digestOf(path);
}

} // namespace miaccel
