#include "mihost/cli/commands/TaskCommand.h"

#include "mihost/cli/accounts/AccountFiles.h"
#include "mihost/cli/change/Clearance.h"
#include "mihost/cli/change/MembershipCheck.h"
#include "mihost/cli/commands/NewPassword.h"
#include "mihost/cli/commands/UnknownName.h"
#include "mihost/cli/input/Help.h"
#include "mihost/cli/system/Failure.h"

#include <CLI/Error.hpp>
#include <algorithm>
#include <fmt/format.h>
#include <fmt/ranges.h>
#include <string_view>

namespace mihost
{

namespace
{

constexpr std::string_view neverExpires = "never"; // in place of a day

/** An argument that names something that must exist. */
struct Existing {
    std::string_view argument;
    char const* file;
    void (*failForUnknown)(std::string const& name);
};

constexpr Existing existing[] = {
    {"USER", accountFile, failForUnknownAccount},
    {"GROUP", groupFile, failForUnknownGroup},
};

bool isOption(TaskValue const& value)
{
    return value.name[0] == '-';
}

Parameter const& parameterOf(Task const& task, TaskValue const& value)
{
    return *findParameter(*findMethod(task.method), value.parameter);
}

/** @throws Failure (NotFound) for a name that is in no record */
void checkThatItExists(TaskValue const& value, std::string const& name)
{
    for (Existing const& each : existing)
        if (each.argument == value.name && recordOf(each.file, name).empty())
            each.failForUnknown(name);
}

/** The names of the options that the task has. */
std::vector<std::string> optionsOf(Task const& task)
{
    std::vector<std::string> names;
    for (TaskValue const& value : task.values)
        if (isOption(value))
            names.emplace_back(value.name);
    return names;
}

} // namespace

void TaskCommand::declare(CLI::App& app)
{
    app.add_option(subject_.argument, shown_, subject_.meaning);
    app.require_subcommand(0, 1);
    for (Task const& task : subject_.tasks)
        declareTask(app, task);
    app.callback([this] { checkWords(); });
}

void TaskCommand::declareTask(CLI::App& app, Task const& task)
{
    CLI::App& command = *app.add_subcommand(task.name, task.summary)->group("Commands");
    for (TaskValue const& value : task.values)
        declareValue(command, task, value);
    setExamples(command, task.examples);
    command.callback([this, &task] { task_ = &task; });
}

void TaskCommand::declareValue(CLI::App& app, Task const& task, TaskValue const& value)
{
    Parameter const& parameter = parameterOf(task, value);
    if (parameter.form == Form::Password) {
        declarePassword(app, value, parameter.required);
        return;
    }
    auto const take = [this, &value](std::string const& text) { given_.push_back({&value, text}); };
    CLI::Option* const option =
        app.add_option_function<std::string>(value.name, take, value.meaning)
            ->required(!isOption(value))
            ->type_name(value.type);
    if (isOption(value))
        option->take_last();
}

void TaskCommand::declarePassword(CLI::App& app, TaskValue const& value, bool isRequired)
{
    if (!isRequired)
        app.add_flag(value.name, isPasswordWanted_, value.meaning);
    app.add_option("--password-file", passwordFile_,
                   "read the password from FILE, - for standard input")
        ->type_name("FILE");
}

/** @throws CLI::ParseError if neither a name nor a task was given, or both */
void TaskCommand::checkWords() const
{
    if (!task_ && shown_.empty())
        throw CLI::ValidationError(fmt::format("{} or a command is required", subject_.argument));
    if (task_ && !shown_.empty())
        throw CLI::ValidationError(fmt::format("unexpected argument '{}'", shown_));
}

MethodCall TaskCommand::callOf(Session const& session) const
{
    std::vector<Assignment> assignments;
    for (Given const& given : given_) {
        Parameter const& parameter = parameterOf(*task_, *given.value);
        if (parameter.form == Form::Day && given.text == neverExpires)
            continue; // what the method does if it gets no day
        assignments.push_back({&parameter, given.value->name, given.text});
        checkAssignment(assignments.back());
        checkThatItExists(*given.value, given.text);
    }
    bool const hasOption = std::any_of(given_.begin(), given_.end(),
                                       [](Given const& given) { return isOption(*given.value); });
    if (task_->isNothingWithoutOption && !hasOption)
        throw Failure(BadUsage, fmt::format("nothing to change (use {})",
                                            fmt::join(optionsOf(*task_), ", ")));
    for (TaskValue const& value : task_->values) {
        Parameter const& parameter = parameterOf(*task_, value);
        if (parameter.form == Form::Password &&
            (parameter.required || isPasswordWanted_ || !passwordFile_.empty()))
            assignments.push_back(
                {&parameter, "the password", readNewPassword(session, passwordFile_)});
    }
    return makeCall(*findMethod(task_->method), assignments);
}

Write TaskCommand::writeOf(Session& session, MethodCall const& call) const
{
    bool const isNever = std::any_of(given_.begin(), given_.end(), [this](Given const& given) {
        return given.text == neverExpires && parameterOf(*task_, *given.value).form == Form::Day;
    });
    return methodWrite(session.node("os"), call, isNever ? Expiry::Erase : Expiry::Keep);
}

void TaskCommand::carryOutTask(Session& session) const
{
    MethodCall const call = callOf(session);
    std::string const what = fmt::format("{} {}", subject_.command, task_->name);
    std::string const question =
        task_->question ? fmt::format(task_->question, given_.front().text) : "";
    session.node("os"); // built before others are kept from changing the machine
    ChangeLock const lock =
        clearChange(session, what, question, [&call] { checkMembership(call); });
    Write write = writeOf(session, call);
    write.what = what;
    carryOut(session, write);
}

void TaskCommand::run(Session& session)
{
    std::string const what = task_ ? fmt::format("{} {}: ", subject_.command, task_->name)
                                   : fmt::format("{}: ", subject_.command);
    try {
        if (task_)
            carryOutTask(session);
        else
            subject_.show(session, shown_);
    } catch (Failure const& failure) {
        bool const isNamed = std::string_view(failure.what()).substr(0, what.size()) == what;
        throw Failure(failure.code(), (isNamed ? "" : what) + failure.what());
    }
}

} // namespace mihost
