#include "host/Properties.h"
#include "mihost/cli/change/Clearance.h"
#include "mihost/cli/change/MembershipCheck.h"
#include "mihost/cli/change/MethodWrite.h"
#include "mihost/cli/change/PropertyWrite.h"
#include "mihost/cli/change/UserCheck.h"
#include "mihost/cli/commands/CommandRows.h"
#include "mihost/cli/input/ValueText.h"
#include "mihost/cli/system/Failure.h"

#include <fmt/format.h>

namespace mihost
{

namespace
{

/** The call in a value, if it is one that the plug-in carries out rather than only stores. */
std::optional<MethodCall> callIn(Property const& property, IC::PropertyValue const& value)
{
    std::string const text = static_cast<std::string>(value);
    if (property.form != Form::MethodCall || callsNothing(text))
        return std::nullopt;
    return takeApart(text);
}

std::string questionBefore(IC::MutableNode const& node, Property const& property,
                           IC::PropertyValue const& value)
{
    if (auto const call = callIn(property, value))
        return dangerOf(*call);
    return dangerOf(node, property.id, value);
}

/** Rebuilding nodes reads the machine only. */
bool changesMachine(Property const& property)
{
    return property.has(Property::Acts) && property.id != IC::property::refresh;
}

void checkMachine(IC::MutableNode const& node, Property const& property,
                  IC::PropertyValue const& value)
{
    if (auto const call = callIn(property, value))
        checkMembership(*call);
    bool const deletes = property.id == IC::property::deleteUser;
    if (node.getNodeType() == IC::nodeType::user &&
        (!deletes || static_cast<unsigned int>(value) == IC::command::deleteAccount))
        checkUserWrite(node, deletes ? UserWrite::Delete : UserWrite::Change);
}

Write writeOf(Session& session, IC::MutableNode& node, Property const& property,
              IC::PropertyValue const& value)
{
    if (auto const call = callIn(property, value))
        return methodWrite(session, node, *call);
    return propertyWrite(session, node, property, value);
}

class Set : public Command
{
public:
    void declare(CLI::App& app) override
    {
        app.add_option("NODE", address_,
                       "an id, or a name such as os or user:root; see 'mihost tree'")
            ->required();
        app.add_option("PROPERTY", name_, "an id or a name, see 'mihost properties'")->required();
        app.add_option(
               "VALUE", text_,
               "dates as YYYY-MM-DD, booleans as true or false, lists separated by commas; - "
               "reads a password hash from a prompt or standard input")
            ->required();
    }

    void run(Session& session) override
    {
        IC::MutableNode& node = session.node(address_);
        unsigned int const id = propertyId(node, name_);
        NodeKind const* const kind = findKind(node.getNodeType());
        Property const* const property = kind ? findProperty(*kind, id) : nullptr;
        if (!property)
            throw Failure(
                NotFound,
                fmt::format("set: unknown property '{}' of node '{}' (see 'mihost properties')",
                            name_, address_));
        if (property->has(Property::Secret) && text_ == toBeAsked)
            text_ = session.askSecret(fmt::format("{} hash", property->name));

        IC::PropertyValue const value = parseValue(*property, text_);
        std::optional<ChangeLock> lock;
        if (changesMachine(*property))
            lock = clearChange(session, fmt::format("set {}", property->name),
                               questionBefore(node, *property, value),
                               [&] { checkMachine(node, *property, value); });
        carryOut(session, writeOf(session, node, *property, value));
    }

private:
    std::string address_;
    std::string name_;
    std::string text_;
};

} // namespace

CommandRow const commandRows::set{
    "set",
    "write one property of a node",
    newCommand<Set>,
    {
        {"mihost set os refresh 0", "rebuild the user and group nodes"},
        {"mihost --sandbox set user:jdoe password '!'", "try locking an account's password"},
    },
};

} // namespace mihost
