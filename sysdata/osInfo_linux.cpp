#include "sysdata/osInfo_linux.h"

#include "host/make_string.h"
#include "sysdata/minMaxId.h"
#include "sysdata/osInfo_log.h"
#include "util/MyProcess.h"
#include "util/file.h"
#include "util/textTools.h"

#include <algorithm>
#include <cstdlib>
#include <ctime>
#include <langinfo.h>
#include <pwd.h>
#include <shadow.h>
#include <sys/sysinfo.h>

namespace NQ
{

std::string loggerOsInfo = "Veltrix.IC.MI.OsSwMI.OsInfo";

namespace os
{

log::Unit const facts{loggerOsInfo, "OsSwMI"};
log::Unit const methods{loggerOsInfo, "osInfo_linux"};

} // namespace os

namespace
{

using os::facts;
using Figures = struct sysinfo;

void setRam(unsigned long amount, unsigned int memoryUnit, unsigned int& out)
{
    if (memoryUnit == 1)
        out = static_cast<unsigned int>(amount >> 10);
    else if (memoryUnit >= 1024)
        out = (memoryUnit >> 10) * static_cast<unsigned int>(amount);
}

void getRam(unsigned long Figures::*amount, char const* failure, unsigned int& out,
            log::Scope const& scope)
{
    Figures figures{};
    if (sysinfo(&figures) == 0) {
        setRam(figures.*amount, figures.mem_unit, out);
    } else {
        scope.progress(failure);
        out = 0;
    }
}

/** Zeros if the call fails. */
Figures figuresOrZero()
{
    Figures figures{};
    if (sysinfo(&figures) != 0)
        figures = {};
    return figures;
}

std::string environment(char const* name)
{
    return make_string(std::getenv(name));
}

std::string withoutBlanks(std::string text)
{
    std::string::size_type const first = text.find_first_not_of(' ');
    if (first != std::string::npos)
        text.erase(0, first);
    text.erase(text.find_last_not_of(' ') + 1);
    return text;
}

void powerDown(log::Scope const& scope, char const* announcement, char const* command)
{
    scope.power(announcement);
    MyProcess process;
    process.mypopen(command, "r");
}

} // namespace

OsInfo::OsInfo() = default;

OsInfo::~OsInfo() = default;

bool OsInfo::getDistributed(bool& out)
{
    log::Scope const scope(facts);
    out = false;
    return true;
}

bool OsInfo::getProcessMaxNumber(unsigned int& out)
{
    log::Scope const scope(facts);
    out = 32000;
    return true;
}

bool OsInfo::getProcessMaxMemory(unsigned int& out)
{
    log::Scope const scope(facts);
    out = 0;
    return true;
}

bool OsInfo::getLicensedUserCount(unsigned int& out)
{
    log::Scope const scope(facts);
    out = 0;
    return true;
}

bool OsInfo::getVirtualMemorySize(unsigned int& out)
{
    log::Scope const scope(facts);
    out = 0;
    return true;
}

bool OsInfo::getVirtualMemoryFree(unsigned int& out)
{
    log::Scope const scope(facts);
    out = 0;
    return true;
}

bool OsInfo::getOSCreateUser(std::string& out)
{
    log::Scope const scope(facts);
    out.clear();
    return true;
}

bool OsInfo::getPhysicalMemorySize(unsigned int& out)
{
    log::Scope const scope(facts);
    getRam(&Figures::totalram, "physicalMemorySize failed", out, scope);
    return true;
}

bool OsInfo::getPhysicalMemoryFree(unsigned int& out)
{
    log::Scope const scope(facts);
    getRam(&Figures::freeram, "physicalMemoryFree failed", out, scope);
    return true;
}

bool OsInfo::getSwapFileSize(unsigned int& out)
{
    log::Scope const scope(facts);
    out = static_cast<unsigned int>(figuresOrZero().totalswap);
    return true;
}

bool OsInfo::getSwapFileFree(unsigned int& out)
{
    log::Scope const scope(facts);
    out = static_cast<unsigned int>(figuresOrZero().freeswap);
    return true;
}

bool OsInfo::getSwapFileSizeStored(unsigned int& out)
{
    log::Scope const scope(facts);
    Figures const figures = figuresOrZero();
    out = static_cast<unsigned int>(figures.totalswap - figures.freeswap);
    return true;
}

bool OsInfo::getProcessCount(unsigned int& out)
{
    log::Scope const scope(facts);
    out = figuresOrZero().procs;
    return true;
}

bool OsInfo::getLastBootTime(long& out)
{
    log::Scope const scope(facts);
    Figures figures{};
    if (sysinfo(&figures) != 0)
        return false;
    out = static_cast<long>(std::time(nullptr)) - figures.uptime;
    return true;
}

bool OsInfo::getUserCount(unsigned int& out)
{
    log::Scope const scope(facts);
    lckpwdf();
    setpwent();
    minMaxId::Instance(); // read before the accounts, even if there are none
    unsigned int count = 0;
    if (files::File const file("/etc/passwd", "ro"); file.stream()) {
        passwd entry{};
        passwd* found = nullptr;
        char line[4096];
        while (fgetpwent_r(file.stream(), &entry, line, sizeof line, &found) == 0)
            if (isReportedUser(entry.pw_uid))
                ++count;
    }
    ulckpwdf();
    out = count;
    return true;
}

bool OsInfo::getLanguageEdition(std::string& out)
{
    log::Scope const scope(facts);
    std::string language = environment("LANG");
    if (language.empty())
        language = environment("LC_CTYPE");
    language = withoutBlanks(language);
    if (language == "POSIX") {
        out = "en-US";
        return true;
    }
    language.erase(std::min(language.rfind('.'), language.size()));
    std::replace(language.begin(), language.end(), '_', '-');
    out = language;
    return true;
}

bool OsInfo::getCodeSet(std::string& out)
{
    log::Scope const scope(facts);
    std::string codeSet = withoutBlanks(environment("LANG"));
    if (codeSet == "POSIX") {
        out = "UTF-8";
        return true;
    }
    std::string::size_type const dot = codeSet.find('.');
    if (dot != std::string::npos)
        codeSet.erase(0, dot + 1);
    out = codeSet.empty() ? make_string(nl_langinfo(CODESET)) : codeSet;
    return true;
}

void OsInfo::trimString(std::string& text)
{
    log::Scope const scope(facts);
    std::string::size_type const first = text.find_first_not_of(' ');
    if (first == std::string::npos) {
        if (!text.empty())
            text.pop_back();
        return;
    }
    text = text.substr(first, text.find_last_not_of(' ') - first + 1);
}

void OsInfo::strreplace(char* s, char from, char to)
{
    log::Scope const scope(facts);
    text::replaceAfterFirst(s, from, to);
}

bool OsInfo::statusOffline()
{
    log::Scope const scope(facts);
    powerDown(scope, "Halt after shutdown.", "/sbin/shutdown -h now");
    return true;
}

bool OsInfo::statusReset()
{
    log::Scope const scope(facts);
    powerDown(scope, "Reboot after shutdown.", "/sbin/shutdown -r now");
    return true;
}

} // namespace NQ
