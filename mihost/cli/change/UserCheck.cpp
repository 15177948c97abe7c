#include "mihost/cli/change/UserCheck.h"

#include "host/Properties.h"
#include "mihost/cli/accounts/AccountFiles.h"
#include "mihost/cli/input/Address.h"
#include "mihost/cli/input/InputValidation.h"
#include "mihost/cli/system/Failure.h"
#include "mihost/runtime/Text.h"
#include "mihost/sandbox/OwnedStream.h"

#include <algorithm>
#include <cstdio>
#include <fmt/format.h>
#include <pwd.h>

namespace mihost
{

namespace
{

/** The account that tools find by a name: the first one. Null if there is none. */
Account const* find(std::vector<Account> const& accounts, std::string const& name)
{
    auto const found =
        std::find_if(accounts.begin(), accounts.end(),
                     [&name](Account const& account) { return account.name == name; });
    return found == accounts.end() ? nullptr : &*found;
}

std::optional<std::string> objectionToTexts(Account const& node)
{
    if (auto const reason = objection(Form::AccountName, node.name))
        return fmt::format("its user-name {}", *reason);
    if (auto const reason = objection(Form::Digits, node.id))
        return fmt::format("its user-id {}", *reason);
    return std::nullopt;
}

std::optional<std::string> objectionToDelete(Account const& node,
                                             std::vector<Account> const& accounts)
{
    if (node.name == node.id)
        return std::nullopt;
    std::string const right =
        fmt::format("use 'mihost user delete {}', which keeps the home directory", node.name);
    // Contract: the plug-in runs userdel with property 89.
    if (find(accounts, node.id))
        return fmt::format("userdel would get the UID {0}, which is the name of another "
                           "account: '{0}' would be deleted ({1})",
                           node.id, right);
    return fmt::format("userdel would get the UID {}, but accepts only names ({})", node.id, right);
}

/** As the plug-in and the account tools read the file. */
std::vector<Account> accountsOfMachine()
{
    Stream const file(std::fopen(accountFile, "re"));
    std::vector<Account> accounts;
    while (passwd const* entry = file ? fgetpwent(file.get()) : nullptr)
        accounts.push_back({entry->pw_name, std::to_string(entry->pw_uid)});
    return accounts;
}

} // namespace

std::optional<std::string> objectionToUserWrite(Account const& node, UserWrite write,
                                                std::vector<Account> const& accounts)
{
    if (auto reason = objectionToTexts(node))
        return reason;
    Account const* const account = find(accounts, node.name);
    if (!account)
        return fmt::format("no account is named '{}' (run 'mihost refresh')", node.name);
    if (account->id != node.id)
        return fmt::format("'{}' is now an account with UID {}, not {} (run 'mihost refresh')",
                           node.name, account->id, node.id);
    return write == UserWrite::Delete ? objectionToDelete(node, accounts) : std::nullopt;
}

void checkUserWrite(IC::MutableNode const& node, UserWrite write)
{
    Account const account{storedText(node, IC::property::name), storedText(node, IC::property::id)};
    if (auto const reason = objectionToUserWrite(account, write, accountsOfMachine()))
        throw Failure(BadUsage, fmt::format("nothing is run for user:{}: {}",
                                            printable(account.name), *reason));
}

} // namespace mihost
