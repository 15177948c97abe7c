// The numbers and words that hosts know, written out once more: a changed one breaks every host.

#include "host/Methods.h"
#include "host/Properties.h"
#include "host/VXLogger.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace contract_numbers_test
{

using Numbers = std::vector<unsigned int>;
using Words = std::vector<std::string>;

TEST(ContractNumbers, NameEachKindOfNode)
{
    namespace t = IC::nodeType;
    EXPECT_EQ((Numbers{t::operatingSystem, t::log, t::osSw, t::computer, t::driver, t::user,
                       t::logEntry, t::group, t::root}),
              (Numbers{17, 35, 39, 40, 44, 46, 47, 51, 59}));
    EXPECT_EQ(IC::statusOk, 1U);
}

TEST(ContractNumbers, NameTheSharedProperties)
{
    namespace p = IC::property;
    EXPECT_EQ(
        (Numbers{p::elementCount, p::id, p::name, p::requestedState, p::fixedNumbers, p::version}),
        (Numbers{51, 89, 108, 123, 125, 134}));
}

TEST(ContractNumbers, NameTheOperatingSystemsProperties)
{
    namespace p = IC::property;
    EXPECT_EQ((Numbers{p::createUser, p::refresh, p::fixedEnumeration, p::clearLog}),
              (Numbers{74, 75, 128, 191}));
    EXPECT_EQ((Numbers{p::installDate, p::distributed, p::lastBootTime, p::processMaxNumber,
                       p::processMaxMemory, p::processCount, p::userCount, p::licensedUserCount,
                       p::virtualMemorySize, p::virtualMemoryFree, p::physicalMemoryFree,
                       p::physicalMemorySize, p::swapFileSize, p::swapFileSizeStored,
                       p::swapFileFree, p::codeSet, p::languageEdition}),
              (Numbers{139, 140, 141, 142, 143, 144, 145, 146, 147, 148, 149, 150, 151, 152, 153,
                       154, 155}));
}

TEST(ContractNumbers, NameTheAccountsProperties)
{
    namespace p = IC::property;
    EXPECT_EQ((Numbers{p::pwdExpDays,       p::idLength,      p::passwordExpiration,
                       p::maxLoginFailures, p::nameLength,    p::reservedText,
                       p::password,         p::inactiveTime,  p::passwordHistoryDepth,
                       p::passwordLength,   p::deleteUser,    p::homeDir,
                       p::scriptPath,       p::lastPwdChange, p::pwdMinDays,
                       p::pwdWarnDays,      p::pwdMaxDays,    p::groupId,
                       p::fullName,         p::members}),
              (Numbers{44,  90,  91,  106, 109, 113, 117, 118, 119, 120,
                       138, 158, 159, 160, 161, 162, 163, 311, 312, 165}));
}

TEST(ContractNumbers, NameTheDriversAndTheLogsProperties)
{
    namespace p = IC::property;
    EXPECT_EQ((Numbers{p::manufacturer, p::buildNumber, p::logNumber, p::creationTime, p::message,
                       p::dataType, p::logState}),
              (Numbers{36, 70, 37, 79, 81, 84, 114}));
}

TEST(ContractNumbers, NameTheCommands)
{
    namespace c = IC::command;
    EXPECT_EQ((Numbers{c::restart, c::halt, c::emptyLog, c::rebuild, c::deleteAccount}),
              (Numbers{9, 12, 9, 0, 1}));
}

TEST(ContractNumbers, NameTheLogLevels)
{
    namespace l = VXLog::level;
    EXPECT_EQ((std::vector<int>{l::progress, l::power, l::error}),
              (std::vector<int>{3000, 4000, 6000}));
}

TEST(ContractWords, NameTheMethods)
{
    namespace m = IC::method;
    EXPECT_EQ(
        (Words{m::userAdd, m::userDel, m::userSetAttrib, m::userSetFullName, m::userSetHomeDir,
               m::userSetPassword, m::userSetScriptPath, m::localGroupAdd, m::localGroupDel,
               m::localGroupAddUser, m::localGroupDelUser, m::getShadowing}),
        (Words{"UserAdd", "UserDel", "UserSetAttrib", "UserSetFullName", "UserSetHomeDir",
               "UserSetPassword", "UserSetScriptPath", "LocalGroupAdd", "LocalGroupDel",
               "LocalGroupAddUser", "LocalGroupDelUser", "GetShadowing"}));
}

TEST(ContractWords, NameTheParametersAndTheirTypes)
{
    namespace p = IC::parameter;
    EXPECT_EQ((Words{p::comment, p::domainAndMember, p::fullName, p::groupName, p::homeDir,
                     p::localGroupName, p::password, p::scriptPath, p::userName}),
              (Words{"Comment", "DomainAndMember", "FullName", "GroupName", "HomeDir",
                     "LocalGroupName", "Password", "ScriptPath", "UserName"}));
    EXPECT_EQ((Words{p::daysExpireAfter, p::daysMustChangePasswordAfter, p::daysMustKeepPassword,
                     p::daysWarnBeforePasswordExpire, p::passwordExpirationDate}),
              (Words{"daysExpireAfter", "daysMustChangePasswordAfter", "daysMustKeepPassword",
                     "daysWarnBeforePasswordExpire", "passwordExpirationDate"}));
    namespace t = IC::parameterType;
    EXPECT_EQ((Words{t::text, t::number, t::date}),
              (Words{"CMPI_string", "CMPI_uint32", "CMPI_dateTime"}));
}

} // namespace contract_numbers_test
