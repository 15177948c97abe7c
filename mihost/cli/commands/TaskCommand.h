#ifndef MIHOST_CLI_COMMANDS_TASKCOMMAND_H
#define MIHOST_CLI_COMMANDS_TASKCOMMAND_H

#include "mihost/cli/change/MethodWrite.h"
#include "mihost/cli/commands/Task.h"

#include <string>

namespace mihost
{

/** What a command's tasks are about, such as users. */
struct Subject {
    char const* command;  // "user"
    char const* argument; // "USER"
    char const* meaning;
    std::vector<Task> const& tasks;
    void (*show)(Session& session, std::string const& name);
};

/** A command that shows one account or group, and has a command below it for each task. */
class TaskCommand : public Command
{
public:
    explicit TaskCommand(Subject const& subject) : subject_(subject) {}

    void declare(CLI::App& app) override;
    void run(Session& session) override;

private:
    struct Given {
        TaskValue const* value;
        std::string text;
    };

    void declareTask(CLI::App& app, Task const& task);
    void declareValue(CLI::App& app, Task const& task, TaskValue const& value);
    void declarePassword(CLI::App& app, TaskValue const& value, bool isRequired);
    void checkWords() const;
    MethodCall callOf(Session const& session) const;
    Write writeOf(Session& session, MethodCall const& call) const;
    void carryOutTask(Session& session) const;

    Subject subject_;
    Task const* task_ = nullptr; // null to show
    std::string shown_;
    std::vector<Given> given_;
    bool isPasswordWanted_ = false;
    std::string passwordFile_; // "-" for standard input
};

} // namespace mihost

#endif
