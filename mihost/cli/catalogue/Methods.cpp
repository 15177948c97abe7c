// The administration methods and their parameters.

#include "host/Methods.h"
#include "mihost/cli/catalogue/CatalogueRows.h"

namespace mihost
{

namespace
{

namespace method = IC::method;
namespace parameter = IC::parameter;

using namespace rows;

constexpr Parameter userName = required(parameter::userName, Form::AccountName, "login name");
constexpr Parameter newUserName = required(parameter::userName, Form::PlainName, "login name");
constexpr Parameter groupName =
    required(parameter::groupName, Form::AccountName, "the group's name");
constexpr Parameter newGroupName =
    required(parameter::groupName, Form::PlainName, "the group's name");
constexpr Parameter localGroup =
    required(parameter::localGroupName, Form::PlainName, "the group's name");
constexpr Parameter member =
    required(parameter::domainAndMember, Form::AccountName, "login name of the member");
constexpr Parameter fullName = required(parameter::fullName, Form::Words, "full name");

std::vector<Parameter> const ageing = {
    optional(parameter::daysMustKeepPassword, Form::Digits, "minimum password age, in days"),
    optional(parameter::daysMustChangePasswordAfter, Form::Digits, "maximum password age, in days"),
    optional(parameter::daysWarnBeforePasswordExpire, Form::Digits,
             "days of warning before the password expires"),
    optional(parameter::daysExpireAfter, Form::Digits,
             "days from the password's expiry until the account becomes inactive"),
    optional(parameter::passwordExpirationDate, Form::Day,
             "day on which the account expires; never if not given"),
};

/** The parameters, then those of ageing. */
std::vector<Parameter> withAgeing(std::vector<Parameter> parameters)
{
    parameters.insert(parameters.end(), ageing.begin(), ageing.end());
    return parameters;
}

std::vector<Method> const allMethods = {
    {method::userAdd, "adds a user account and sets its password ageing",
     withAgeing({
         newUserName,
         optional(parameter::comment, Form::Words, "the account's comment field"),
         optional(parameter::homeDir, Form::Path, "home directory, to be created"),
         optional(parameter::scriptPath, Form::Path, "login shell"),
         optional(parameter::password, Form::Password, "plain password"),
     })},
    {method::userDel, "deletes a user account; keeps its home directory and mail", {userName}},
    {method::userSetAttrib, "sets an account's password ageing", withAgeing({userName})},
    {method::userSetFullName, "sets an account's comment field", {userName, fullName}},
    {method::userSetScriptPath,
     "sets an account's login shell",
     {userName, required(parameter::scriptPath, Form::Path, "login shell")}},
    {method::userSetHomeDir,
     "moves an account's home directory",
     {userName, required(parameter::homeDir, Form::Path,
                         "new home directory, to which the files are moved")}},
    {method::userSetPassword,
     "sets an account's password",
     {userName, required(parameter::password, Form::Password, "plain password")}},
    {method::localGroupAdd, "adds a group", {newGroupName}},
    {method::localGroupDel, "deletes a group", {groupName}},
    {method::localGroupAddUser, "adds a user to a group", {localGroup, member}},
    {method::localGroupDelUser, "removes a user from a group", {localGroup, member}},
    {method::getShadowing,
     "checks whether the shadow file can be read; the answer is not reported",
     {}},
};

} // namespace

std::vector<Method> const& methods()
{
    return allMethods;
}

} // namespace mihost
