#ifndef MIHOST_CLI_COMMANDS_TASK_H
#define MIHOST_CLI_COMMANDS_TASK_H

#include "mihost/cli/input/Command.h"

#include <utility>
#include <vector>

namespace mihost
{

/** A value that a task takes, as an argument ("USER") or an option ("--shell"). */
struct TaskValue {
    char const* name;
    char const* parameter; // of the task's method
    char const* type;      // of an option's value in the help, or FILE or DIR for completion
    char const* meaning;
};

/** A command such as "user add", which calls a method of the operating-system node. */
struct Task {
    char const* name;
    char const* summary;
    char const* method;
    std::vector<TaskValue> values; // the first is what the task is about
    Example examples[2];
    char const* question = nullptr; // the prompt, {} being the first value; null for none
    bool isNothingWithoutOption = false;

    Task asking(char const* text) const
    {
        Task task = *this;
        task.question = text;
        return task;
    }
    Task needingAnOption() const
    {
        Task task = *this;
        task.isNothingWithoutOption = true;
        return task;
    }
};

} // namespace mihost

#endif
