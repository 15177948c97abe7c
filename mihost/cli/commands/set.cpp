#include "mihost/cli/Failure.h"
#include "mihost/cli/MethodCall.h"
#include "mihost/cli/Safety.h"
#include "mihost/cli/Say.h"
#include "mihost/cli/Session.h"
#include "mihost/cli/ValueText.h"
#include "mihost/cli/Write.h"
#include "mihost/cli/commands/makers.h"
#include "nodes/ids.h"

#include <fmt/format.h>

namespace mihost
{

namespace
{

/** A write that is asked about first. */
struct Danger {
    unsigned int nodeType;
    unsigned int property;
    unsigned int value;
    char const* what; // {} stands for the account's name
};

constexpr Danger dangers[] = {
    {NODES::operatingSystemType, NODES::requestedState, 9, "restart the machine"},
    {NODES::operatingSystemType, NODES::requestedState, 12, "halt the machine"},
    {NODES::operatingSystemType, NODES::clearLog, 9, "empty the system log"},
    {NODES::userType, NODES::deleteUser, 1, "delete the account {} and its home directory"},
};

/** A user node's writes put its stored name or id into a command line. */
void checkAccount(IC::MutableNode const& node)
{
    NodeKind const& kind = *findKind(NODES::userType);
    for (unsigned int const id : {NODES::name, NODES::id}) {
        Property const& property = *findProperty(kind, id);
        if (auto const reason = objection(property.form, storedText(node, id)))
            throw Failure(BadUsage, fmt::format("nothing is run for this account: its {} {}",
                                                property.name, *reason));
    }
}

std::string dangerOf(IC::MutableNode const& node, Property const& property,
                     IC::PropertyValue const& value)
{
    if (property.form == Form::MethodCall) {
        std::string const text = static_cast<std::string>(value);
        return callsNothing(text) ? "" : dangerOf(takeApart(text));
    }
    for (Danger const& danger : dangers)
        if (danger.nodeType == node.getNodeType() && danger.property == property.id &&
            danger.value == static_cast<unsigned int>(value))
            return fmt::format(danger.what, storedText(node, NODES::name));
    return "";
}

std::string secretOf(Property const& property, std::string const& text)
{
    if (property.has(Property::Secret))
        return text;
    bool const isCall = property.form == Form::MethodCall && !callsNothing(text);
    return isCall ? secretOf(takeApart(text)) : "";
}

class Set : public Command
{
public:
    void declare(CLI::App& app) override
    {
        app.add_option("NODE", address_,
                       "an id, or a name such as os or user:root; tree shows them")
            ->required();
        app.add_option("PROPERTY", name_, "an id or a name, which properties explains")->required();
        app.add_option("VALUE", text_,
                       "a date as YYYY-MM-DD, true or false, lists with commas; - for a password "
                       "is asked for, or read from standard input")
            ->required();
    }

    void run(Session& session) override
    {
        IC::MutableNode& node = session.node(address_);
        unsigned int const id = propertyId(node, name_);
        NodeKind const* const kind = findKind(node.getNodeType());
        Property const* const property = kind ? findProperty(*kind, id) : nullptr;
        if (!property)
            throw Failure(NotFound,
                          fmt::format("nothing is known of property '{}' of node '{}', so "
                                      "it is not written",
                                      name_, address_));
        if (property->has(Property::Secret) && text_ == toBeAsked)
            text_ = session.askSecret(fmt::format("{} hash", property->name));

        IC::PropertyValue const value = parseValue(*property, text_);
        if (node.getNodeType() == NODES::userType && property->has(Property::Acts))
            checkAccount(node);
        if (std::string const danger = dangerOf(node, *property, value); !danger.empty())
            session.confirm(danger);
        carryOut(session, {node, id, value, secretOf(*property, text_)});
        if (!property->has(Property::Acts) && !session.options().json)
            say(fmt::format("mihost: {} changed in this tree alone; 'mihost properties {}' tells "
                            "which properties act on the machine\n",
                            property->name, kind->name));
    }

private:
    std::string address_;
    std::string name_;
    std::string text_;
};

} // namespace

std::unique_ptr<Command> commandMakers::set()
{
    return std::make_unique<Set>();
}

} // namespace mihost
