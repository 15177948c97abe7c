#include "mihost/cli/change/MethodWrite.h"

#include "mihost/cli/accounts/AccountFiles.h"
#include "mihost/cli/change/PasswordHash.h"
#include "mihost/cli/input/Day.h"
#include "mihost/cli/input/Decimal.h"
#include "mihost/cli/system/Failure.h"
#include "nodes/ids.h"

#include <fmt/format.h>

namespace mihost
{

namespace
{

constexpr char expiryParameter[] = "passwordExpirationDate";

/** @param secrets  gets every form that the password takes */
void makePasswordSafe(MethodCall& call, std::vector<std::string>& secrets)
{
    for (MethodCall::Argument& argument : call.arguments) {
        if (argument.parameter->form != Form::Password)
            continue;
        secrets.push_back(argument.value);
        if (passwdReadsStdin())
            continue;
        std::string const hash = hashOf(argument.value);
        // Contract: the plug-in escapes blanks only, so the shell gets everything else as it is.
        argument.value = escapedForShell(hash);
        secrets.insert(secrets.end(), {hash, argument.value});
    }
}

/** The account's expiry as the shadow file has it; empty for none. */
std::string expiryField(std::string const& user)
{
    Record const record = recordOf(shadowFile, user);
    std::string const field = record.empty() ? "" : record[shadowField::Expiry];
    return field == "-1" ? "" : field;
}

/** Contract: UserSetAttrib without an expiry date runs chage -E -1. */
void keepExpiry(MethodCall& call, bool erase, std::vector<std::string>& warnings)
{
    if (std::string_view(call.method->name) != "UserSetAttrib" ||
        !valueOf(call, expiryParameter).empty())
        return;
    std::string const field = expiryField(valueOf(call, "UserName"));
    if (field.empty())
        return;
    auto const number = parseDecimal(field);
    auto const day = number ? dayOfNumber(static_cast<long>(*number)) : std::nullopt;
    std::string const text = day ? dayText(*day) : fmt::format("day '{}'", field);
    if (erase) {
        warnings.push_back(fmt::format("UserSetAttrib erases the account's expiry {}", text));
        return;
    }
    if (!day)
        throw Failure(BadUsage, fmt::format("UserSetAttrib erases the account's expiry, and {} "
                                            "cannot be passed along (add --yes to erase it)",
                                            text));
    Parameter const* const parameter = findParameter(*call.method, expiryParameter);
    call.arguments.push_back({parameter, dateTimeText(*day)});
    warnings.push_back(fmt::format("UserSetAttrib would erase the account's expiry {}, so it is "
                                   "passed along (add --yes to erase it)",
                                   text));
}

} // namespace

Write methodWrite(Session const& session, IC::MutableNode& os, MethodCall call)
{
    std::vector<std::string> warnings;
    keepExpiry(call, session.options().yes, warnings);
    std::vector<Expectation> const expectations = expectationsOf(call);
    std::vector<std::string> secrets;
    makePasswordSafe(call, secrets);
    return {fmt::format("call {}", call.method->name),
            os,
            NODES::createUser,
            IC::PropertyValue(textOf(call), true),
            true,
            expectations,
            secrets,
            warnings,
            ""};
}

} // namespace mihost
