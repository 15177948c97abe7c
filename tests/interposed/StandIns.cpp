#include "tests/interposed/StandIns.h"

#include "host/Number.h"
#include "host/PropertyValue.h"
#include "nodes/OsNode.h"
#include "sysdata/logInfo_linux.h"
#include "sysdata/minMaxId.h"
#include "sysdata/osInfo_linux.h"
#include "tests/interpose/Real.h"

StandIns& standIns()
{
    static StandIns inUse;
    return inUse;
}

namespace
{

/** Answers for the getter that calls it. */
template <class Value>
bool answer(std::map<std::string, Value> const& values, Value& out,
            char const* getter = __builtin_FUNCTION())
{
    standIns().calls.emplace_back(getter);
    if (standIns().failing.count(getter) != 0)
        return false;
    auto const found = values.find(getter);
    if (found != values.end())
        out = found->second;
    return true;
}

unsigned int note(unsigned int value, char const* function = __builtin_FUNCTION())
{
    standIns().calls.emplace_back(function);
    return value;
}

} // namespace

bool realGetUserCount(unsigned int& out)
{
    static auto* const real = interpose::real(&NQ::OsInfo::getUserCount);
    NQ::OsInfo info;
    return real(&info, out);
}

bool realGetInstallDate(long& out)
{
    static auto* const real = interpose::real(&NQ::OsInfo::getInstallDate);
    NQ::OsInfo info;
    return real(&info, out);
}

IC::Number::Number(long seconds, unsigned short subSeconds)
    : kind_(DateKind), subSeconds_(subSeconds), value_(seconds)
{
    standIns().dates.emplace_back(seconds, subSeconds);
}

IC::PropertyValue::PropertyValue(char const* text, bool const& flag)
    : kind_(TextKind), flag_(flag), content_(std::string(text))
{
    standIns().literals.emplace_back(text);
}

namespace NQ
{

OsInfo::OsInfo()
{
    standIns().lives.emplace_back("OsInfo made");
}

OsInfo::~OsInfo()
{
    standIns().lives.emplace_back("OsInfo gone");
}

logInfo::logInfo()
{
    standIns().lives.emplace_back("logInfo made");
}

logInfo::~logInfo()
{
    standIns().lives.emplace_back("logInfo gone");
}

bool OsInfo::getDistributed(bool& out)
{
    unsigned int number = 0;
    bool const known = answer(standIns().numbers, number);
    if (known)
        out = number != 0;
    return known;
}

bool OsInfo::getProcessMaxNumber(unsigned int& out)
{
    return answer(standIns().numbers, out);
}

bool OsInfo::getProcessMaxMemory(unsigned int& out)
{
    return answer(standIns().numbers, out);
}

bool OsInfo::getLicensedUserCount(unsigned int& out)
{
    return answer(standIns().numbers, out);
}

bool OsInfo::getVirtualMemorySize(unsigned int& out)
{
    return answer(standIns().numbers, out);
}

bool OsInfo::getVirtualMemoryFree(unsigned int& out)
{
    return answer(standIns().numbers, out);
}

bool OsInfo::getPhysicalMemorySize(unsigned int& out)
{
    return answer(standIns().numbers, out);
}

bool OsInfo::getPhysicalMemoryFree(unsigned int& out)
{
    return answer(standIns().numbers, out);
}

bool OsInfo::getSwapFileSize(unsigned int& out)
{
    return answer(standIns().numbers, out);
}

bool OsInfo::getSwapFileFree(unsigned int& out)
{
    return answer(standIns().numbers, out);
}

bool OsInfo::getSwapFileSizeStored(unsigned int& out)
{
    return answer(standIns().numbers, out);
}

bool OsInfo::getProcessCount(unsigned int& out)
{
    return answer(standIns().numbers, out);
}

bool OsInfo::getUserCount(unsigned int& out)
{
    return answer(standIns().numbers, out);
}

bool OsInfo::getLastBootTime(long& out)
{
    return answer(standIns().times, out);
}

bool OsInfo::getInstallDate(long& out)
{
    return answer(standIns().times, out);
}

bool OsInfo::getOSName(std::string& out)
{
    return answer(standIns().texts, out);
}

bool OsInfo::getOSVersion(std::string& out)
{
    return answer(standIns().texts, out);
}

bool OsInfo::getLanguageEdition(std::string& out)
{
    return answer(standIns().texts, out);
}

bool OsInfo::getCodeSet(std::string& out)
{
    return answer(standIns().texts, out);
}

minMaxId* minMaxId::Instance()
{
    static minMaxId instance;
    standIns().calls.emplace_back("Instance");
    return &instance;
}

unsigned int minMaxId::getMinUserId()
{
    return note(500);
}

unsigned int minMaxId::getMaxUserId()
{
    return note(60000);
}

} // namespace NQ

namespace IC
{

Error OsNode::setProperty(unsigned int const& id, PropertyValue const& value)
{
    static auto* const real =
        interpose::real<Error(OsNode*, unsigned int const&, PropertyValue const&)>();
    standIns().calls.push_back("set " + std::to_string(id));
    return real(this, id, value);
}

} // namespace IC
