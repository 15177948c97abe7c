#include "mihost/cli/metrics/MachineMetrics.h"

#include "mihost/cli/accounts/UserDescription.h"
#include "mihost/cli/catalogue/Catalogue.h"

#include <algorithm>
#include <functional>
#include <optional>

namespace mihost
{

namespace
{

constexpr double bytesPerKib = 1024;
constexpr double secondsPerDay = 86400;

/** The property of this catalogue name; null if the node lacks it or it could not be read. */
PropertyView const* propertyOf(NodeView const& view, std::string_view name)
{
    for (PropertyView const& property : view.properties)
        if (property.row && name == property.row->name)
            return property.unknown.empty() ? &property : nullptr;
    return nullptr;
}

std::string textOf(NodeView const& view, std::string_view name)
{
    PropertyView const* const property = propertyOf(view, name);
    return property ? static_cast<std::string>(property->value) : "";
}

std::optional<double> numberOf(NodeView const& view, std::string_view name)
{
    PropertyView const* const property = propertyOf(view, name);
    if (!property)
        return std::nullopt;
    return static_cast<double>(property->value.getNumber());
}

std::vector<NodeView const*> nodesOf(MachineState const& state, std::string_view kind)
{
    std::vector<NodeView const*> found;
    for (NodeView const& view : state.nodes)
        if (kind == kindName(view.node->getNodeType()))
            found.push_back(&view);
    return found;
}

// Figures of the operating system.

struct Figure {
    char const* property;
    double scale;
    char const* metric;
    char const* unit;
    char const* help;
};

constexpr Figure figures[] = {
    {"physical-memory-size", bytesPerKib, "mi_memory_size_bytes", "bytes", "Size of the RAM."},
    {"physical-memory-free", bytesPerKib, "mi_memory_free_bytes", "bytes", "Free RAM."},
    {"process-count", 1, "mi_processes", "", "Number of processes."},
    {"last-boot-time", 1, "mi_boot_time_seconds", "seconds", "When the machine was started."},
};

void addFigures(NodeView const& os, std::vector<Metric>& to)
{
    for (Figure const& figure : figures)
        if (auto const number = numberOf(os, figure.property))
            to.push_back({figure.metric, figure.unit, figure.help, {{{}, *number * figure.scale}}});
    to.push_back({"mi_os_info",
                  "",
                  "The operating system, always 1.",
                  {{{{"name", textOf(os, "os-name")}, {"version", textOf(os, "os-version")}}, 1}}});
}

// Kernel modules.

void addDrivers(MachineState const& state, std::vector<Metric>& to)
{
    Metric info{"mi_driver_info", "", "A loaded kernel module and its version, always 1.", {}};
    for (NodeView const* const driver : nodesOf(state, "driver"))
        info.samples.push_back({{{"driver", textOf(*driver, "driver-name")},
                                 {"version", textOf(*driver, "driver-version")}},
                                1});
    auto const count = static_cast<double>(info.samples.size());
    to.push_back({"mi_drivers", "", "Loaded kernel modules.", {{{}, count}}});
    to.push_back(info);
}

// The log.

void addLog(MachineState const& state, std::vector<Metric>& to)
{
    std::optional<double> newest;
    for (NodeView const* const entry : nodesOf(state, "log-entry"))
        if (auto const time = numberOf(*entry, "time"))
            newest = std::max(newest.value_or(0), *time);
    to.push_back({"mi_log_lines",
                  "",
                  "Lines of the system log.",
                  {{{}, static_cast<double>(state.logLines)}}});
    if (newest)
        to.push_back({"mi_log_newest_time_seconds",
                      "seconds",
                      "Time stamp of the newest lines of the system log.",
                      {{{}, *newest}}});
}

// Accounts.

struct Account {
    std::string name;
    std::optional<double> expiry; // nothing for never
    double passwordChange;        // 0 for never
    bool disabled;                // it allows no login by password
};

/** Contract: the day that an account without an expiry reports. */
bool isNever(double time)
{
    auto const seconds = static_cast<std::time_t>(time);
    std::tm day{};
    return localtime_r(&seconds, &day) && day.tm_year == 2038 - 1900 && day.tm_mon == 0 &&
           day.tm_mday == 19;
}

/** Nothing if the account's password and ageing could not be read. */
std::optional<Account> accountOf(NodeView const& user)
{
    PropertyView const* const password = propertyOf(user, "password");
    auto const expiry = numberOf(user, "inactive-time");
    auto const change = numberOf(user, "last-password-change");
    if (!password || !expiry || !change)
        return std::nullopt;
    PasswordState const state = passwordState(static_cast<std::string>(password->value));
    Account account{textOf(user, "user-name"), expiry, *change,
                    state == PasswordState::Locked || state == PasswordState::Unusable};
    if (isNever(*expiry))
        account.expiry.reset();
    return account;
}

using Accounts = std::vector<Account>;

double countOf(Accounts const& accounts, std::function<bool(Account const&)> const& fits)
{
    return static_cast<double>(std::count_if(accounts.begin(), accounts.end(), fits));
}

void addAccountCounts(Accounts const& accounts, std::time_t now, std::vector<Metric>& to)
{
    auto const untilExpiry = [now](Account const& account) {
        return *account.expiry - static_cast<double>(now);
    };
    Metric expiring{"mi_accounts_expiring", "", "Accounts that expire within this many days.", {}};
    for (int const days : {7, 30})
        expiring.samples.push_back(
            {{{"days", std::to_string(days)}}, countOf(accounts, [&](Account const& account) {
                 return account.expiry && untilExpiry(account) > 0 &&
                        untilExpiry(account) <= days * secondsPerDay;
             })});
    to.push_back(expiring);
    to.push_back({"mi_accounts_expired",
                  "",
                  "Accounts that have expired.",
                  {{{}, countOf(accounts, [&](Account const& account) {
                        return account.expiry && untilExpiry(account) <= 0;
                    })}}});
    to.push_back(
        {"mi_accounts_disabled",
         "",
         "Accounts that allow no login by password.",
         {{{}, countOf(accounts, [](Account const& account) { return account.disabled; })}}});
    to.push_back({"mi_accounts_password_never_changed",
                  "",
                  "Accounts without a date of the last password change.",
                  {{{}, countOf(accounts, [](Account const& account) {
                        return account.passwordChange == 0;
                    })}}});
}

void addAccountSeries(Accounts const& accounts, std::vector<Metric>& to)
{
    Metric expiry{"mi_account_expiry_time_seconds",
                  "seconds",
                  "When an account expires, for those that do.",
                  {}};
    Metric change{"mi_account_password_change_time_seconds",
                  "seconds",
                  "When an account's password was last changed, 0 for never.",
                  {}};
    Metric disabled{
        "mi_account_disabled", "", "Whether an account allows no login by password.", {}};
    for (Account const& account : accounts) {
        auto const sample = [&account](double value) {
            return Sample{{{"user", account.name}}, value};
        };
        if (account.expiry)
            expiry.samples.push_back(sample(*account.expiry));
        change.samples.push_back(sample(account.passwordChange));
        disabled.samples.push_back(sample(account.disabled ? 1 : 0));
    }
    to.insert(to.end(), {expiry, change, disabled});
}

void addAccounts(MachineState const& state, AccountSeries series, std::vector<Metric>& to)
{
    std::vector<NodeView const*> const users = nodesOf(state, "user");
    to.push_back({"mi_users",
                  "",
                  "Local user accounts: ordinary ones and those with UID 0.",
                  {{{}, static_cast<double>(users.size())}}});
    to.push_back({"mi_groups",
                  "",
                  "Local groups: ordinary ones and GID 0.",
                  {{{}, static_cast<double>(nodesOf(state, "group").size())}}});
    Accounts accounts;
    for (NodeView const* const user : users) {
        auto const account = accountOf(*user);
        if (!account)
            return; // no count is better than a wrong one
        accounts.push_back(*account);
    }
    addAccountCounts(accounts, state.now, to);
    if (series == AccountSeries::Make)
        addAccountSeries(accounts, to);
}

void addNeeds(std::vector<Need> const& needs, std::vector<Metric>& to)
{
    Metric ok{"mi_doctor_ok", "", "Whether the machine has what a full tree needs.", {}};
    Metric fixable{
        "mi_doctor_fixable", "", "Whether what is missing can be fixed on this machine.", {}};
    for (Need const& need : needs) {
        ok.samples.push_back({{{"need", need.what}}, need.problem ? 0.0 : 1.0});
        if (need.problem)
            fixable.samples.push_back({{{"need", need.what}}, need.noFix.empty() ? 1.0 : 0.0});
    }
    to.insert(to.end(), {ok, fixable});
}

} // namespace

std::vector<Metric> machineMetrics(MachineState const& state, AccountSeries accounts)
{
    std::vector<Metric> metrics;
    for (NodeView const* const os : nodesOf(state, "os"))
        addFigures(*os, metrics);
    metrics.push_back({"mi_swap_size_bytes",
                       "bytes",
                       "Size of the swap space.",
                       {{{}, static_cast<double>(state.swapSize)}}});
    metrics.push_back({"mi_swap_free_bytes",
                       "bytes",
                       "Free swap space.",
                       {{{}, static_cast<double>(state.swapFree)}}});
    addDrivers(state, metrics);
    addAccounts(state, accounts, metrics);
    addLog(state, metrics);
    addNeeds(state.needs, metrics);
    return metrics;
}

std::vector<Metric> collectionMetrics(bool success, double seconds)
{
    return {{"mi_collection_success",
             "",
             "Whether the tree could be read.",
             {{{}, success ? 1.0 : 0.0}}},
            {"mi_collection_duration_seconds",
             "seconds",
             "How long reading the tree took.",
             {{{}, seconds}}}};
}

} // namespace mihost
