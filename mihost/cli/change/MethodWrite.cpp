#include "mihost/cli/change/MethodWrite.h"

#include "host/Methods.h"
#include "host/Properties.h"
#include "mihost/cli/accounts/AccountFiles.h"
#include "mihost/cli/change/PasswordHash.h"
#include "mihost/cli/input/Day.h"
#include "mihost/cli/input/Decimal.h"
#include "mihost/cli/system/Failure.h"

#include <fmt/format.h>

namespace mihost
{

namespace
{

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

bool mayEraseExpiry(MethodCall const& call)
{
    return std::string_view(call.method->name) == IC::method::userSetAttrib &&
           valueOf(call, IC::parameter::passwordExpirationDate).empty();
}

/** Contract: UserSetAttrib without an expiry date runs chage -E -1. */
void treatExpiry(MethodCall& call, Expiry expiry, std::vector<std::string>& warnings)
{
    if (!mayEraseExpiry(call) || expiry == Expiry::Erase)
        return;
    std::string const field = expiryField(valueOf(call, IC::parameter::userName));
    if (field.empty())
        return;
    auto const number = parseDecimal(field);
    auto const day = number ? dayOfNumber(static_cast<long>(*number)) : std::nullopt;
    std::string const text = day ? dayText(*day) : fmt::format("day '{}'", field);
    if (expiry == Expiry::EraseAloud) {
        warnings.push_back(fmt::format("UserSetAttrib erases the account's expiry {}", text));
        return;
    }
    if (!day)
        throw Failure(BadUsage,
                      expiry == Expiry::Keep
                          ? fmt::format("the account's expiry, {}, is not a day that can be kept "
                                        "(set it with 'mihost user expire' first)",
                                        text)
                          : fmt::format("UserSetAttrib erases the account's expiry, and {} "
                                        "cannot be kept (add --yes to erase it)",
                                        text));
    Parameter const* const parameter =
        findParameter(*call.method, IC::parameter::passwordExpirationDate);
    call.arguments.push_back({parameter, dateTimeText(*day)});
    if (expiry == Expiry::KeepAloud)
        warnings.push_back(
            fmt::format("UserSetAttrib would erase the account's expiry {}, so mihost "
                        "passes it (add --yes to erase it)",
                        text));
}

} // namespace

Write methodWrite(IC::MutableNode& os, MethodCall call, Expiry expiry)
{
    std::vector<std::string> warnings;
    treatExpiry(call, expiry, warnings);
    std::vector<Expectation> expectations = expectationsOf(call);
    if (mayEraseExpiry(call) && expiry == Expiry::Erase)
        expectations.push_back(noAccountExpiry(valueOf(call, IC::parameter::userName)));
    std::vector<std::string> secrets;
    makePasswordSafe(call, secrets);
    return {fmt::format("call {}", call.method->name),
            os,
            IC::property::createUser,
            IC::PropertyValue(textOf(call), true),
            true,
            expectations,
            secrets,
            warnings,
            ""};
}

Write methodWrite(Session const& session, IC::MutableNode& os, MethodCall const& call)
{
    return methodWrite(os, call, session.options().yes ? Expiry::EraseAloud : Expiry::KeepAloud);
}

} // namespace mihost
