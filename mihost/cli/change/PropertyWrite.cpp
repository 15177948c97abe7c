#include "mihost/cli/change/PropertyWrite.h"

#include "host/Properties.h"
#include "mihost/cli/accounts/LocalNames.h"
#include "mihost/cli/input/Address.h"

#include <fmt/format.h>
#include <optional>
#include <set>

namespace mihost
{

namespace
{

/** The requested change of one property. */
struct Act {
    using Expect = std::vector<Expectation>(Session& session, IC::MutableNode const& node,
                                            IC::PropertyValue const& value);

    unsigned int nodeType;
    unsigned int property;
    std::optional<unsigned int> value{}; // the only one that acts; nothing if every one does
    bool onMachine = true;               // not only on the tree
    char const* tool = "";               // as in Write
    Expect* expectations = nullptr;      // none for what cannot be checked
    char const* warning = "";            // "" for none; {} is the account's name
    char const* danger = "";             // to be confirmed; as the warning

    Act of(unsigned int only) const
    {
        return with(&Act::value, only);
    }
    Act onTree() const
    {
        return with(&Act::onMachine, false);
    }
    Act by(char const* command) const
    {
        return with(&Act::tool, command);
    }
    Act expects(Expect* what) const
    {
        return with(&Act::expectations, what);
    }
    Act warns(char const* text) const
    {
        return with(&Act::warning, text);
    }
    Act asks(char const* text) const
    {
        return with(&Act::danger, text);
    }

private:
    template <class Field, class Value> Act with(Field Act::*field, Value set) const
    {
        Act act = *this;
        act.*field = set;
        return act;
    }
};

std::string userOf(IC::MutableNode const& node)
{
    return storedText(node, IC::property::name);
}

/** The plug-in reads the day of a date and drops the time. */
std::string dayOf(IC::PropertyValue const& value)
{
    constexpr std::size_t dayLength = 10;
    return static_cast<std::string>(value).substr(0, dayLength);
}

/** That every account of the files has a node. */
Expectation completeList(Session& session, NodeKind const& kind)
{
    return {fmt::format("list of {}", kind.listName), "complete",
            [&session, &kind]() -> std::string {
                std::set<std::string> shown;
                for (IC::MutableNode const* node : session.nodes())
                    if (node->getNodeType() == kind.type)
                        shown.insert(storedText(*node, kind.nameProperty));
                for (std::string const& name : localNames(kind))
                    if (shown.count(name) == 0)
                        return fmt::format("missing '{}'", name);
                return "complete";
            }};
}

std::vector<Expectation> completeLists(Session& session, IC::MutableNode const&,
                                       IC::PropertyValue const&)
{
    return {completeList(session, *findKind(IC::nodeType::user)),
            completeList(session, *findKind(IC::nodeType::group))};
}

std::vector<Expectation> emptyLog(Session&, IC::MutableNode const&, IC::PropertyValue const&)
{
    return {emptiedLog()};
}

std::vector<Expectation> hash(Session&, IC::MutableNode const& node, IC::PropertyValue const& value)
{
    return {passwordHash(userOf(node), static_cast<std::string>(value))};
}

std::vector<Expectation> inactivity(Session&, IC::MutableNode const& node,
                                    IC::PropertyValue const& value)
{
    return {inactivityDay(userOf(node), dayOf(value))};
}

std::vector<Expectation> expiry(Session&, IC::MutableNode const& node,
                                IC::PropertyValue const& value)
{
    return {passwordExpiryDay(userOf(node), dayOf(value))};
}

std::vector<Expectation> deletion(Session&, IC::MutableNode const& node, IC::PropertyValue const&)
{
    return {deletedAccount(userOf(node))};
}

constexpr char shutdownTool[] = "/sbin/shutdown";
constexpr char inactivityWarning[] =
    "inactive-time reads the account's expiry date, but writing it sets how long after its "
    "password's expiry the account stays active (for the date, use 'mihost user expire {} "
    "YYYY-MM-DD')";
constexpr char expirationWarning[] =
    "password-expiration reads the account's expiry date, but writing it sets the password's "
    "maximum age (for the date, use 'mihost user expire {} YYYY-MM-DD')";

Act onOs(unsigned int property, unsigned int value)
{
    return Act{IC::nodeType::operatingSystem, property}.of(value);
}

Act onUser(unsigned int property)
{
    return Act{IC::nodeType::user, property};
}

std::vector<Act> const& acts()
{
    namespace command = IC::command;
    namespace property = IC::property;
    static std::vector<Act> const all{
        onOs(property::requestedState, command::restart)
            .by(shutdownTool)
            .asks("restart the machine"),
        onOs(property::requestedState, command::halt).by(shutdownTool).asks("halt the machine"),
        onOs(property::refresh, command::rebuild).onTree().expects(completeLists),
        onOs(property::clearLog, command::emptyLog).expects(emptyLog).asks("empty the system log"),
        onUser(property::password).expects(hash),
        onUser(property::inactiveTime).expects(inactivity).warns(inactivityWarning),
        onUser(property::passwordExpiration).expects(expiry).warns(expirationWarning),
        onUser(property::deleteUser)
            .of(command::deleteAccount)
            .expects(deletion)
            .asks("delete the account {} and its home directory"),
    };
    return all;
}

/** What to use in place of a write that stays in the tree. */
struct Instead {
    unsigned int nodeType;
    unsigned int property;
    char const* command;
};

constexpr Instead instead[] = {
    {IC::nodeType::user, IC::property::name, "usermod -l"},
    {IC::nodeType::user, IC::property::id, "usermod -u"},
    {IC::nodeType::user, IC::property::groupId, "usermod -g"},
    {IC::nodeType::user, IC::property::fullName, "mihost user set-name"},
    {IC::nodeType::user, IC::property::homeDir, "mihost user set-home"},
    {IC::nodeType::user, IC::property::scriptPath, "mihost user set-shell"},
    {IC::nodeType::user, IC::property::pwdMaxDays, "mihost user age"},
    {IC::nodeType::user, IC::property::pwdWarnDays, "mihost user age"},
    {IC::nodeType::user, IC::property::pwdMinDays, "mihost user age"},
    {IC::nodeType::user, IC::property::pwdExpDays, "mihost user age"},
    {IC::nodeType::user, IC::property::lastPwdChange, "chage -d"},
    {IC::nodeType::group, IC::property::name, "groupmod -n"},
    {IC::nodeType::group, IC::property::id, "groupmod -g"},
    {IC::nodeType::group, IC::property::members, "mihost group add-member"},
};

Act const* findAct(IC::MutableNode const& node, unsigned int property,
                   IC::PropertyValue const& value)
{
    for (Act const& act : acts())
        if (act.nodeType == node.getNodeType() && act.property == property &&
            (!act.value || *act.value == static_cast<unsigned int>(value)))
            return &act;
    return nullptr;
}

/** That the node holds the value now. */
Expectation storedValue(IC::MutableNode const& node, Property const& property,
                        IC::PropertyValue const& value)
{
    return {property.name, static_cast<std::string>(value),
            [&node, id = property.id] { return storedText(node, id); }};
}

std::string memoryWarning(IC::MutableNode const& node, Property const& property)
{
    std::string text = fmt::format("{} changed in memory only", property.name);
    for (Instead const& each : instead)
        if (each.nodeType == node.getNodeType() && each.property == property.id)
            text += fmt::format(" (use '{}')", each.command);
    return text;
}

} // namespace

Write propertyWrite(Session& session, IC::MutableNode& node, Property const& property,
                    IC::PropertyValue const& value)
{
    Act const* const act = findAct(node, property.id, value);
    Write write{fmt::format("set {}", property.name),
                node,
                property.id,
                value,
                act && act->onMachine,
                {},
                {},
                {},
                act ? act->tool : ""};
    if (property.has(Property::Secret))
        write.secrets.push_back(static_cast<std::string>(value));
    if (!act) {
        write.expectations.push_back(storedValue(node, property, value));
        write.warnings.push_back(memoryWarning(node, property));
        return write;
    }
    if (act->expectations)
        write.expectations = act->expectations(session, node, value);
    if (*act->warning)
        write.warnings.push_back(fmt::format(act->warning, userOf(node)));
    return write;
}

std::string dangerOf(IC::MutableNode const& node, unsigned int property,
                     IC::PropertyValue const& value)
{
    Act const* const act = findAct(node, property, value);
    return act ? fmt::format(act->danger, userOf(node)) : "";
}

Write osWrite(Session& session, IC::MutableNode& os, std::string const& what, unsigned int property,
              IC::PropertyValue const& value)
{
    Property const& row = *findProperty(*findKind(IC::nodeType::operatingSystem), property);
    Write write = propertyWrite(session, os, row, value);
    write.what = what;
    return write;
}

} // namespace mihost
