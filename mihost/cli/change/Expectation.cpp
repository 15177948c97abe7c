#include "mihost/cli/change/Expectation.h"

#include "host/Methods.h"
#include "mihost/cli/accounts/AccountFiles.h"
#include "mihost/cli/change/PasswordHash.h"
#include "mihost/cli/input/Day.h"
#include "mihost/cli/input/Decimal.h"
#include "mihost/cli/log/LogLine.h"

#include <algorithm>
#include <fmt/format.h>
#include <fstream>
#include <optional>
#include <sys/stat.h>

namespace mihost
{

namespace
{

constexpr char present[] = "present";
constexpr char absent[] = "absent";
constexpr char givenOne[] = "the given one";
constexpr char otherOne[] = "another one";
constexpr char never[] = "never";
constexpr char unknown[] = "unknown"; // no record, or an unreadable one

/** A record that a method makes or removes. */
struct RecordEffect {
    char const* method;
    char const* nameParameter;
    char const* file;
    char const* noun;
    char const* wanted;
};

constexpr RecordEffect recordEffects[] = {
    {IC::method::userAdd, IC::parameter::userName, accountFile, "account", present},
    {IC::method::userDel, IC::parameter::userName, accountFile, "account", absent},
    {IC::method::localGroupAdd, IC::parameter::groupName, groupFile, "group", present},
    {IC::method::localGroupDel, IC::parameter::groupName, groupFile, "group", absent},
};

/** A membership that a method makes or ends. */
struct MembershipEffect {
    char const* method;
    char const* wanted;
};

constexpr MembershipEffect membershipEffects[] = {
    {IC::method::localGroupAddUser, present},
    {IC::method::localGroupDelUser, absent},
};

/** The field that a parameter sets, in whatever method. */
struct FieldEffect {
    char const* parameter;
    char const* file;
    std::size_t field;
    char const* noun;
};

constexpr FieldEffect fieldEffects[] = {
    {IC::parameter::comment, accountFile, accountField::Comment, "full name"},
    {IC::parameter::fullName, accountFile, accountField::Comment, "full name"},
    {IC::parameter::homeDir, accountFile, accountField::Home, "home directory"},
    {IC::parameter::scriptPath, accountFile, accountField::Shell, "login shell"},
    {IC::parameter::password, shadowFile, shadowField::Password, "password"},
    {IC::parameter::daysMustKeepPassword, shadowFile, shadowField::MinDays, "minimum password age"},
    {IC::parameter::daysMustChangePasswordAfter, shadowFile, shadowField::MaxDays,
     "maximum password age"},
    {IC::parameter::daysWarnBeforePasswordExpire, shadowFile, shadowField::WarnDays,
     "password warning"},
    {IC::parameter::daysExpireAfter, shadowFile, shadowField::Inactive, "inactivity time"},
    {IC::parameter::passwordExpirationDate, shadowFile, shadowField::Expiry, "account expiry"},
};

std::string subjectOf(char const* noun, std::string const& name)
{
    return fmt::format("{} of {}", noun, name);
}

std::string withoutTrailing(std::string text, char character)
{
    while (text.size() > 1 && text.back() == character)
        text.pop_back();
    return text;
}

/** A number without leading zeros; other texts as they are. */
std::string plainNumber(std::string const& text)
{
    auto const number = parseDecimal(text);
    return number ? std::to_string(*number) : text;
}

std::string dayOfField(std::string const& field)
{
    auto const number = parseDecimal(field);
    auto const day = number ? dayOfNumber(static_cast<long>(*number)) : std::nullopt;
    return day ? dayText(*day) : never;
}

/** The requested value, in the form of fieldText. */
std::string wantedText(Form form, std::string const& value)
{
    switch (form) {
    case Form::Password:
        return givenOne;
    case Form::Day:
        return dayText(*parseDateTime(value));
    case Form::Digits:
        return plainNumber(value);
    case Form::Path:
        return withoutTrailing(value, '/'); // as newer tools store it
    default:
        return value;
    }
}

/** @param value  the argument */
std::string fieldText(Form form, std::string const& field, std::string const& value)
{
    switch (form) {
    case Form::Password:
        return fits(value, field) ? givenOne : otherOne;
    case Form::Day:
        return dayOfField(field);
    case Form::Digits:
        return field.empty() ? "none" : plainNumber(field);
    case Form::Path:
        return withoutTrailing(field, '/');
    default:
        return field.empty() ? "empty" : field;
    }
}

Expectation fieldExpectation(FieldEffect const& effect, std::string const& user, Form form,
                             std::string const& value)
{
    return {subjectOf(effect.noun, user), wantedText(form, value),
            [file = effect.file, field = effect.field, user, form, value] {
                Record const record = recordOf(file, user);
                return record.empty() ? unknown : fieldText(form, record[field], value);
            }};
}

Expectation recordExpectation(RecordEffect const& effect, std::string const& name)
{
    return {fmt::format("{} {}", effect.noun, name), effect.wanted,
            [file = effect.file, name] { return recordOf(file, name).empty() ? absent : present; }};
}

std::string membership(std::string const& user, std::string const& group)
{
    Record const groupRecord = recordOf(groupFile, group);
    if (groupRecord.empty())
        return absent;
    std::vector<std::string> const members = fieldsOf(groupRecord[groupField::Members], ',');
    if (std::find(members.begin(), members.end(), user) != members.end())
        return present;
    Record const account = recordOf(accountFile, user);
    bool const isPrimary =
        !account.empty() && account[accountField::Group] == groupRecord[groupField::Id];
    return isPrimary ? "by its primary group" : absent;
}

/** A day that is a sum of days in the account's shadow record; "never" if one is unlimited. */
std::string dayOfSum(std::string const& user, std::vector<std::size_t> const& fields)
{
    constexpr unsigned int unlimited = 99999;
    Record const record = recordOf(shadowFile, user);
    if (record.empty())
        return unknown;
    long sum = 0;
    for (std::size_t const field : fields) {
        auto const days = parseDecimal(record[field]);
        if (!days || *days >= unlimited)
            return never;
        sum += static_cast<long>(*days);
    }
    return dayOfField(std::to_string(sum));
}

/** Distinguishes a log from the same log emptied, even if lines were added since. */
struct LogState {
    off_t size;
    std::string start;
};

std::optional<LogState> logState()
{
    constexpr std::size_t enough = 4096;
    struct stat status {
    };
    if (stat(systemLog, &status) != 0)
        return std::nullopt;
    LogState state{status.st_size, std::string(enough, '\0')};
    std::ifstream file(systemLog, std::ios::binary);
    file.read(state.start.data(), static_cast<std::streamsize>(enough));
    state.start.resize(static_cast<std::size_t>(std::max<std::streamsize>(file.gcount(), 0)));
    return state;
}

bool isSameLog(LogState const& before, LogState const& now)
{
    return now.size >= before.size && now.start.compare(0, before.start.size(), before.start) == 0;
}

} // namespace

std::vector<Expectation> expectationsOf(MethodCall const& call)
{
    std::string const method = call.method->name;
    std::vector<Expectation> all;
    for (RecordEffect const& effect : recordEffects)
        if (method == effect.method)
            all.push_back(recordExpectation(effect, valueOf(call, effect.nameParameter)));
    for (MembershipEffect const& effect : membershipEffects)
        if (method == effect.method) {
            std::string const user = valueOf(call, IC::parameter::domainAndMember);
            std::string const group = valueOf(call, IC::parameter::localGroupName);
            all.push_back({fmt::format("membership of {} in {}", user, group), effect.wanted,
                           [user, group] { return membership(user, group); }});
        }
    for (MethodCall::Argument const& argument : call.arguments)
        for (FieldEffect const& effect : fieldEffects)
            if (std::string_view(argument.parameter->name) == effect.parameter)
                all.push_back(fieldExpectation(effect, valueOf(call, IC::parameter::userName),
                                               argument.parameter->form, argument.value));
    return all;
}

Expectation passwordHash(std::string const& user, std::string const& hash)
{
    return {subjectOf("password hash", user), givenOne, [user, hash] {
                Record const record = recordOf(shadowFile, user);
                if (record.empty())
                    return unknown;
                return record[shadowField::Password] == hash ? givenOne : otherOne;
            }};
}

Expectation deletedAccount(std::string const& user)
{
    return {"account " + user, absent,
            [user] { return recordOf(accountFile, user).empty() ? absent : present; }};
}

Expectation noAccountExpiry(std::string const& user)
{
    return {subjectOf("account expiry", user), never, [user] {
                Record const record = recordOf(shadowFile, user);
                return record.empty() ? unknown : dayOfField(record[shadowField::Expiry]);
            }};
}

Expectation passwordExpiryDay(std::string const& user, std::string const& day)
{
    return {subjectOf("password expiry", user), day, [user] {
                return dayOfSum(user, {shadowField::LastChange, shadowField::MaxDays});
            }};
}

Expectation inactivityDay(std::string const& user, std::string const& day)
{
    return {subjectOf("inactivity", user), day, [user] {
                return dayOfSum(
                    user, {shadowField::LastChange, shadowField::MaxDays, shadowField::Inactive});
            }};
}

Expectation emptiedLog()
{
    std::optional<LogState> const before = logState();
    return {"system log", "empty", [before]() -> std::string {
                auto const now = logState();
                if (!now)
                    return "missing";
                bool const isEmptied = now->size == 0 || (before && !isSameLog(*before, *now));
                return isEmptied ? "empty" : fmt::format("{} bytes long", now->size);
            }};
}

} // namespace mihost
