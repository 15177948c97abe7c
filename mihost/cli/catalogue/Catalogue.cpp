#include "mihost/cli/catalogue/Catalogue.h"

#include "nodes/ids.h"

#include <algorithm>
#include <cstring>

namespace mihost
{

namespace
{

using P = Property;
using V = IC::PropertyValue;

// clang-format off
Property const requestedState{NODES::requestedState, "requested-state", V::EnumerationKind, "", P::Plain, Form::Digits, "fixed: 1"};
Property const fixedNumbers{NODES::fixedNumbers, "fixed-numbers", V::NumbersKind, "", P::Plain, Form::Digits, "fixed: 0, 1, 24"};

std::vector<Property> const computerProperties = {
    {NODES::name, "computer-name", V::TextKind, "", P::Plain, Form::Free, "the machine's network node name"},
};

std::vector<Property> const osProperties = {
    {NODES::fixedEnumeration, "fixed-enumeration", V::EnumerationKind, "", P::Plain, Form::Digits, "fixed: 35"},
    {NODES::requestedState, "requested-state", V::EnumerationKind, "", P::Acts, Form::Digits, "starts as 1; writing 9 restarts the machine, 12 halts it"},
    fixedNumbers,
    {NODES::name, "os-name", V::TextKind, "", P::Plain, Form::Free, "first line of the distribution's release file, else Linux"},
    {NODES::version, "os-version", V::TextKind, "", P::Plain, Form::Free, "the distribution's version; unset where no release file is known"},
    {NODES::createUser, "create-user", V::TextKind, "", P::Acts | P::MayBeSecret, Form::MethodCall, "writing a method-call text carries out an administration method; empty after a failure"},
    {NODES::refresh, "refresh", V::NumberKind, "", P::Acts, Form::Digits, "writing 0 builds the user and group nodes anew"},
    {NODES::distributed, "distributed", V::BooleanKind, "", P::Plain, Form::Free, "fixed: false"},
    {NODES::processMaxNumber, "process-max-number", V::NumberKind, "processes", P::Plain, Form::Digits, "fixed: 32000"},
    {NODES::processMaxMemory, "process-max-memory", V::NumberKind, "", P::Plain, Form::Digits, "fixed: 0"},
    {NODES::userCount, "user-count", V::NumberKind, "accounts", P::Plain, Form::Digits, "ordinary accounts and those with UID 0, at the start"},
    {NODES::licensedUserCount, "licensed-user-count", V::NumberKind, "accounts", P::Plain, Form::Digits, "fixed: 0"},
    {NODES::virtualMemorySize, "virtual-memory-size", V::NumberKind, "", P::Plain, Form::Digits, "fixed: 0"},
    {NODES::virtualMemoryFree, "virtual-memory-free", V::NumberKind, "", P::Plain, Form::Digits, "fixed: 0"},
    {NODES::languageEdition, "language-edition", V::TextKind, "", P::Plain, Form::Free, "language tag of the locale, such as en-US"},
    {NODES::codeSet, "code-set", V::TextKind, "", P::Plain, Form::Free, "code set of the locale, such as UTF-8"},
    {NODES::processCount, "process-count", V::NumberKind, "processes", P::Live, Form::Digits, "processes at this moment"},
    {NODES::physicalMemoryFree, "physical-memory-free", V::NumberKind, "KiB", P::Live, Form::Digits, "free RAM"},
    {NODES::physicalMemorySize, "physical-memory-size", V::NumberKind, "KiB", P::Live, Form::Digits, "RAM"},
    {NODES::swapFileSize, "swap-size", V::NumberKind, "kernel memory units", P::Live, Form::Digits, "swap space, not scaled; cut to 32 bits"},
    {NODES::swapFileFree, "swap-free", V::NumberKind, "kernel memory units", P::Live, Form::Digits, "free swap space, not scaled; cut to 32 bits"},
    {NODES::swapFileSizeStored, "swap-used", V::NumberKind, "kernel memory units", P::Live, Form::Digits, "swap space in use, not scaled; cut to 32 bits"},
    {NODES::lastBootTime, "last-boot-time", V::DateKind, "", P::Plain, Form::Day, "when the machine was started"},
    {NODES::installDate, "install-date", V::DateKind, "", P::Plain, Form::Day, "last status change of the release file; the epoch where there is none"},
    {NODES::clearLog, "clear-log", V::NumberKind, "", P::Live | P::Unstored | P::Acts, Form::Digits, "always reads 0; writing 9 empties the system log"},
};

std::vector<Property> const driverProperties = {
    {NODES::version, "driver-version", V::TextKind, "", P::Plain, Form::Free, "the module's version; empty where it states none"},
    {NODES::name, "driver-name", V::TextKind, "", P::Plain, Form::Free, "the module's name"},
    {NODES::buildNumber, "build-number", V::TextKind, "", P::Plain, Form::Free, "always empty"},
    {NODES::manufacturer, "manufacturer", V::TextKind, "", P::Plain, Form::Free, "always empty"},
};

std::vector<Property> const userProperties = {
    requestedState,
    fixedNumbers,
    {NODES::name, "user-name", V::TextKind, "", P::Plain, Form::AccountName, "login name; account commands take it from here"},
    {NODES::nameLength, "user-name-length", V::NumberKind, "bytes", P::Plain, Form::Digits, "length of the login name"},
    {NODES::id, "user-id", V::TextKind, "", P::Plain, Form::Digits, "UID in decimal; a delete takes it from here"},
    {NODES::idLength, "user-id-length", V::NumberKind, "bytes", P::Plain, Form::Digits, "length of the UID's text"},
    {NODES::groupId, "group-id", V::TextKind, "", P::Plain, Form::Digits, "GID of the primary group in decimal"},
    {NODES::fullName, "full-name", V::TextKind, "", P::Plain, Form::Free, "the account's comment field"},
    {NODES::homeDir, "home-directory", V::TextKind, "", P::Plain, Form::Free, "home directory"},
    {NODES::scriptPath, "login-shell", V::TextKind, "", P::Plain, Form::Free, "login shell"},
    {NODES::password, "password", V::TextKind, "", P::Acts | P::Secret, Form::Hash, "password hash; writing a hash sets it"},
    {NODES::passwordLength, "password-length", V::NumberKind, "bytes", P::Plain, Form::Digits, "length of the password hash"},
    {NODES::pwdMaxDays, "password-max-days", V::NumberKind, "days", P::Plain, Form::Digits, "how long a password stays valid; 99999 for ever"},
    {NODES::pwdWarnDays, "password-warn-days", V::NumberKind, "days", P::Plain, Form::Digits, "warning before a password expires"},
    {NODES::pwdMinDays, "password-min-days", V::NumberKind, "days", P::Plain, Form::Digits, "wait before a password may be changed"},
    {NODES::pwdExpDays, "password-expiry-days", V::NumberKind, "days", P::Plain, Form::Digits, "from a password's expiry until the account goes inactive; 99999 for never"},
    {NODES::inactiveTime, "inactive-time", V::DateKind, "", P::Acts, Form::Day, "account expiry, 2038-01-19 for never; writing a day makes the account inactive from then on"},
    {NODES::passwordHistoryDepth, "password-history-depth", V::NumberKind, "", P::Plain, Form::Digits, "fixed: 0"},
    {NODES::reservedText, "reserved-text", V::TextKind, "", P::Plain, Form::Free, "fixed: empty"},
    {NODES::passwordExpiration, "password-expiration", V::DateKind, "", P::Acts, Form::Day, "account expiry, as inactive-time; writing a day lets the password expire then"},
    {NODES::lastPwdChange, "last-password-change", V::DateKind, "", P::Plain, Form::Day, "when the password was last changed"},
    {NODES::maxLoginFailures, "max-login-failures", V::NumberKind, "", P::Plain, Form::Digits, "the deny= of /etc/pam.d/login, 0 for none"},
    {NODES::deleteUser, "delete", V::BooleanKind, "", P::Acts, Form::Free, "reads false; writing true deletes the account that is named like this UID, home directory included"},
    {NODES::elementCount, "user-count", V::NumberKind, "accounts", P::Live, Form::Digits, "reported accounts at this moment"},
};

std::vector<Property> const groupProperties = {
    {NODES::name, "group-name", V::TextKind, "", P::Plain, Form::Free, "the group's name"},
    {NODES::id, "group-id", V::NumberKind, "", P::Plain, Form::Digits, "GID"},
    {NODES::members, "members", V::TextsKind, "", P::Plain, Form::Free, "login names: those whose primary group it is, then those it lists"},
    {NODES::elementCount, "group-count", V::NumberKind, "groups", P::Live, Form::Digits, "reported groups at this moment"},
};

std::vector<Property> const logProperties = {
    requestedState,
    fixedNumbers,
    {NODES::logNumber, "log-number", V::NumberKind, "", P::Plain, Form::Digits, "fixed: 0"},
    {NODES::name, "log-name", V::TextKind, "", P::Plain, Form::Free, "fixed: OS Log"},
    {NODES::logState, "log-state", V::EnumerationKind, "", P::Plain, Form::Digits, "fixed: 2"},
    {NODES::dataType, "data-type", V::TextKind, "", P::Plain, Form::Free, "fixed: *string LogData*"},
};

std::vector<Property> const logEntryProperties = {
    {NODES::id, "index", V::NumberKind, "", P::Live, Form::Digits, "position counted from the newest line, which is 1"},
    {NODES::message, "message", V::TextKind, "", P::Live, Form::Free, "the line without its time stamp, between asterisks"},
    {NODES::creationTime, "time", V::DateKind, "", P::Live, Form::Day, "the line's time stamp, read as local time"},
};

std::vector<NodeKind> const kinds = {
    {NODES::osSwType, "mi", "mi", true, "", 0, 0, "the management interface itself", {}, {}},
    {NODES::rootType, "root", "root", true, "", 0, 0, "root of the machine's tree", {}, {}},
    {NODES::computerType, "computer", "computer", true, "", 0, NODES::name, "the machine", {}, computerProperties},
    {NODES::operatingSystemType, "os", "os", true, "", 0, NODES::name, "the operating system: facts, commands and methods", {}, osProperties},
    {NODES::driverType, "driver", "driver", false, "drivers", NODES::name, NODES::version, "a loaded kernel module", {"driver-name", "driver-version", "description"}, driverProperties},
    {NODES::userType, "user", "user", false, "users", NODES::name, NODES::fullName, "a local user account: ordinary ones and those with UID 0", {"user-name", "user-id", "group-id", "full-name", "home-directory", "login-shell"}, userProperties},
    {NODES::groupType, "group", "group", false, "groups", NODES::name, NODES::members, "a local group: ordinary ones and GID 0", {"group-name", "group-id", "members"}, groupProperties},
    {NODES::logType, "log", "log", true, "", 0, 0, "the system log, /var/log/messages", {}, logProperties},
    {NODES::logEntryType, "log-entry", "log", false, "log", NODES::id, NODES::message, "one of the 50 newest lines of the system log", {"index", "time", "message"}, logEntryProperties},
};

constexpr char const* text = "CMPI_string";
constexpr char const* number = "CMPI_uint32";
constexpr char const* date = "CMPI_dateTime";

Parameter const userName{"UserName", text, Form::AccountName, true, "login name"};
Parameter const newUserName{"UserName", text, Form::PlainName, true, "login name"};
Parameter const groupName{"GroupName", text, Form::AccountName, true, "the group's name"};
Parameter const newGroupName{"GroupName", text, Form::PlainName, true, "the group's name"};
Parameter const comment{"Comment", text, Form::Words, false, "the account's comment field"};
Parameter const homeDir{"HomeDir", text, Form::Path, false, "home directory; made, or moved there with its files"};
Parameter const scriptPath{"ScriptPath", text, Form::Path, false, "login shell"};
Parameter const password{"Password", text, Form::Password, false, "plain password"};
Parameter const minDays{"daysMustKeepPassword", number, Form::Digits, false, "days before a password may be changed"};
Parameter const maxDays{"daysMustChangePasswordAfter", number, Form::Digits, false, "days that a password stays valid"};
Parameter const warnDays{"daysWarnBeforePasswordExpire", number, Form::Digits, false, "days of warning before it expires"};
Parameter const expireDays{"daysExpireAfter", number, Form::Digits, false, "days from a password's expiry until the account goes inactive"};
Parameter const expirationDate{"passwordExpirationDate", date, Form::Day, false, "day on which the account expires; never, where it is not given"};
Parameter const localGroup{"LocalGroupName", text, Form::PlainName, true, "the group's name"};
Parameter const member{"DomainAndMember", text, Form::AccountName, true, "login name of the member"};

Parameter required(Parameter parameter)
{
    parameter.required = true;
    return parameter;
}

std::vector<Method> const allMethods = {
    {"UserAdd", "makes a user account and sets its password ageing",
     {newUserName, comment, homeDir, scriptPath, password, minDays, maxDays, warnDays, expireDays, expirationDate}},
    {"UserDel", "deletes a user account; home directory and mail stay", {userName}},
    {"UserSetAttrib", "sets an account's password ageing", {userName, minDays, maxDays, warnDays, expireDays, expirationDate}},
    {"UserSetFullName", "sets an account's comment field", {userName, {"FullName", text, Form::Words, true, "full name"}}},
    {"UserSetScriptPath", "sets an account's login shell", {userName, required(scriptPath)}},
    {"UserSetHomeDir", "moves an account's home directory", {userName, required(homeDir)}},
    {"UserSetPassword", "sets an account's password", {userName, required(password)}},
    {"LocalGroupAdd", "makes a group", {newGroupName}},
    {"LocalGroupDel", "deletes a group", {groupName}},
    {"LocalGroupAddUser", "adds a user to a group", {localGroup, member}},
    {"LocalGroupDelUser", "takes a user out of a group", {localGroup, member}},
    {"GetShadowing", "asks whether the shadow file can be read; the answer reaches nobody", {}},
};
// clang-format on

template <class Rows, class Matches> auto const* find(Rows const& rows, Matches matches)
{
    auto const found = std::find_if(rows.begin(), rows.end(), matches);
    return found == rows.end() ? nullptr : &*found;
}

} // namespace

std::vector<NodeKind> const& nodeKinds()
{
    return kinds;
}

std::vector<Method> const& methods()
{
    return allMethods;
}

NodeKind const* findKind(unsigned int nodeType)
{
    return find(kinds, [nodeType](NodeKind const& kind) { return kind.type == nodeType; });
}

NodeKind const* findList(std::string_view name)
{
    return find(kinds,
                [name](NodeKind const& kind) { return !name.empty() && kind.listName == name; });
}

Property const* findProperty(NodeKind const& kind, unsigned int id)
{
    return find(kind.properties, [id](Property const& property) { return property.id == id; });
}

Property const* findProperty(NodeKind const& kind, std::string_view name)
{
    return find(kind.properties,
                [name](Property const& property) { return property.name == name; });
}

Method const* findMethod(std::string_view name)
{
    return find(allMethods, [name](Method const& method) { return method.name == name; });
}

Parameter const* findParameter(Method const& method, std::string_view name)
{
    return find(method.parameters,
                [name](Parameter const& parameter) { return parameter.name == name; });
}

char const* kindName(unsigned int nodeType)
{
    NodeKind const* kind = findKind(nodeType);
    return kind ? kind->name : "unknown";
}

char const* valueKindName(ValueKind kind)
{
    static constexpr char const* names[] = {"empty", "text",        "number",  "boolean",
                                            "date",  "enumeration", "numbers", "texts"};
    return names[kind];
}

} // namespace mihost
