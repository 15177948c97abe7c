#include "sysdata/osInfo_commands.h"

#include "host/Methods.h"
#include "sysdata/osInfo_log.h"

#include <algorithm>
#include <iterator>

namespace NQ::os
{

namespace
{

namespace method = IC::method;
namespace parameter = IC::parameter;
namespace parameterType = IC::parameterType;

constexpr std::size_t argumentLimit = 39;
constexpr std::size_t lengthLimit = 254;

struct TypeName {
    char const* name;
    ParamType type;
};

constexpr TypeName typeNames[] = {
    {parameterType::text, ParamType::text},
    {parameterType::number, ParamType::number},
    {parameterType::date, ParamType::date},
};

constexpr Method methodTable[] = {
    {method::userAdd, MethodKind::userAdd, "/usr/sbin/useradd", AccountName::amongOthers},
    {method::userDel, MethodKind::userDel, "/usr/sbin/userdel", AccountName::amongOthers},
    {method::userSetAttrib, MethodKind::userSetAttrib, "/usr/bin/chage", AccountName::amongOthers},
    {method::localGroupAdd, MethodKind::plain, "/usr/sbin/groupadd"},
    {method::localGroupDel, MethodKind::plain, "/usr/sbin/groupdel"},
    {method::getShadowing, MethodKind::getShadowing},
    {method::localGroupAddUser, MethodKind::groupMembership},
    {method::localGroupDelUser, MethodKind::groupMembership},
    {method::userSetFullName, MethodKind::userSetFullName, "/usr/sbin/usermod", AccountName::last},
    {method::userSetScriptPath, MethodKind::plain, "/usr/sbin/usermod", AccountName::last},
    {method::userSetHomeDir, MethodKind::plain, "/usr/sbin/usermod", AccountName::last},
    {method::userSetPassword, MethodKind::plain, "/usr/sbin/usermod", AccountName::last},
};

enum class Item { plain, fullName, scriptPath, homeDir, password, userName, expiry };

struct Option {
    ParamType type;
    char const* name;
    Item item;
    char const* flag; // null: the value stands alone
};

constexpr Option options[] = {
    {ParamType::text, parameter::fullName, Item::fullName, "-c"},
    {ParamType::text, parameter::comment, Item::plain, "-c"},
    {ParamType::text, parameter::scriptPath, Item::scriptPath, "-s"},
    {ParamType::text, parameter::homeDir, Item::homeDir, "-d"},
    {ParamType::text, parameter::password, Item::password, "-p"},
    {ParamType::text, parameter::userName, Item::userName, nullptr},
    {ParamType::text, parameter::groupName, Item::plain, nullptr},
    {ParamType::number, parameter::daysMustKeepPassword, Item::plain, "-m"},
    {ParamType::number, parameter::daysMustChangePasswordAfter, Item::plain, "-M"},
    {ParamType::number, parameter::daysWarnBeforePasswordExpire, Item::plain, "-W"},
    {ParamType::number, parameter::daysExpireAfter, Item::plain, "-I"},
    {ParamType::date, parameter::passwordExpirationDate, Item::expiry, "-E"},
};

Option const* findOption(ParamType type, std::string const& name)
{
    auto const found =
        std::find_if(std::begin(options), std::end(options), [&](Option const& option) {
            return option.type == type && name == option.name;
        });
    return found == std::end(options) ? nullptr : found;
}

void addText(Method const& method, Option const& option, std::string const& value,
             Commands& commands)
{
    if (option.item == Item::fullName && method.kind != MethodKind::userSetFullName)
        return;
    if (option.item == Item::password)
        commands.password = value;
    if (option.item == Item::userName) {
        commands.user = value;
        if (method.accountName == AccountName::last)
            return;
    }
    bool const path = option.item == Item::scriptPath || option.item == Item::homeDir;
    if (path && value.empty())
        return;
    if (option.flag)
        commands.main.emplace_back(option.flag);
    commands.main.push_back(withEscapedBlanks(value));
    if (option.item == Item::homeDir)
        commands.main.emplace_back("-m");
}

/** @return false for a parameter of an unknown type, which the complaint then names */
bool addParams(Method const& method, std::vector<ParamInfo> const& params, Commands& commands,
               Complaint& complaint)
{
    bool const adding = method.kind == MethodKind::userAdd;
    Arguments& aged = adding ? commands.aging : commands.main;
    for (ParamInfo const& param : params) {
        ParamType const type = typeOf(param.type);
        if (type == ParamType::unknown) {
            complaint = {unknownType, param.type};
            return false;
        }
        Option const* option = findOption(type, param.name);
        if (!option)
            continue;
        if (type == ParamType::text) {
            addText(method, *option, param.value, commands);
            continue;
        }
        aged.insert(aged.end(), {option->flag, param.value});
        if (option->item == Item::expiry)
            commands.expires = true;
    }
    return true;
}

void removeExpiry(Arguments& arguments)
{
    arguments.insert(arguments.end(), {"-E", "-1"});
}

/** @return false if the account must not be deleted */
bool closeLists(Method const& method, Commands& commands)
{
    if (method.kind == MethodKind::userAdd && !commands.expires)
        removeExpiry(commands.aging);
    if (method.accountName != AccountName::nowhere) {
        // Contract: the quotes differ, so this never holds and root can be deleted.
        if (method.kind == MethodKind::userDel && "'" + commands.user + "'" == "\"root\"")
            return false;
        commands.aging.push_back(commands.user);
        if (method.accountName == AccountName::last)
            commands.main.push_back(commands.user);
    }
    if (method.kind == MethodKind::userSetAttrib && !commands.expires)
        removeExpiry(commands.main);
    return true;
}

bool fits(Arguments const& arguments)
{
    return arguments.size() <= argumentLimit + 1 &&
           std::all_of(arguments.begin(), arguments.end(),
                       [](std::string const& entry) { return entry.size() <= lengthLimit; }) &&
           commandLine(arguments).size() < bufferSize;
}

template <std::size_t count>
bool beginsWithAny(std::string const& text, char const* const (&beginnings)[count])
{
    return std::any_of(std::begin(beginnings), std::end(beginnings), [&](std::string const& begin) {
        return text.compare(0, begin.size(), begin) == 0;
    });
}

constexpr char const* agingNotices[] = {"Aging information changed",
                                        "Aging information not changed"};

// From userdel for an account without a crontab, and from usermod if there is nothing to change.
constexpr char const* harmlessNotices[] = {"no crontab for", "usermod: no changes"};

} // namespace

ParamType typeOf(std::string const& name)
{
    for (TypeName const& known : typeNames)
        if (name == known.name)
            return known.type;
    return ParamType::unknown;
}

std::string withEscapedBlanks(std::string const& value)
{
    std::string escaped;
    for (char const c : value) {
        if (c == ' ')
            escaped += '\\';
        escaped += c;
    }
    return escaped;
}

Method const* findMethod(std::string const& name)
{
    for (Method const& method : methodTable)
        if (name == method.name)
            return &method;
    return nullptr;
}

std::string commandLine(Arguments const& arguments)
{
    std::string line = arguments.front();
    auto const end = std::find(arguments.begin() + 1, arguments.end(), "");
    for (auto argument = arguments.begin() + 1; argument != end; ++argument)
        line.append(" ").append(*argument);
    if (line.find("useradd") != std::string::npos)
        line += " 2>&1;echo rc=$?"; // Contract: the redirection follows once more
    return line + " 2>&1";
}

bool makeCommands(Method const& method, std::string const& program,
                  std::vector<ParamInfo> const& params, Commands& commands, Complaint& complaint)
{
    commands.main = {program};
    commands.aging = {"/usr/bin/chage"};
    if (!addParams(method, params, commands, complaint) || !closeLists(method, commands))
        return false;
    for (Arguments const* list : {&commands.main, &commands.aging}) {
        if (fits(*list))
            continue;
        complaint = {tooLong, list->front()};
        return false;
    }
    return true;
}

bool isAgingNotice(std::string const& output)
{
    return beginsWithAny(output, agingNotices);
}

bool isBenign(std::string const& output)
{
    return isAgingNotice(output) || beginsWithAny(output, harmlessNotices);
}

} // namespace NQ::os
