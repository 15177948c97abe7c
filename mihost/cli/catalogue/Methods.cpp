// The administration methods and their parameters.

#include "mihost/cli/catalogue/Rows.h"

namespace mihost
{

namespace
{

using namespace rows;

constexpr Parameter userName = required("UserName", Form::AccountName, "login name");
constexpr Parameter newUserName = required("UserName", Form::PlainName, "login name");
constexpr Parameter groupName = required("GroupName", Form::AccountName, "the group's name");
constexpr Parameter newGroupName = required("GroupName", Form::PlainName, "the group's name");
constexpr Parameter localGroup = required("LocalGroupName", Form::PlainName, "the group's name");
constexpr Parameter member =
    required("DomainAndMember", Form::AccountName, "login name of the member");
constexpr Parameter fullName = required("FullName", Form::Words, "full name");
constexpr char homeMeaning[] = "home directory; made, or moved there with its files";

std::vector<Parameter> const ageing = {
    optional("daysMustKeepPassword", Form::Digits, "days before a password may be changed"),
    optional("daysMustChangePasswordAfter", Form::Digits, "days that a password stays valid"),
    optional("daysWarnBeforePasswordExpire", Form::Digits, "days of warning before it expires"),
    optional("daysExpireAfter", Form::Digits,
             "days from a password's expiry until the account goes inactive"),
    optional("passwordExpirationDate", Form::Day,
             "day on which the account expires; never if not given"),
};

/** The parameters, then those of ageing. */
std::vector<Parameter> withAgeing(std::vector<Parameter> parameters)
{
    parameters.insert(parameters.end(), ageing.begin(), ageing.end());
    return parameters;
}

std::vector<Method> const allMethods = {
    {"UserAdd", "makes a user account and sets its password ageing",
     withAgeing({
         newUserName,
         optional("Comment", Form::Words, "the account's comment field"),
         optional("HomeDir", Form::Path, homeMeaning),
         optional("ScriptPath", Form::Path, "login shell"),
         optional("Password", Form::Password, "plain password"),
     })},
    {"UserDel", "deletes a user account; home directory and mail stay", {userName}},
    {"UserSetAttrib", "sets an account's password ageing", withAgeing({userName})},
    {"UserSetFullName", "sets an account's comment field", {userName, fullName}},
    {"UserSetScriptPath",
     "sets an account's login shell",
     {userName, required("ScriptPath", Form::Path, "login shell")}},
    {"UserSetHomeDir",
     "moves an account's home directory",
     {userName, required("HomeDir", Form::Path, homeMeaning)}},
    {"UserSetPassword",
     "sets an account's password",
     {userName, required("Password", Form::Password, "plain password")}},
    {"LocalGroupAdd", "makes a group", {newGroupName}},
    {"LocalGroupDel", "deletes a group", {groupName}},
    {"LocalGroupAddUser", "adds a user to a group", {localGroup, member}},
    {"LocalGroupDelUser", "removes a user from a group", {localGroup, member}},
    {"GetShadowing", "checks whether the shadow file can be read; the answer is not reported", {}},
};

} // namespace

std::vector<Method> const& methods()
{
    return allMethods;
}

} // namespace mihost
