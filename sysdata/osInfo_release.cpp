// What the distribution's release files say: name, version and install date.

#include "sysdata/osInfo_linux.h"
#include "sysdata/osInfo_log.h"
#include "util/MyProcess.h"
#include "util/file.h"

#include <cstdio>
#include <fstream>
#include <sys/utsname.h>

namespace NQ
{

namespace
{

using files::canOpen;
using os::facts;

#if defined(__GNUC__) && !defined(__clang__)
#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wmismatched-dealloc"
#endif
// Contract: fclose on a command's stream, so the shell's exit status is never read.
void closeAsFile(FILE* pipe)
{
    std::fclose(pipe);
}
#if defined(__GNUC__) && !defined(__clang__)
#pragma GCC diagnostic pop
#endif

struct ReleaseFile {
    char const* path;
    char const* command;
};

constexpr ReleaseFile installDateFiles[] = {
    {"/etc/SuSE-release", "stat /etc/SuSE-release | grep Change"},
    {"/etc/UnitedLinux-release", "stat /etc/UnitedLinux-release | grep Change"},
    {"/etc/redhat-release", "stat /etc/redhat-release | grep Change"},
};

// Contract: another order than for the name and for the install date.
constexpr ReleaseFile versionFiles[] = {
    {"/etc/vmware-release", " cat /etc/vmware-release  | tr -d '[:alpha:][:space:][()]'"},
    {"/etc/redhat-release", "cat /etc/redhat-release  | tr -d '[:alpha:][:space:][()]'"},
    {"/etc/SuSE-release", "echo $(cat /etc/SuSE-release | tr '\\n' ' ' | cut -d ' ' -f 9)."
                          "$(cat /etc/SuSE-release | tr '\\n' ' ' | cut -d ' ' -f 12)"
                          " | tr -d [:space:]"},
};

// Contract: they differ.
constexpr std::size_t shortestMajorLine = 10;
constexpr std::size_t shortestMinorLine = 13;

constexpr char const* nameFiles[] = {"/etc/release", "/etc/vmware-release", "/etc/redhat-release",
                                     "/etc/SuSE-release", "/etc/UnitedLinux-release"};

/**
 * The time in a line of stat, such as "Change: 2010-05-12 10:23:45.000000000 +0200". The fraction
 * and the zone are passed over.
 *
 * @param line  changed in place
 */
long changeTime(OsInfo& info, char* line)
{
    info.strreplace(line, '-', ' ');
    info.strreplace(line, ':', ' ');
    int year = 0, month = 0, day = 0, hour = 0, minute = 0, second = 0;
    std::sscanf(line, "Change  %d %d %d %d %d %d\n", &year, &month, &day, &hour, &minute, &second);
    return static_cast<long>(ito_time_t(year, month, day, 0, hour, minute, second, -1));
}

} // namespace

bool OsInfo::getInstallDate(long& out)
{
    log::Scope const scope(facts);
    out = 0;
    for (ReleaseFile const& candidate : installDateFiles) {
        MyProcess process;
        FILE* output = nullptr;
        {
            files::File const probe(candidate.path, "r");
            if (!probe.stream())
                continue;
            output = process.mypopen(candidate.command, "r");
        }
        char line[1024];
        if (output && std::fgets(line, sizeof line, output))
            out = changeTime(*this, line);
        break;
    }
    return true;
}

bool OsInfo::getOSName(std::string& out)
{
    log::Scope const scope(facts);
    out = "Linux";
    for (char const* path : nameFiles)
        if (getOSReleaseName(path, out))
            break;
    return true;
}

bool OsInfo::getOSReleaseName(std::string path, std::string& out)
{
    log::Scope const scope(facts);
    std::ifstream file(path);
    std::string line;
    if (!std::getline(file, line))
        return false;
    out = line;
    return true;
}

bool OsInfo::getKestoVersion(std::string path, std::string& out)
{
    log::Scope const scope(facts);
    std::ifstream file(path);
    std::string line;
    if (!std::getline(file, line))
        return false;
    if (!std::getline(file, line) || line.size() < shortestMajorLine)
        return false;
    std::string major = line.substr(line.rfind('=') + 1);
    trimString(major);
    if (!std::getline(file, line) || line.size() < shortestMinorLine)
        return false;
    std::string minor = line.substr(line.rfind('=') + 1);
    trimString(minor);
    out = major + "." + minor;
    return true;
}

bool OsInfo::getOSVersion(std::string& out)
{
    log::Scope const scope(facts);
    if (getKestoVersion("/etc/release", out))
        return true;
    if (files::File const file("/etc/UnitedLinux-release", "r"); file.stream()) {
        utsname system{};
        if (uname(&system) != 0)
            return false;
        out = system.release;
        return true;
    }
    for (ReleaseFile const& candidate : versionFiles) {
        if (!canOpen(candidate.path))
            continue;
        FILE* pipe = popen(candidate.command, "r");
        char version[10];
        if (!pipe || !std::fgets(version, sizeof version, pipe))
            return false; // Contract: the stream stays open
        out = version;
        closeAsFile(pipe);
        return true;
    }
    return false;
}

} // namespace NQ
