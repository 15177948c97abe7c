#include "mihost/cli/accounts/ShadowGap.h"

#include "host/Properties.h"
#include "mihost/cli/accounts/AccountFiles.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <fmt/format.h>
#include <unistd.h>

namespace mihost
{

namespace
{

constexpr unsigned int fromShadow[] = {
    IC::property::password,     IC::property::passwordLength, IC::property::pwdMaxDays,
    IC::property::pwdWarnDays,  IC::property::pwdMinDays,     IC::property::pwdExpDays,
    IC::property::inactiveTime, IC::property::lastPwdChange,  IC::property::passwordExpiration,
};

/** Properties that are hardly ever all zero if an entry was read. */
constexpr unsigned int telling[] = {IC::property::pwdMaxDays, IC::property::pwdExpDays,
                                    IC::property::inactiveTime, IC::property::lastPwdChange};

bool isBlank(IC::PropertyValue const& value)
{
    return value.getKind() == IC::PropertyValue::TextKind ? static_cast<std::string>(value).empty()
                                                          : value.getNumber() == 0;
}

/** Whether an entry says what the plug-in says without one. */
bool isAllZero(Record const& record)
{
    return std::all_of(record.begin() + shadowField::LastChange,
                       record.begin() + shadowField::Expiry + 1,
                       [](std::string const& field) { return field == "0"; });
}

std::string reasonOf(std::string const& user)
{
    if (access(shadowFile, R_OK) != 0)
        return fmt::format("{} cannot be read: {}", shadowFile, std::strerror(errno));
    Record const record = recordOf(shadowFile, user);
    if (record.empty())
        return fmt::format("'{}' has no entry in {}", user, shadowFile);
    if (isAllZero(record))
        return "";
    return fmt::format("the entry of '{}' in {} is out of the order of {}", user, shadowFile,
                       accountFile);
}

} // namespace

ShadowGap::ShadowGap(IC::MutableNode const& node)
{
    if (node.getNodeType() != IC::nodeType::user)
        return;
    auto const stored = node.getProperties();
    for (unsigned int const property : telling) {
        auto const found = stored.find(property);
        if (found == stored.end() || !isBlank(found->second))
            return;
    }
    auto const name = stored.find(IC::property::name);
    if (name != stored.end())
        reason_ = reasonOf(static_cast<std::string>(name->second));
}

std::string ShadowGap::reasonFor(unsigned int property, IC::PropertyValue const& value) const
{
    bool const isFromShadow =
        std::find(std::begin(fromShadow), std::end(fromShadow), property) != std::end(fromShadow);
    return isFromShadow && isBlank(value) ? reason_ : "";
}

} // namespace mihost
