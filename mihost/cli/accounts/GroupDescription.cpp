#include "mihost/cli/accounts/GroupDescription.h"

#include "mihost/cli/input/Decimal.h"

#include <algorithm>

namespace mihost
{

namespace
{

std::vector<std::string> accountsOf(AccountData const& data, unsigned int group)
{
    std::vector<std::string> names;
    for (std::string const& line : data.files.at(accountFile)) {
        Record const account = fieldsOf(line, ':');
        if (account.size() > accountField::Group &&
            parseDecimal(account[accountField::Group]) == group)
            names.push_back(account[0]);
    }
    return names;
}

std::vector<GroupDescription::Member> membersIn(AccountData const& data, std::string const& list)
{
    std::vector<std::string> const known = recordNames(data.files.at(accountFile));
    std::vector<GroupDescription::Member> members;
    for (std::string const& name : fieldsOf(list, ','))
        if (!name.empty())
            members.push_back({name, std::find(known.begin(), known.end(), name) != known.end()});
    return members;
}

} // namespace

std::optional<GroupDescription> describeGroup(AccountData const& data, std::string const& name)
{
    Record const group = recordIn(data.files.at(groupFile), name);
    auto const id = group.empty() ? std::nullopt : parseDecimal(group[groupField::Id]);
    if (!id)
        return std::nullopt;
    return GroupDescription{name, *id, accountsOf(data, *id),
                            membersIn(data, group[groupField::Members]),
                            data.loginDefs.groups().objectionTo("gid", *id)};
}

} // namespace mihost
