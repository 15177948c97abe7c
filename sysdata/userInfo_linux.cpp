// The record: fields, and what the shadow file's numbers mean.

#include "sysdata/userInfo_linux.h"

#include "sysdata/userInfo_log.h"
#include "util/MyProcess.h"

#include <utility>

namespace NQ
{

namespace USER_INFO
{

std::string loggerUserInfo = "Veltrix.IC.MI.OsSwMI.UserInfo";
unsigned long const never = 0xFFFFFFFFUL;
log::Unit const unit{loggerUserInfo, "userInfo_linux"};

} // namespace USER_INFO

namespace
{

using USER_INFO::never;
using USER_INFO::unit;

constexpr unsigned long noLimit = 99999;
constexpr unsigned long secondsPerDay = 86400;

/** Days as the shadow file's reader gives them: an empty field has all bits set in full width. */
unsigned long narrowed(unsigned long days)
{
    return days == ~0UL ? never : days;
}

unsigned long unlessNever(unsigned long days, unsigned long otherwise)
{
    return narrowed(days) == never ? otherwise : days;
}

} // namespace

userInfo::userInfo() = default;

userInfo::userInfo(std::string name) : userName_(std::move(name)) {}

std::string userInfo::getUserName()
{
    log::Scope const scope(unit);
    return userName_;
}

std::string userInfo::getUserFullName()
{
    log::Scope const scope(unit);
    return fullName_;
}

void userInfo::setUserFullName(std::string fullName)
{
    log::Scope const scope(unit);
    fullName_ = std::move(fullName);
}

std::string userInfo::getUserHomeDir()
{
    log::Scope const scope(unit);
    return homeDir_;
}

void userInfo::setUserHomeDir(std::string homeDir)
{
    log::Scope const scope(unit);
    homeDir_ = std::move(homeDir);
}

std::string userInfo::getUserScriptPath()
{
    log::Scope const scope(unit);
    return scriptPath_;
}

void userInfo::setUserScriptPath(std::string scriptPath)
{
    log::Scope const scope(unit);
    scriptPath_ = std::move(scriptPath);
}

std::string userInfo::getUserPassword()
{
    log::Scope const scope(unit);
    return password_;
}

void userInfo::setUserPassword(std::string password)
{
    log::Scope const scope(unit);
    password_ = std::move(password);
}

std::string userInfo::getUserId()
{
    log::Scope const scope(unit);
    return userId_;
}

void userInfo::setUserId(std::string userId)
{
    log::Scope const scope(unit);
    userId_ = std::move(userId);
}

std::string userInfo::getGroupId()
{
    log::Scope const scope(unit);
    return groupId_;
}

void userInfo::setGroupId(std::string groupId)
{
    log::Scope const scope(unit);
    groupId_ = std::move(groupId);
}

bool userInfo::IsUserAcctDisabled()
{
    log::Scope const scope(unit);
    return acctDisabled_;
}

void userInfo::setUserAcctDisabled(bool disabled)
{
    log::Scope const scope(unit);
    acctDisabled_ = disabled;
}

bool userInfo::IsDelete()
{
    log::Scope const scope(unit);
    return delete_;
}

unsigned long userInfo::getPwdMinDays()
{
    log::Scope const scope(unit);
    return pwdMinDays_;
}

void userInfo::setPwdMinDays(unsigned long days)
{
    log::Scope const scope(unit);
    pwdMinDays_ = unlessNever(days, 0);
}

unsigned long userInfo::getPwdMaxDays()
{
    log::Scope const scope(unit);
    return pwdMaxDays_;
}

void userInfo::setPwdMaxDays(unsigned long days)
{
    log::Scope const scope(unit);
    pwdMaxDays_ = unlessNever(days, noLimit);
}

unsigned long userInfo::getPwdWarnDays()
{
    log::Scope const scope(unit);
    return pwdWarnDays_;
}

void userInfo::setPwdWarnDays(unsigned long days)
{
    log::Scope const scope(unit);
    pwdWarnDays_ = unlessNever(days, 7);
}

unsigned long userInfo::getPwdExpDays()
{
    log::Scope const scope(unit);
    return pwdExpDays_;
}

void userInfo::setPwdExpDays(unsigned long days)
{
    log::Scope const scope(unit);
    pwdExpDays_ = unlessNever(days, noLimit);
}

unsigned long userInfo::getPwdInactDays()
{
    log::Scope const scope(unit);
    return pwdInactDays_;
}

void userInfo::setPwdInactDays(unsigned long days)
{
    log::Scope const scope(unit);
    char january[] = "Jan";
    if (unlessNever(days, noLimit) == noLimit)
        pwdInactDays_ = static_cast<unsigned long>(to_time_t(2038, january, 19, 0, 0, 0, 0, -1));
    else
        pwdInactDays_ = static_cast<unsigned long>(to_time_t(1970, january, 1, 0, 0, 0, 0, -1)) +
                        days * secondsPerDay;
}

unsigned long userInfo::getLstPwdChg()
{
    log::Scope const scope(unit);
    return lstPwdChg_;
}

void userInfo::setLstPwdChg(unsigned long days)
{
    log::Scope const scope(unit);
    lstPwdChg_ = static_cast<unsigned long>(ito_time_t(1970, 1, 1, 0, 0, 0, 0, -1)) +
                 narrowed(days) * secondsPerDay;
}

long userInfo::getPasswordHistoryDepth()
{
    log::Scope const scope(unit);
    return passwordHistoryDepth_;
}

void userInfo::setPasswordHistoryDepth(long depth)
{
    log::Scope const scope(unit);
    passwordHistoryDepth_ = depth;
}

long userInfo::getMaxLoginFailures()
{
    log::Scope const scope(unit);
    return maxLoginFailures_;
}

void userInfo::setMaxLoginFailures(long failures)
{
    log::Scope const scope(unit);
    maxLoginFailures_ = failures;
}

} // namespace NQ
