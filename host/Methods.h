#ifndef HOST_METHODS_H
#define HOST_METHODS_H

/*
 * The words of a method-call text, which a host writes to property::createUser of the
 * operating-system node: METHOD,NAME:TYPE:VALUE,NAME:TYPE:VALUE...
 *
 * Contract: none may change, since hosts send them.
 */
namespace IC
{

namespace method
{

constexpr char userAdd[] = "UserAdd";
constexpr char userDel[] = "UserDel";
constexpr char userSetAttrib[] = "UserSetAttrib";
constexpr char userSetFullName[] = "UserSetFullName";
constexpr char userSetHomeDir[] = "UserSetHomeDir";
constexpr char userSetPassword[] = "UserSetPassword";
constexpr char userSetScriptPath[] = "UserSetScriptPath";
constexpr char localGroupAdd[] = "LocalGroupAdd";
constexpr char localGroupDel[] = "LocalGroupDel";
constexpr char localGroupAddUser[] = "LocalGroupAddUser";
constexpr char localGroupDelUser[] = "LocalGroupDelUser";
constexpr char getShadowing[] = "GetShadowing";

} // namespace method

namespace parameter
{

constexpr char comment[] = "Comment";
constexpr char domainAndMember[] = "DomainAndMember";
constexpr char fullName[] = "FullName";
constexpr char groupName[] = "GroupName";
constexpr char homeDir[] = "HomeDir";
constexpr char localGroupName[] = "LocalGroupName";
constexpr char password[] = "Password"; // no text that holds this word is logged
constexpr char scriptPath[] = "ScriptPath";
constexpr char userName[] = "UserName";
constexpr char daysExpireAfter[] = "daysExpireAfter";
constexpr char daysMustChangePasswordAfter[] = "daysMustChangePasswordAfter";
constexpr char daysMustKeepPassword[] = "daysMustKeepPassword";
constexpr char daysWarnBeforePasswordExpire[] = "daysWarnBeforePasswordExpire";
constexpr char passwordExpirationDate[] = "passwordExpirationDate";

} // namespace parameter

namespace parameterType
{

constexpr char text[] = "CMPI_string";
constexpr char number[] = "CMPI_uint32";
constexpr char date[] = "CMPI_dateTime";

} // namespace parameterType

} // namespace IC

#endif
